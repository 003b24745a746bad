-- Counts the rising edges of the input, and remembers that it has wrapped.

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
    clk     : in  std_logic;
    rst     : in  std_logic;
    pulse   : in  std_logic;
    clear   : in  std_logic;
    count   : out std_logic_vector(WIDTH - 1 downto 0);
    wrapped : out std_logic
  );
end entity pulse_counter;

architecture rtl of pulse_counter is
  constant FULL : unsigned(WIDTH - 1 downto 0) := (others => '1');

  signal value : unsigned(WIDTH - 1 downto 0) := (others => '0');
  signal last  : std_logic := '0';
begin

  advance : process (clk)
  begin
    if rising_edge(clk) then
      last <= pulse;
      if rst = '1' or clear = '1' then
        value   <= (others => '0');
        wrapped <= '0';
      elsif pulse = '1' and last = '0' then
        value <= value + 1;
        if value = FULL then
          wrapped <= '1';
        end if;
      end if;
    end if;
  end process advance;

  count <= to_gray(std_logic_vector(value)) when GRAY else std_logic_vector(value);

end architecture rtl;
