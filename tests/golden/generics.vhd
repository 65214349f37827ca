
library ieee;
use ieee.std_logic_1164.ALL;
use ieee.numeric_std.ALL;
library KESTRA;
use KESTRA.Vcomponents.ALL;

entity generics is
   generic( WIDTH : integer :=  4;
            START : bit :=  '1'
   -- synopsys translate_off
   ;
            NOTE : string :=  "model only";
            QUICK : boolean :=  TRUE
   -- synopsys translate_on
   );
   port ( A      : in    std_logic_vector (3 downto 0); 
          Y      : out   std_logic; 
          Z      : out   std_logic);
end generics;
architecture BEHAVIORAL of generics is
   component LUT4
      generic( INIT : bit_vector :=  x"FFFE");
      port ( I      : in    std_logic_vector (3 downto 0); 
             O      : out   std_logic);
   end component;

begin
   U1 : LUT4
      generic map( INIT => x"8000")
      port map (I(3 downto 0)=>A(3 downto 0),
                O=>Y);
   U2 : LUT4
      generic map( INIT => x"FFFE")
      port map (I(3 downto 0)=>A(3 downto 0),
                O=>Z);
end BEHAVIORAL;

-- synopsys translate_off
configuration CFG_generics of  generics is
   for BEHAVIORAL
      for U1, U2 : LUT4
         use configuration WORK.CFG_LUT4;
      end for;
   end for;
end CFG_generics;
-- synopsys translate_on

