-- Sends pulses of two cycles until the count has wrapped, then clears it.

library ieee;
use ieee.std_logic_1164.all;
use ieee.numeric_std.all;

entity pulse_counter_tb is
end entity pulse_counter_tb;

architecture test of pulse_counter_tb is
  signal clk            : std_logic := '0';
  signal rst            : std_logic := '1';
  signal pulse, clear   : std_logic := '0';
  signal count          : std_logic_vector(2 downto 0);
  signal wrapped, ended : std_logic := '0';
begin

  clk <= not clk after 5 ns when ended = '0';

  dut : entity work.pulse_counter
    generic map (WIDTH => 3)
    port map (clk => clk, rst => rst, pulse => pulse, clear => clear,
              count => count, wrapped => wrapped);

  drive : process
    procedure cycles(number : positive) is
    begin
      for i in 1 to number loop
        wait until falling_edge(clk);
      end loop;
    end procedure cycles;
  begin
    cycles(2);
    rst <= '0';
    for i in 1 to 9 loop
      pulse <= '1';
      cycles(2);
      pulse <= '0';
      cycles(1);
      assert unsigned(count) = i mod 8 report "wrong count" severity failure;
      assert (wrapped = '1') = (i >= 8) report "wrong wrapped flag" severity failure;
    end loop;
    clear <= '1';
    cycles(1);
    clear <= '0';
    cycles(1);
    assert count = "000" and wrapped = '0' report "not cleared" severity failure;
    report "PASS";
    ended <= '1';
    wait;
  end process drive;

end architecture test;
