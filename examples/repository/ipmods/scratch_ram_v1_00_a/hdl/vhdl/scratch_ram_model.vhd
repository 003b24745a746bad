-- Behaves like rtl, and warns when a word is read that was never written.

library ieee;
use ieee.std_logic_1164.all;
use ieee.numeric_std.all;

architecture model of scratch_ram is
begin

  ports : process (clk)
    type word_array is array (natural range <>) of std_logic_vector(DATA_WIDTH - 1 downto 0);
    type flag_array is array (natural range <>) of boolean;
    variable words   : word_array(0 to 2 ** ADDR_WIDTH - 1);
    variable written : flag_array(words'range) := (others => false);
    variable address : natural;
  begin
    if rising_edge(clk) then
      if rd_en = '1' then
        address := to_integer(unsigned(rd_addr));
        if written(address) then
          rd_data  <= words(address);
          rd_error <= '0';
        else
          report "word " & integer'image(address) & " was never written" severity warning;
          rd_data  <= (others => 'X');
          rd_error <= 'X';
        end if;
      end if;
      if wr_en = '1' then
        address          := to_integer(unsigned(wr_addr));
        words(address)   := wr_data;
        written(address) := true;
      end if;
    end if;
  end process ports;

end architecture model;
