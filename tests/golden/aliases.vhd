
library ieee;
use ieee.std_logic_1164.ALL;
use ieee.numeric_std.ALL;
library KESTRA;
use KESTRA.Vcomponents.ALL;

entity aliases is
   port ( A      : in    std_logic; 
          D      : in    std_logic_vector (3 downto 0); 
          P      : out   std_logic_vector (0 to 3); 
          Q      : out   std_logic_vector (3 downto 0); 
          R      : out   std_logic_vector (1 downto 0); 
          Y      : out   std_logic; 
          Z      : out   std_logic);
end aliases;
architecture BEHAVIORAL of aliases is
begin
   P(0 to 3) <= D(3 downto 0);
   Q(3 downto 0) <= D(3 downto 0);
   R(1 downto 0) <= D(3 downto 2);
   Y <= A;
   Z <= D(2);
end BEHAVIORAL;

-- synopsys translate_off
configuration CFG_aliases of  aliases is
   for BEHAVIORAL
   end for;
end CFG_aliases;
-- synopsys translate_on

