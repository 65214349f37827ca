
library ieee;
use ieee.std_logic_1164.ALL;
use ieee.numeric_std.ALL;
library KESTRA;
use KESTRA.Vcomponents.ALL;

entity synthesis_attributes is
   port ( A : in    std_logic; 
          Y : out   std_logic);
   attribute LOC    : string ;
   attribute LOC of A : signal is "P1";
end synthesis_attributes;
architecture BEHAVIORAL of synthesis_attributes is
   attribute KEEP   : string ;
   attribute SPEED  : string ;
   attribute KIND   : string ;
   attribute RLOC   : string ;
   signal n1 : std_logic;
   component INV
      port ( I : in    std_logic; 
             O : out   std_logic);
   end component;
   attribute SPEED of INV : component is "slow";
   attribute KIND of INV : component is "gate";

   attribute KEEP of n1 : signal is "TRUE";
   attribute speed of U1 : label is "fast";
   attribute RLOC of U1 : label is "X0 Y1";
begin
   U1 : INV
      port map (I=>A,
                O=>n1);
   U2 : INV
      port map (I=>n1,
                O=>Y);
end BEHAVIORAL;

-- synopsys translate_off
configuration CFG_synthesis_attributes of  synthesis_attributes is
   for BEHAVIORAL
      for U1, U2 : INV
         use configuration WORK.CFG_INV;
      end for;
   end for;
end CFG_synthesis_attributes;
-- synopsys translate_on

