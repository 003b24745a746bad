-- One cycle of '1' for each rising edge of the input.

library ieee;
use ieee.std_logic_1164.all;

entity edge_detect is
  port (
    clk    : in  std_logic;
    rst    : in  std_logic;
    level  : in  std_logic;
    rising : out std_logic
  );
end entity edge_detect;

architecture rtl of edge_detect is
  signal last : std_logic := '0';
begin

  remember : process (clk)
  begin
    if rising_edge(clk) then
      last <= level and not rst;
    end if;
  end process remember;

  rising <= level and not last;

end architecture rtl;
