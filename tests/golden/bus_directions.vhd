
library ieee;
use ieee.std_logic_1164.ALL;
use ieee.numeric_std.ALL;
library KESTRA;
use KESTRA.Vcomponents.ALL;

entity bus_directions is
   port ( D      : in    std_logic_vector (7 downto 0); 
          V      : out   std_logic_vector (0 to 3); 
          W      : out   std_logic_vector (0 to 3); 
          Z      : out   std_logic_vector (3 downto 0));
end bus_directions;
architecture BEHAVIORAL of bus_directions is
   signal N      : std_logic_vector (3 downto 0);
   component REV4
      port ( I      : in    std_logic_vector (0 to 3); 
             O      : out   std_logic_vector (0 to 3));
   end component;

begin
   N(0) <= '1';
   N(1) <= '0';
   N(3 downto 2) <= b"01";
   W(0) <= D(1);
   W(1) <= D(2);
   W(2) <= D(3);
   W(3) <= D(4);
   U1 : REV4
      port map (I(0 to 3)=>D(7 downto 4),
                O(0 to 3)=>V(0 to 3));
   U2 : REV4
      port map (I(0)=>D(0),
                I(1)=>D(1),
                I(2)=>D(2),
                I(3)=>D(3),
                O(0 to 3)=>Z(3 downto 0));
end BEHAVIORAL;

-- synopsys translate_off
configuration CFG_bus_directions of  bus_directions is
   for BEHAVIORAL
      for U1, U2 : REV4
         use configuration WORK.CFG_REV4;
      end for;
   end for;
end CFG_bus_directions;
-- synopsys translate_on

