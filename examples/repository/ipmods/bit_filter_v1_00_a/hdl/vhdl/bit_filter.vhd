-- Takes over a new input level only after it has stood still for SETTLE cycles.

library ieee;
use ieee.std_logic_1164.all;
use ieee.numeric_std.all;

library math_pack_v1_00_a;
use math_pack_v1_00_a.math_pack.all;

entity bit_filter is
  generic (
    SETTLE : positive := 4
  );
  port (
    clk     : in  std_logic;
    rst     : in  std_logic;
    raw     : in  std_logic;
    clean   : out std_logic;
    changed : out std_logic
  );
end entity bit_filter;

architecture rtl of bit_filter is
  signal sync  : std_logic_vector(1 downto 0) := "00";
  signal level : std_logic := '0';
  signal age   : unsigned(bits_for(SETTLE) - 1 downto 0) := (others => '0');
begin

  filter : process (clk)
  begin
    if rising_edge(clk) then
      changed <= '0';
      if rst = '1' then
        sync  <= "00";
        level <= '0';
        age   <= (others => '0');
      else
        sync <= sync(0) & raw;
        if sync(1) = level then
          age <= (others => '0');
        elsif age = SETTLE - 1 then
          age     <= (others => '0');
          level   <= sync(1);
          changed <= '1';
        else
          age <= age + 1;
        end if;
      end if;
    end if;
  end process filter;

  clean <= level;

end architecture rtl;
