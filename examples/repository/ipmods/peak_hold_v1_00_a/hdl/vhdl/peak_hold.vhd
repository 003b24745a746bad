library ieee;
use ieee.std_logic_1164.all;
use ieee.numeric_std.all;

library metering;
use metering.samples_pack.all;

entity peak_hold is
  generic (
    WIDTH : positive := 8;
    DEPTH : positive := 4
  );
  port (
    clk    : in  std_logic;
    sample : in  std_logic_vector(WIDTH-1 downto 0);
    peak   : out std_logic_vector(WIDTH-1 downto 0)
  );
end entity peak_hold;

architecture rtl of peak_hold is
  signal recent : sample_list(0 to DEPTH-1)(WIDTH-1 downto 0) := (others => (others => '0'));
begin
  keep : process (clk)
  begin
    if rising_edge(clk) then
      for i in 1 to DEPTH-1 loop
        recent(i) <= recent(i-1);
      end loop;
      recent(0) <= unsigned(sample);
    end if;
  end process keep;

  peak <= std_logic_vector(largest(recent));
end architecture rtl;
