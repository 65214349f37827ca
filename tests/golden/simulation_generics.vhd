
library ieee;
use ieee.std_logic_1164.ALL;
use ieee.numeric_std.ALL;
library KESTRA;
use KESTRA.Vcomponents.ALL;

entity simulation_generics is
   -- synopsys translate_off
   generic( MODE : string :=  "fast");
   -- synopsys translate_on
   port ( I   : in    std_logic; 
          T   : in    std_logic; 
          O   : out   std_logic; 
          PAD : inout std_logic);
end simulation_generics;
architecture BEHAVIORAL of simulation_generics is
   component IOBUF
      -- synopsys translate_off
      generic( SLEW : string :=  "SLOW");
      -- synopsys translate_on
      port ( I  : in    std_logic; 
             T  : in    std_logic; 
             O  : out   std_logic; 
             IO : inout std_logic);
   end component;

begin
   U1 : IOBUF
      -- synopsys translate_off
      generic map( SLEW => "FAST")
      -- synopsys translate_on
      port map (I=>I,
                T=>T,
                O=>O,
                IO=>PAD);
end BEHAVIORAL;

-- synopsys translate_off
configuration CFG_simulation_generics of  simulation_generics is
   for BEHAVIORAL
      for U1 : IOBUF
         use configuration WORK.CFG_IOBUF;
      end for;
   end for;
end CFG_simulation_generics;
-- synopsys translate_on

