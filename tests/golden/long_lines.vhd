
library ieee;
use ieee.std_logic_1164.ALL;
use ieee.numeric_std.ALL;
library KESTRA;
use KESTRA.Vcomponents.ALL;

entity long_lines is
   port ( D                                                                  : 
         in    std_logic_vector (16 downto 0); 
          a_port_whose_name_is_so_long_that_its_declaration_cannot_fit       : 
         out   std_logic_vector (15 downto 0); 
          W                                                                  : 
         out   std_logic_vector (0 to 15));
end long_lines;
architecture BEHAVIORAL of long_lines is
begin
   a_port_whose_name_is_so_long_that_its_declaration_cannot_fit(15 downto 0) <= 
         D(15 downto 0);
   W(0) <= D(0);
   W(1) <= D(1);
   W(2) <= D(2);
   W(3) <= D(3);
   W(4) <= D(4);
   W(5) <= D(5);
   W(6) <= D(6);
   W(7) <= D(7);
   W(8) <= D(8);
   W(9) <= D(9);
   W(10) <= D(10);
   W(11) <= D(11);
   W(12) <= D(12);
   W(13) <= D(13);
   W(14) <= D(14);
   W(15) <= D(15);
end BEHAVIORAL;

-- synopsys translate_off
configuration CFG_long_lines of  long_lines is
   for BEHAVIORAL
   end for;
end CFG_long_lines;
-- synopsys translate_on

