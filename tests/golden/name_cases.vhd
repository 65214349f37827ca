
library ieee;
use ieee.std_logic_1164.ALL;
use ieee.numeric_std.ALL;
library KESTRA;
use KESTRA.Vcomponents.ALL;

entity name_cases is
   port ( Data      : in    std_logic_vector (1 downto 0); 
          Y         : out   std_logic);
end name_cases;
architecture BEHAVIORAL of name_cases is
   signal Mid       : std_logic;
   component And2
      port ( I0 : in    std_logic; 
             I1 : in    std_logic; 
             O  : out   std_logic);
   end component;

begin
   u1 : And2
      port map (I0=>Data(0),
                I1=>Data(1),
                O=>Mid);
   u2 : And2
      port map (I0=>Mid,
                I1=>Data(1),
                O=>Y);
end BEHAVIORAL;

-- synopsys translate_off
configuration CFG_name_cases of  name_cases is
   for BEHAVIORAL
      for u1, u2 : And2
         use configuration WORK.CFG_And2;
      end for;
   end for;
end CFG_name_cases;
-- synopsys translate_on

