-- Follows two periods of the wave and counts the wraps.

library ieee;
use ieee.std_logic_1164.all;
use ieee.numeric_std.all;

entity tone_gen_tb is
end entity tone_gen_tb;

architecture test of tone_gen_tb is
  signal clk    : std_logic := '0';
  signal rst    : std_logic := '1';
  signal enable : std_logic := '0';
  signal sample : std_logic_vector(2 downto 0);
  signal wrap   : std_logic;
  signal ended  : boolean := false;
begin

  clk <= not clk after 5 ns when not ended;

  dut : entity work.tone_gen
    generic map (PHASE_WIDTH => 4, SAMPLE_WIDTH => 3)
    port map (clk => clk, rst => rst, enable => enable, step => "0001",
              sample => sample, wrap => wrap);

  drive : process
    variable wraps, expected : natural := 0;
  begin
    wait until falling_edge(clk);
    rst    <= '0';
    enable <= '1';
    for i in 1 to 32 loop
      wait until falling_edge(clk);
      expected := i mod 16;
      if expected > 7 then
        expected := 15 - expected;
      end if;
      assert to_integer(unsigned(sample)) = expected
        report "wrong sample" severity failure;
      if wrap = '1' then
        wraps := wraps + 1;
      end if;
    end loop;
    assert wraps = 2 report "wrong number of wraps" severity failure;
    enable <= '0';
    wait until falling_edge(clk);
    assert sample = "000" and wrap = '0' report "did not stop" severity failure;
    report "PASS";
    ended <= true;
    wait;
  end process drive;

end architecture test;
