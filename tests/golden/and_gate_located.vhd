
library ieee;
use ieee.std_logic_1164.ALL;
use ieee.numeric_std.ALL;
library KESTRA;
use KESTRA.Vcomponents.ALL;

entity top is
   port ( A      : in    std_logic_vector (1 downto 0); 
          Y      : out   std_logic);
end top;
architecture BEHAVIORAL of top is
   attribute LOC : string ;
   signal n1     : std_logic;
   component AND2
      port ( I0 : in    std_logic; 
             I1 : in    std_logic; 
             O  : out   std_logic);
   end component;

   attribute LOC of U1 : label is "P1";
begin
   U1 : AND2
      port map (I0=>A(0),
                I1=>n1,
                O=>Y);
end BEHAVIORAL;

-- synopsys translate_off
configuration CFG_top of  top is
   for BEHAVIORAL
      for U1 : AND2
         use configuration WORK.CFG_AND2;
      end for;
   end for;
end CFG_top;
-- synopsys translate_on

