
library ieee;
use ieee.std_logic_1164.ALL;
use ieee.numeric_std.ALL;
library KESTRA;
use KESTRA.Vcomponents.ALL;

entity compound_of_output_ports is
   port ( X      : in    std_logic; 
          W      : out   std_logic; 
          Y      : out   std_logic; 
          Z      : out   std_logic_vector (1 downto 0));
end compound_of_output_ports;
architecture BEHAVIORAL of compound_of_output_ports is
   signal Y_DUMMY      : std_logic;
   signal Z_DUMMY      : std_logic_vector (1 downto 0);
   component BUF1
      port ( I : in    std_logic; 
             O : out   std_logic);
   end component;

   component LUT4
      port ( I      : in    std_logic_vector (3 downto 0); 
             O      : out   std_logic);
   end component;

begin
   Y <= Y_DUMMY;
   Z(1 downto 0) <= Z_DUMMY(1 downto 0);
   U1 : BUF1
      port map (I=>X,
                O=>Y_DUMMY);
   U2 : BUF1
      port map (I=>X,
                O=>Z_DUMMY(0));
   U3 : BUF1
      port map (I=>X,
                O=>Z_DUMMY(1));
   U4 : LUT4
      port map (I(3)=>Y_DUMMY,
                I(2 downto 1)=>Z_DUMMY(1 downto 0),
                I(0)=>X,
                O=>W);
end BEHAVIORAL;

-- synopsys translate_off
configuration CFG_compound_of_output_ports of  compound_of_output_ports is
   for BEHAVIORAL
      for U1, U2, U3 : BUF1
         use configuration WORK.CFG_BUF1;
      end for;
      for U4 : LUT4
         use configuration WORK.CFG_LUT4;
      end for;
   end for;
end CFG_compound_of_output_ports;
-- synopsys translate_on

