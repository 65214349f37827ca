
library ieee;
use ieee.std_logic_1164.ALL;
use ieee.numeric_std.ALL;
library KESTRA;
use KESTRA.Vcomponents.ALL;

entity wired_or_output is
   port ( A : in    std_logic; 
          B : in    std_logic; 
          Y : out   std_logic; 
          Z : out   std_logic);
end wired_or_output;
architecture BEHAVIORAL of wired_or_output is
   signal Y_DUMMY : std_logic;
   component INV
      port ( I : in    std_logic; 
             O : out   std_logic);
   end component;

begin
   Y <= Y_DUMMY;
   U1 : INV
      port map (I=>A,
                O=>Y_DUMMY);
   U2 : INV
      port map (I=>B,
                O=>Y_DUMMY);
   U3 : INV
      port map (I=>B,
                O=>Z);
end BEHAVIORAL;

-- synopsys translate_off
configuration CFG_wired_or_output of  wired_or_output is
   for BEHAVIORAL
      for U1, U2, U3 : INV
         use configuration WORK.CFG_INV;
      end for;
   end for;
end CFG_wired_or_output;
-- synopsys translate_on

