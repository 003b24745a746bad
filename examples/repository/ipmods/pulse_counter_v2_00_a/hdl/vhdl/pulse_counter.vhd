-- Edge counter behind four registers, with an interrupt at a chosen count.
--
--   address  read               write
--   0        count              any value clears the count
--   1        level              count that raises the interrupt
--   2        count, Gray code   -
--   3        bit 0: interrupt   any value ends the interrupt

library ieee;
use ieee.std_logic_1164.all;
use ieee.numeric_std.all;

library math_pack_v1_00_a;
use math_pack_v1_00_a.math_pack.all;

entity pulse_counter is
  generic (
    WIDTH : positive := 8
  );
  port (
    clk       : in  std_logic;
    rst       : in  std_logic;
    pulse     : in  std_logic;
    bus_sel   : in  std_logic;
    bus_write : in  std_logic;
    bus_addr  : in  std_logic_vector(1 downto 0);
    bus_wdata : in  std_logic_vector(WIDTH - 1 downto 0);
    bus_rdata : out std_logic_vector(WIDTH - 1 downto 0);
    irq       : out std_logic
  );
end entity pulse_counter;

architecture rtl of pulse_counter is
  signal count   : unsigned(WIDTH - 1 downto 0) := (others => '0');
  signal level   : unsigned(WIDTH - 1 downto 0) := (others => '1');
  signal pending : std_logic := '0';
  signal rising  : std_logic;
begin

  edges : entity work.edge_detect
    port map (clk => clk, rst => rst, level => pulse, rising => rising);

  registers : process (clk)
  begin
    if rising_edge(clk) then
      if rising = '1' then
        count <= count + 1;
        if count + 1 = level then
          pending <= '1';
        end if;
      end if;
      if bus_sel = '1' and bus_write = '1' then
        case bus_addr is
          when "00"   => count   <= (others => '0');
          when "01"   => level   <= unsigned(bus_wdata);
          when "11"   => pending <= '0';
          when others => null;
        end case;
      end if;
      if rst = '1' then
        count   <= (others => '0');
        level   <= (others => '1');
        pending <= '0';
      end if;
    end if;
  end process registers;

  with bus_addr select bus_rdata <=
    std_logic_vector(count)               when "00",
    std_logic_vector(level)               when "01",
    to_gray(std_logic_vector(count))      when "10",
    (WIDTH - 1 downto 1 => '0') & pending when others;

  irq <= pending;

end architecture rtl;
