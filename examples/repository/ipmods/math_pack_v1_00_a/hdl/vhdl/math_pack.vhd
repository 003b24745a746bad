-- Small functions shared by the VHDL cores of this repository.

library ieee;
use ieee.std_logic_1164.all;

package math_pack is

  -- Number of bits that can hold every value from 0 to top.
  function bits_for(top : natural) return positive;

  -- Binary to reflected Gray code, and back.
  function to_gray(binary : std_logic_vector) return std_logic_vector;
  function from_gray(gray : std_logic_vector) return std_logic_vector;

  -- The bit that makes the number of ones in the word and the bit odd.
  function odd_parity(word : std_logic_vector) return std_logic;

  -- '1' for true, '0' for false.
  function to_bit_value(condition : boolean) return std_logic;

end package math_pack;

package body math_pack is

  function bits_for(top : natural) return positive is
    variable rest : natural := top / 2;
    variable bits : positive := 1;
  begin
    while rest > 0 loop
      bits := bits + 1;
      rest := rest / 2;
    end loop;
    return bits;
  end function bits_for;

  function to_gray(binary : std_logic_vector) return std_logic_vector is
    alias value : std_logic_vector(binary'length - 1 downto 0) is binary;
  begin
    return value xor ('0' & value(value'high downto 1));
  end function to_gray;

  function from_gray(gray : std_logic_vector) return std_logic_vector is
    alias value : std_logic_vector(gray'length - 1 downto 0) is gray;
    variable result : std_logic_vector(value'range);
  begin
    result(value'high) := value(value'high);
    for i in value'high - 1 downto 0 loop
      result(i) := result(i + 1) xor value(i);
    end loop;
    return result;
  end function from_gray;

  function odd_parity(word : std_logic_vector) return std_logic is
    variable result : std_logic := '1';
  begin
    for i in word'range loop
      result := result xor word(i);
    end loop;
    return result;
  end function odd_parity;

  function to_bit_value(condition : boolean) return std_logic is
  begin
    if condition then
      return '1';
    end if;
    return '0';
  end function to_bit_value;

end package body math_pack;
