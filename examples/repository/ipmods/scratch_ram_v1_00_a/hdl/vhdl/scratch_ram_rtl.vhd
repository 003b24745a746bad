-- Each word is stored with a parity bit and checked when it is read.

library ieee;
use ieee.std_logic_1164.all;
use ieee.numeric_std.all;

library math_pack_v1_00_a;
use math_pack_v1_00_a.math_pack.all;

architecture rtl of scratch_ram is
  type word_array is array (natural range <>) of std_logic_vector(DATA_WIDTH downto 0);
  signal words : word_array(0 to 2 ** ADDR_WIDTH - 1);
  signal word  : std_logic_vector(DATA_WIDTH downto 0);
begin

  ports : process (clk)
  begin
    if rising_edge(clk) then
      if rd_en = '1' then
        word <= words(to_integer(unsigned(rd_addr)));
      end if;
      if wr_en = '1' then
        words(to_integer(unsigned(wr_addr))) <= odd_parity(wr_data) & wr_data;
      end if;
    end if;
  end process ports;

  rd_data  <= word(DATA_WIDTH - 1 downto 0);
  rd_error <= word(DATA_WIDTH) xor odd_parity(word(DATA_WIDTH - 1 downto 0));

end architecture rtl;
