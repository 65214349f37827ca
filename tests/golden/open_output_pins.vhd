
library ieee;
use ieee.std_logic_1164.ALL;
use ieee.numeric_std.ALL;
library KESTRA;
use KESTRA.Vcomponents.ALL;

entity open_output_pins is
   port ( A      : in    std_logic_vector (3 downto 0); 
          B      : in    std_logic_vector (3 downto 0); 
          X      : in    std_logic; 
          S      : out   std_logic_vector (3 downto 0); 
          Y      : out   std_logic; 
          Z      : out   std_logic);
end open_output_pins;
architecture BEHAVIORAL of open_output_pins is
   component ADD4
      port ( A      : in    std_logic_vector (3 downto 0); 
             B      : in    std_logic_vector (3 downto 0); 
             CI     : in    std_logic; 
             S      : out   std_logic_vector (3 downto 0); 
             CO     : out   std_logic);
   end component;

   component AND2
      port ( I0 : in    std_logic; 
             I1 : in    std_logic; 
             O  : out   std_logic);
   end component;

begin
   U1 : ADD4
      port map (A(3 downto 0)=>A(3 downto 0),
                B(3 downto 0)=>B(3 downto 0),
                CI=>X,
                CO=>open,
                S(3 downto 0)=>S(3 downto 0));
   U2 : ADD4
      port map (A(3 downto 0)=>A(3 downto 0),
                B(3 downto 0)=>B(3 downto 0),
                CI=>X,
                CO=>Z,
                S=>open);
   U3 : AND2
      port map (I0=>X,
                I1=>A(0),
                O=>Y);
end BEHAVIORAL;

-- synopsys translate_off
configuration CFG_open_output_pins of  open_output_pins is
   for BEHAVIORAL
      for U1, U2 : ADD4
         use configuration WORK.CFG_ADD4;
      end for;
      for U3 : AND2
         use configuration WORK.CFG_AND2;
      end for;
   end for;
end CFG_open_output_pins;
-- synopsys translate_on

