-- Presses a bouncing button three times, 20 cycles apart.

library ieee;
use ieee.std_logic_1164.all;
use ieee.numeric_std.all;

entity event_station_tb is
end entity event_station_tb;

architecture test of event_station_tb is
  signal clk                : std_logic := '0';
  signal rst                : std_logic := '1';
  signal button             : std_logic := '0';
  signal leds               : std_logic_vector(0 to 3);
  signal speaker            : std_logic_vector(7 downto 0);
  signal bus_sel, bus_write : std_logic := '0';
  signal bus_addr           : std_logic_vector(1 downto 0) := "00";
  signal bus_wdata          : std_logic_vector(7 downto 0) := x"00";
  signal bus_rdata          : std_logic_vector(7 downto 0);
  signal log_en             : std_logic := '0';
  signal log_addr           : std_logic_vector(2 downto 0) := "000";
  signal log_data           : std_logic_vector(7 downto 0);
  signal log_error, irq     : std_logic;
  signal ended              : boolean := false;
begin

  clk <= not clk after 5 ns when not ended;

  dut : entity work.event_station
    generic map (SETTLE => 3, COUNT_WIDTH => 8, LOG_ADDR_WIDTH => 3, PITCH => 4096)
    port map (clk => clk, rst => rst, button => button, leds => leds,
              speaker => speaker, bus_sel => bus_sel, bus_write => bus_write,
              bus_addr => bus_addr, bus_wdata => bus_wdata, bus_rdata => bus_rdata,
              log_en => log_en, log_addr => log_addr, log_data => log_data,
              log_error => log_error, irq => irq);

  drive : process
    procedure hold(level : std_logic; number : positive) is
    begin
      button <= level;
      for i in 1 to number loop
        wait until falling_edge(clk);
      end loop;
    end procedure hold;

    variable first : unsigned(7 downto 0);
  begin
    hold('0', 3);
    rst       <= '0';
    bus_sel   <= '1';
    bus_write <= '1';
    bus_addr  <= "01";
    bus_wdata <= x"03";
    hold('0', 1);
    bus_sel   <= '0';
    bus_write <= '0';
    bus_addr  <= "00";

    for i in 1 to 3 loop
      hold('1', 1);
      hold('0', 1);
      hold('1', 9);
      assert leds(0) = '1' and speaker /= x"00" report "no tone" severity failure;
      hold('0', 9);
      assert leds(0) = '0' report "still down" severity failure;
      assert unsigned(bus_rdata) = i report "wrong count" severity failure;
      assert (irq = '1') = (i = 3) report "wrong interrupt" severity failure;
    end loop;

    log_en <= '1';
    for i in 0 to 2 loop
      log_addr <= std_logic_vector(to_unsigned(i, 3));
      hold('0', 1);
      if i = 0 then
        first := unsigned(log_data);
      end if;
      assert unsigned(log_data) = first + 20 * i and log_error = '0'
        report "wrong time in the log" severity failure;
    end loop;
    report "PASS";
    ended <= true;
    wait;
  end process drive;

end architecture test;
