
library ieee;
use ieee.std_logic_1164.ALL;
use ieee.numeric_std.ALL;
library KESTRA;
use KESTRA.Vcomponents.ALL;

entity name_cases is
   port ( data      : in    std_logic_vector (1 downto 0); 
          y         : out   std_logic);
end name_cases;
architecture BEHAVIORAL of name_cases is
   signal mid       : std_logic;
   component AND2
      port ( I0 : in    std_logic; 
             I1 : in    std_logic; 
             O  : out   std_logic);
   end component;

begin
   U1 : AND2
      port map (I0=>data(0),
                I1=>data(1),
                O=>mid);
   U2 : AND2
      port map (I0=>mid,
                I1=>data(1),
                O=>y);
end BEHAVIORAL;

-- synopsys translate_off
configuration CFG_name_cases of  name_cases is
   for BEHAVIORAL
      for U1, U2 : AND2
         use configuration WORK.CFG_AND2;
      end for;
   end for;
end CFG_name_cases;
-- synopsys translate_on

