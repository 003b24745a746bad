-- Fills the memory, reads it back, and reads a word while it is written.

library ieee;
use ieee.std_logic_1164.all;
use ieee.numeric_std.all;

entity scratch_ram_tb is
end entity scratch_ram_tb;

architecture test of scratch_ram_tb is
  signal clk              : std_logic := '0';
  signal wr_en, rd_en     : std_logic := '0';
  signal wr_addr, rd_addr : std_logic_vector(2 downto 0) := "000";
  signal wr_data          : std_logic_vector(7 downto 0) := x"00";
  signal rd_data          : std_logic_vector(7 downto 0);
  signal rd_error         : std_logic;
  signal ended            : boolean := false;
begin

  clk <= not clk after 5 ns when not ended;

  dut : entity work.scratch_ram
    generic map (ADDR_WIDTH => 3, DATA_WIDTH => 8)
    port map (clk => clk, wr_en => wr_en, wr_addr => wr_addr, wr_data => wr_data,
              rd_en => rd_en, rd_addr => rd_addr, rd_data => rd_data,
              rd_error => rd_error);

  drive : process
    function content(address : natural) return std_logic_vector is
    begin
      return std_logic_vector(to_unsigned(29 * address + 3, 8));
    end function content;
  begin
    wait until falling_edge(clk);
    wr_en <= '1';
    for i in 0 to 7 loop
      wr_addr <= std_logic_vector(to_unsigned(i, 3));
      wr_data <= content(i);
      wait until falling_edge(clk);
    end loop;
    wr_en <= '0';
    rd_en <= '1';
    for i in 7 downto 0 loop
      rd_addr <= std_logic_vector(to_unsigned(i, 3));
      wait until falling_edge(clk);
      assert rd_data = content(i) and rd_error = '0'
        report "word " & integer'image(i) & " is wrong" severity failure;
    end loop;
    -- both ports at one address: the read port gives the old word
    wr_en   <= '1';
    wr_addr <= "000";
    wr_data <= x"ff";
    wait until falling_edge(clk);
    assert rd_data = content(0) report "old word expected" severity failure;
    wr_en <= '0';
    wait until falling_edge(clk);
    assert rd_data = x"ff" report "new word expected" severity failure;
    report "PASS";
    ended <= true;
    wait;
  end process drive;

end architecture test;
