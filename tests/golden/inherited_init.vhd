
library ieee;
use ieee.std_logic_1164.ALL;
use ieee.numeric_std.ALL;
library KESTRA;
use KESTRA.Vcomponents.ALL;

entity MHALVEX_LUT is
   generic( INIT : bit_vector :=  x"1234");
   port ( A      : in    std_logic_vector (3 downto 0); 
          Y      : out   std_logic; 
          Z      : out   std_logic);
end MHALVEX_LUT;
architecture BEHAVIORAL of MHALVEX_LUT is
   component LUT4
      generic( INIT : bit_vector :=  x"FFFE");
      port ( I      : in    std_logic_vector (3 downto 0); 
             O      : out   std_logic);
   end component;

begin
   U1 : LUT4
      generic map( INIT => INIT)
      port map (I(3 downto 0)=>A(3 downto 0),
                O=>Y);
   U2 : LUT4
      generic map( INIT => INIT)
      port map (I(3 downto 0)=>A(3 downto 0),
                O=>Z);
end BEHAVIORAL;

-- synopsys translate_off
configuration CFG_MHALVEX_LUT of  MHALVEX_LUT is
   for BEHAVIORAL
      for U1, U2 : LUT4
         use configuration WORK.CFG_LUT4;
      end for;
   end for;
end CFG_MHALVEX_LUT;
-- synopsys translate_on

