
library ieee;
use ieee.std_logic_1164.ALL;
use ieee.numeric_std.ALL;
library KESTRA;
use KESTRA.Vcomponents.ALL;

entity input_driven_inside is
   port ( A : in    std_logic; 
          B : in    std_logic; 
          Y : out   std_logic);
end input_driven_inside;
architecture BEHAVIORAL of input_driven_inside is
   signal A_DUMMY : std_logic;
   component INV
      port ( I : in    std_logic; 
             O : out   std_logic);
   end component;

begin
   A_DUMMY <= A;
   U1 : INV
      port map (I=>B,
                O=>A_DUMMY);
   U2 : INV
      port map (I=>A_DUMMY,
                O=>Y);
end BEHAVIORAL;

-- synopsys translate_off
configuration CFG_input_driven_inside of  input_driven_inside is
   for BEHAVIORAL
      for U1, U2 : INV
         use configuration WORK.CFG_INV;
      end for;
   end for;
end CFG_input_driven_inside;
-- synopsys translate_on

