-- Triangle wave whose frequency is set by the step of a phase accumulator.

library ieee;
use ieee.std_logic_1164.all;

entity tone_gen is
  generic (
    PHASE_WIDTH  : positive := 16;
    SAMPLE_WIDTH : positive := 8
  );
  port (
    clk    : in  std_logic;
    rst    : in  std_logic;
    enable : in  std_logic;
    step   : in  std_logic_vector(PHASE_WIDTH - 1 downto 0);
    sample : out std_logic_vector(SAMPLE_WIDTH - 1 downto 0);
    wrap   : out std_logic
  );
end entity tone_gen;

architecture rtl of tone_gen is

  component phase_acc is
    generic (
      WIDTH : positive
    );
    port (
      clk    : in  std_logic;
      rst    : in  std_logic;
      enable : in  std_logic;
      step   : in  std_logic_vector(WIDTH - 1 downto 0);
      phase  : out std_logic_vector(WIDTH - 1 downto 0);
      wrap   : out std_logic
    );
  end component phase_acc;

  constant TOP : natural := PHASE_WIDTH - 2;

  signal phase : std_logic_vector(PHASE_WIDTH - 1 downto 0);

begin

  accumulator : component phase_acc
    generic map (WIDTH => PHASE_WIDTH)
    port map (clk => clk, rst => rst, enable => enable, step => step,
              phase => phase, wrap => wrap);

  -- the first bit of the phase says whether the wave rises or falls
  sample <= phase(TOP downto TOP + 1 - SAMPLE_WIDTH)
              xor (SAMPLE_WIDTH - 1 downto 0 => phase(PHASE_WIDTH - 1));

end architecture rtl;
