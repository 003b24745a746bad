-- Sets the level to 5, sends pulses, and follows count and interrupt.

library ieee;
use ieee.std_logic_1164.all;
use ieee.numeric_std.all;

entity pulse_counter_tb is
end entity pulse_counter_tb;

architecture test of pulse_counter_tb is
  signal clk                : std_logic := '0';
  signal rst                : std_logic := '1';
  signal pulse              : std_logic := '0';
  signal bus_sel, bus_write : std_logic := '0';
  signal bus_addr           : std_logic_vector(1 downto 0) := "00";
  signal bus_wdata          : std_logic_vector(7 downto 0) := x"00";
  signal bus_rdata          : std_logic_vector(7 downto 0);
  signal irq, ended         : std_logic := '0';
begin

  clk <= not clk after 5 ns when ended = '0';

  dut : entity work.pulse_counter
    generic map (WIDTH => 8)
    port map (clk => clk, rst => rst, pulse => pulse, bus_sel => bus_sel,
              bus_write => bus_write, bus_addr => bus_addr,
              bus_wdata => bus_wdata, bus_rdata => bus_rdata, irq => irq);

  drive : process
    procedure cycle is
    begin
      wait until falling_edge(clk);
    end procedure cycle;

    procedure put(address, value : natural) is
    begin
      bus_sel   <= '1';
      bus_write <= '1';
      bus_addr  <= std_logic_vector(to_unsigned(address, 2));
      bus_wdata <= std_logic_vector(to_unsigned(value, 8));
      cycle;
      bus_sel   <= '0';
      bus_write <= '0';
    end procedure put;

    procedure expect(address, value : natural) is
    begin
      bus_addr <= std_logic_vector(to_unsigned(address, 2));
      wait for 1 ns;
      assert to_integer(unsigned(bus_rdata)) = value
        report "register " & integer'image(address) & " does not hold "
          & integer'image(value) severity failure;
    end procedure expect;
  begin
    cycle;
    rst <= '0';
    put(1, 5);
    expect(1, 5);
    for i in 1 to 6 loop
      pulse <= '1';
      cycle;
      cycle;
      pulse <= '0';
      cycle;
      expect(0, i);
      assert (irq = '1') = (i >= 5) report "wrong interrupt" severity failure;
    end loop;
    expect(2, 5);                       -- 6 is 101 in Gray code
    expect(3, 1);
    put(3, 0);
    expect(3, 0);
    put(0, 0);
    expect(0, 0);
    assert irq = '0' report "interrupt did not end" severity failure;
    report "PASS";
    ended <= '1';
    wait;
  end process drive;

end architecture test;
