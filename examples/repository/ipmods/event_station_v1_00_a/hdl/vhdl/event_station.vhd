-- Counts the presses of a button, logs the time of each, and sounds a tone
-- while the button is down.

library ieee;
use ieee.std_logic_1164.all;
use ieee.numeric_std.all;

library bit_filter_v1_00_a, pulse_counter_v2_00_a, scratch_ram_v1_00_a, tone_gen_v1_00_a;

entity event_station is
  generic (
    SETTLE         : positive := 4;
    COUNT_WIDTH    : positive := 8;
    LOG_ADDR_WIDTH : positive := 4;
    PITCH          : natural  := 2048
  );
  port (
    clk       : in  std_logic;
    rst       : in  std_logic;
    button    : in  std_logic;
    leds      : out std_logic_vector(0 to 3);
    speaker   : out std_logic_vector(7 downto 0);
    bus_sel   : in  std_logic;
    bus_write : in  std_logic;
    bus_addr  : in  std_logic_vector(1 downto 0);
    bus_wdata : in  std_logic_vector(COUNT_WIDTH - 1 downto 0);
    bus_rdata : out std_logic_vector(COUNT_WIDTH - 1 downto 0);
    log_en    : in  std_logic;
    log_addr  : in  std_logic_vector(LOG_ADDR_WIDTH - 1 downto 0);
    log_data  : out std_logic_vector(7 downto 0);
    log_error : out std_logic;
    irq       : out std_logic
  );
end entity event_station;

architecture rtl of event_station is
  signal down, changed, press, wrap : std_logic;

  signal now_time : unsigned(7 downto 0) := (others => '0');
  signal next_log : unsigned(LOG_ADDR_WIDTH - 1 downto 0) := (others => '0');
begin

  filter : entity bit_filter_v1_00_a.bit_filter
    generic map (SETTLE => SETTLE)
    port map (clk => clk, rst => rst, raw => button, clean => down, changed => changed);

  counter : entity pulse_counter_v2_00_a.pulse_counter
    generic map (WIDTH => COUNT_WIDTH)
    port map (clk => clk, rst => rst, pulse => down, bus_sel => bus_sel,
              bus_write => bus_write, bus_addr => bus_addr, bus_wdata => bus_wdata,
              bus_rdata => bus_rdata, irq => irq);

  log : entity scratch_ram_v1_00_a.scratch_ram
    generic map (ADDR_WIDTH => LOG_ADDR_WIDTH, DATA_WIDTH => 8)
    port map (clk => clk, wr_en => press, wr_addr => std_logic_vector(next_log),
              wr_data => std_logic_vector(now_time), rd_en => log_en,
              rd_addr => log_addr, rd_data => log_data, rd_error => log_error);

  tone : entity tone_gen_v1_00_a.tone_gen
    generic map (PHASE_WIDTH => 16, SAMPLE_WIDTH => 8)
    port map (clk => clk, rst => rst, enable => down,
              step => std_logic_vector(to_unsigned(PITCH, 16)), sample => speaker,
              wrap => wrap);

  press <= changed and down;
  leds  <= (0 => down, 1 => changed, 2 => irq, 3 => wrap);

  keep_time : process (clk)
  begin
    if rising_edge(clk) then
      now_time <= now_time + 1;
      if press = '1' then
        next_log <= next_log + 1;
      end if;
      if rst = '1' then
        now_time <= (others => '0');
        next_log <= (others => '0');
      end if;
    end if;
  end process keep_time;

end architecture rtl;
