
library ieee;
use ieee.std_logic_1164.ALL;
use ieee.numeric_std.ALL;
library KESTRA;
use KESTRA.Vcomponents.ALL;

entity output_read_inside is
   port ( A      : in    std_logic; 
          Q      : out   std_logic_vector (1 downto 0); 
          Y      : out   std_logic);
end output_read_inside;
architecture BEHAVIORAL of output_read_inside is
   signal Q_DUMMY      : std_logic_vector (1 downto 0);
   signal Y_DUMMY      : std_logic;
   component INV
      port ( I : in    std_logic; 
             O : out   std_logic);
   end component;

begin
   Q(1 downto 0) <= Q_DUMMY(1 downto 0);
   Y <= Y_DUMMY;
   U1 : INV
      port map (I=>A,
                O=>Y_DUMMY);
   U2 : INV
      port map (I=>Y_DUMMY,
                O=>Q_DUMMY(0));
   U3 : INV
      port map (I=>Q_DUMMY(0),
                O=>Q_DUMMY(1));
end BEHAVIORAL;

-- synopsys translate_off
configuration CFG_output_read_inside of  output_read_inside is
   for BEHAVIORAL
      for U1, U2, U3 : INV
         use configuration WORK.CFG_INV;
      end for;
   end for;
end CFG_output_read_inside;
-- synopsys translate_on

