-- Counts the clock cycles in which the input is high.

library ieee;
use ieee.std_logic_1164.all;
use ieee.numeric_std.all;

library math_pack_v1_00_a;
use math_pack_v1_00_a.math_pack.all;

entity pulse_counter is
  generic (
    WIDTH : positive := 8;
    GRAY  : boolean  := false
  );
  port (
    clk   : in  std_logic;
    rst   : in  std_logic;
    pulse : in  std_logic;
    count : out std_logic_vector(WIDTH - 1 downto 0)
  );
end entity pulse_counter;

architecture rtl of pulse_counter is
  signal value : unsigned(WIDTH - 1 downto 0) := (others => '0');
begin

  advance : process (clk)
  begin
    if rising_edge(clk) then
      if rst = '1' then
        value <= (others => '0');
      elsif pulse = '1' then
        value <= value + 1;
      end if;
    end if;
  end process advance;

  count <= to_gray(std_logic_vector(value)) when GRAY else std_logic_vector(value);

end architecture rtl;
