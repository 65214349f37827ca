
library ieee;
use ieee.std_logic_1164.ALL;
use ieee.numeric_std.ALL;
library KESTRA;
use KESTRA.Vcomponents.ALL;

entity black_boxes is
   port ( A : in    std_logic; 
          Y : out   std_logic);
end black_boxes;
architecture BEHAVIORAL of black_boxes is
   attribute BOX_TYPE : string ;
   signal n1 : std_logic;
   component BUF1
      port ( I : in    std_logic; 
             O : out   std_logic);
   end component;
   attribute BOX_TYPE of BUF1 : component is "BLACK_BOX";

   component INV
      port ( I : in    std_logic; 
             O : out   std_logic);
   end component;

begin
   U1 : BUF1
      port map (I=>A,
                O=>n1);
   U2 : INV
      port map (I=>n1,
                O=>Y);
end BEHAVIORAL;

-- synopsys translate_off
configuration CFG_black_boxes of  black_boxes is
   for BEHAVIORAL
      for U2 : INV
         use configuration WORK.CFG_INV;
      end for;
   end for;
end CFG_black_boxes;
-- synopsys translate_on

