-- A bouncing input must give one change, at the end of the bouncing.

library ieee;
use ieee.std_logic_1164.all;

entity bit_filter_tb is
end entity bit_filter_tb;

architecture test of bit_filter_tb is
  signal clk            : std_logic := '0';
  signal rst            : std_logic := '1';
  signal raw            : std_logic := '0';
  signal clean, changed : std_logic;
  signal changes        : natural := 0;
  signal ended          : boolean := false;
begin

  clk <= not clk after 5 ns when not ended;

  dut : entity work.bit_filter
    generic map (SETTLE => 3)
    port map (clk => clk, rst => rst, raw => raw, clean => clean, changed => changed);

  observe : process (clk)
  begin
    if rising_edge(clk) and changed = '1' then
      changes <= changes + 1;
    end if;
  end process observe;

  drive : process
    procedure hold(level : std_logic; number : positive) is
    begin
      raw <= level;
      for i in 1 to number loop
        wait until falling_edge(clk);
      end loop;
    end procedure hold;
  begin
    hold('0', 4);
    rst <= '0';
    hold('1', 2);
    hold('0', 1);
    hold('1', 1);
    hold('0', 8);
    assert clean = '0' and changes = 0 report "a glitch came through" severity failure;
    hold('1', 8);
    assert clean = '1' and changes = 1 report "rise is missing" severity failure;
    hold('0', 1);
    hold('1', 1);
    hold('0', 8);
    assert clean = '0' and changes = 2 report "fall is missing" severity failure;
    report "PASS";
    ended <= true;
    wait;
  end process drive;

end architecture test;
