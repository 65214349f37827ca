
library ieee;
use ieee.std_logic_1164.ALL;
use ieee.numeric_std.ALL;
library KESTRA;
use KESTRA.Vcomponents.ALL;

entity compounds is
   port ( P      : in    std_logic_vector (2 downto 0); 
          X      : in    std_logic; 
          Y      : in    std_logic; 
          C      : out   std_logic; 
          R      : out   std_logic_vector (3 downto 0));
end compounds;
architecture BEHAVIORAL of compounds is
   signal K      : std_logic;
   signal L      : std_logic;
   signal M      : std_logic;
   signal N      : std_logic_vector (1 downto 0);
   signal T      : std_logic_vector (1 downto 0);
   component ADD4
      port ( A      : in    std_logic_vector (3 downto 0); 
             B      : in    std_logic_vector (3 downto 0); 
             CI     : in    std_logic; 
             S      : out   std_logic_vector (3 downto 0); 
             CO     : out   std_logic);
   end component;

begin
   M <= '1';
   N(1) <= '0';
   N(0) <= '1';
   K <= P(2);
   L <= Y;
   R(1 downto 0) <= T(1 downto 0);
   U1 : ADD4
      port map (A(3)=>X,
                A(2 downto 0)=>P(2 downto 0),
                B(3)=>P(1),
                B(2 downto 1)=>P(2 downto 1),
                B(0)=>Y,
                CI=>X,
                CO=>C,
                S(3 downto 2)=>R(3 downto 2),
                S(1 downto 0)=>T(1 downto 0));
end BEHAVIORAL;

-- synopsys translate_off
configuration CFG_compounds of  compounds is
   for BEHAVIORAL
      for U1 : ADD4
         use configuration WORK.CFG_ADD4;
      end for;
   end for;
end CFG_compounds;
-- synopsys translate_on

