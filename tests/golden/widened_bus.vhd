
library ieee;
use ieee.std_logic_1164.ALL;
use ieee.numeric_std.ALL;
library KESTRA;
use KESTRA.Vcomponents.ALL;

entity widened_bus is
   port ( A      : in    std_logic_vector (3 downto 0); 
          B      : in    std_logic_vector (3 downto 0); 
          X      : in    std_logic; 
          Q      : out   std_logic_vector (7 downto 0));
end widened_bus;
architecture BEHAVIORAL of widened_bus is
   signal carry  : std_logic;
   signal T      : std_logic_vector (7 downto 0);
   component ADD4
      port ( A      : in    std_logic_vector (3 downto 0); 
             B      : in    std_logic_vector (3 downto 0); 
             CI     : in    std_logic; 
             S      : out   std_logic_vector (3 downto 0); 
             CO     : out   std_logic);
   end component;

begin
   Q(7 downto 0) <= T(7 downto 0);
   U1 : ADD4
      port map (A(3 downto 0)=>A(3 downto 0),
                B(3 downto 0)=>B(3 downto 0),
                CI=>X,
                CO=>carry,
                S(3 downto 0)=>T(3 downto 0));
   U2 : ADD4
      port map (A(3 downto 0)=>A(3 downto 0),
                B(3 downto 0)=>B(3 downto 0),
                CI=>carry,
                CO=>open,
                S(3 downto 0)=>T(7 downto 4));
end BEHAVIORAL;

-- synopsys translate_off
configuration CFG_widened_bus of  widened_bus is
   for BEHAVIORAL
      for U1, U2 : ADD4
         use configuration WORK.CFG_ADD4;
      end for;
   end for;
end CFG_widened_bus;
-- synopsys translate_on

