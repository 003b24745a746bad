-- Sends a rising and falling row of samples.

library ieee;
use ieee.std_logic_1164.all;
use ieee.numeric_std.all;

library metering;

entity peak_hold_tb is
  generic (
    DEPTH : positive := 3
  );
end entity peak_hold_tb;

architecture test of peak_hold_tb is
  signal clk          : std_logic := '0';
  signal sample, peak : std_logic_vector(7 downto 0) := (others => '0');
begin
  dut : entity metering.peak_hold
    generic map (WIDTH => 8, DEPTH => DEPTH)
    port map (clk => clk, sample => sample, peak => peak);

  check : process
    variable expected : natural;
  begin
    for i in 0 to 40 loop
      sample <= std_logic_vector(to_unsigned(20 - abs (i - 20), 8));
      wait for 5 ns;
      clk <= '1';
      wait for 5 ns;
      clk <= '0';
      -- up to the top the newest is the largest, and the oldest behind it
      expected := i when i <= 20 else 20 when i < 20 + DEPTH else 41 - i + DEPTH - 2;
      wait for 0 ns;
      assert to_integer(unsigned(peak)) = expected
        report "the peak is " & to_string(to_integer(unsigned(peak))) & ", not "
          & to_string(expected) severity failure;
    end loop;
    report "PASS";
    wait;
  end process check;
end architecture test;
