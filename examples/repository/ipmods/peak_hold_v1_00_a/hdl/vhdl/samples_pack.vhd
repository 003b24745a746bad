-- Lists of samples of any width, which VHDL has since 2008.

library ieee;
use ieee.std_logic_1164.all;
use ieee.numeric_std.all;

package samples_pack is
  type sample_list is array (natural range <>) of unsigned;

  -- The largest of at least one sample.
  function largest(samples : sample_list) return unsigned;
end package samples_pack;

package body samples_pack is
  function largest(samples : sample_list) return unsigned is
    variable found : unsigned(samples(samples'left)'range) := samples(samples'left);
  begin
    for i in samples'range loop
      found := samples(i) when samples(i) > found else found;
    end loop;
    return found;
  end function largest;
end package body samples_pack;
