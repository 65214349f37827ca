
library ieee;
use ieee.std_logic_1164.ALL;
use ieee.numeric_std.ALL;
library KESTRA;
use KESTRA.Vcomponents.ALL;

entity typed_attributes is
   port ( A : in    std_logic; 
          Y : out   std_logic);
end typed_attributes;
architecture BEHAVIORAL of typed_attributes is
   attribute NAME     : string ;
   attribute COUNT    : integer ;
   attribute RATIO    : real ;
   attribute ENABLE   : boolean ;
   attribute FLAG     : bit ;
   attribute MASK     : bit_vector ;
   attribute LOUDNESS : severity_level ;
   component INV
      port ( I : in    std_logic; 
             O : out   std_logic);
   end component;

   attribute NAME of U1 : label is "alpha";
   attribute COUNT of U1 : label is 5;
   attribute RATIO of U1 : label is 2.50;
   attribute ENABLE of U1 : label is TRUE;
   attribute FLAG of U1 : label is '1';
   attribute MASK of U1 : label is x"A";
   attribute LOUDNESS of U1 : label is warning;
begin
   U1 : INV
      port map (I=>A,
                O=>Y);
end BEHAVIORAL;

-- synopsys translate_off
configuration CFG_typed_attributes of  typed_attributes is
   for BEHAVIORAL
      for U1 : INV
         use configuration WORK.CFG_INV;
      end for;
   end for;
end CFG_typed_attributes;
-- synopsys translate_on

