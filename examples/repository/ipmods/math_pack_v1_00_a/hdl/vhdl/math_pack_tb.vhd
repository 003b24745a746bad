-- Walks all 6 bit values through the functions of the package.

library ieee;
use ieee.std_logic_1164.all;
use ieee.numeric_std.all;

library math_pack_v1_00_a;
use math_pack_v1_00_a.math_pack.all;

entity math_pack_tb is
end entity math_pack_tb;

architecture test of math_pack_tb is
begin
  check : process
    variable word, gray, last, step : std_logic_vector(5 downto 0);
  begin
    last := to_gray("111111");
    for i in 0 to 63 loop
      word := std_logic_vector(to_unsigned(i, 6));
      gray := to_gray(word);
      assert from_gray(gray) = word
        report "Gray code does not come back" severity failure;

      -- neighbours differ in one bit, so the parity changes each time
      step := gray xor last;
      assert (unsigned(step) and (unsigned(step) - 1)) = 0 and unsigned(step) /= 0
        report "neighbours do not differ in one bit" severity failure;
      assert odd_parity(gray) /= odd_parity(last)
        report "parity does not alternate" severity failure;
      last := gray;

      assert i < 2 ** bits_for(i) and (i < 2 or i >= 2 ** (bits_for(i) - 1))
        report "bits_for is not minimal" severity failure;
    end loop;
    assert to_bit_value(true) = '1' and to_bit_value(false) = '0'
      report "to_bit_value is wrong" severity failure;
    report "PASS";
    wait;
  end process check;
end architecture test;
