-- Twin of phase_acc.v, for simulators that read VHDL only.

library ieee;
use ieee.std_logic_1164.all;
use ieee.numeric_std.all;

entity phase_acc is
  generic (
    WIDTH : positive := 16
  );
  port (
    clk    : in  std_logic;
    rst    : in  std_logic;
    enable : in  std_logic;
    step   : in  std_logic_vector(WIDTH - 1 downto 0);
    phase  : out std_logic_vector(WIDTH - 1 downto 0);
    wrap   : out std_logic
  );
end entity phase_acc;

architecture model of phase_acc is
  signal sum : unsigned(WIDTH downto 0) := (others => '0');
begin

  accumulate : process (clk)
  begin
    if rising_edge(clk) then
      if rst = '1' then
        sum <= (others => '0');
      elsif enable = '1' then
        sum <= ('0' & sum(WIDTH - 1 downto 0)) + unsigned('0' & step);
      else
        sum(WIDTH) <= '0';
      end if;
    end if;
  end process accumulate;

  phase <= std_logic_vector(sum(WIDTH - 1 downto 0));
  wrap  <= sum(WIDTH);

end architecture model;
