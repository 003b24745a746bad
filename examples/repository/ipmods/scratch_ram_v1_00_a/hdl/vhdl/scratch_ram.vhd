-- Small memory with a write port and a read port. One of two architectures
-- goes with this entity: rtl for synthesis, model for simulation.

library ieee;
use ieee.std_logic_1164.all;

entity scratch_ram is
  generic (
    ADDR_WIDTH : positive := 4;
    DATA_WIDTH : positive := 8
  );
  port (
    clk      : in  std_logic;
    wr_en    : in  std_logic;
    wr_addr  : in  std_logic_vector(ADDR_WIDTH - 1 downto 0);
    wr_data  : in  std_logic_vector(DATA_WIDTH - 1 downto 0);
    rd_en    : in  std_logic;
    rd_addr  : in  std_logic_vector(ADDR_WIDTH - 1 downto 0);
    rd_data  : out std_logic_vector(DATA_WIDTH - 1 downto 0);
    rd_error : out std_logic
  );
end entity scratch_ram;
