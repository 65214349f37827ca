
library ieee;
use ieee.std_logic_1164.ALL;
use ieee.numeric_std.ALL;
library KESTRA;
use KESTRA.Vcomponents.ALL;

entity constants is
   port ( Y      : out   std_logic_vector (7 downto 0); 
          Z      : out   std_logic);
end constants;
architecture BEHAVIORAL of constants is
   signal B                      : std_logic_vector (3 downto 0);
   signal N                      : std_logic;
   signal O1                     : std_logic;
   signal S1                     : std_logic_vector (3 downto 0);
   signal U1_I0_CONST_SIGNAL     : std_logic;
   signal U1_I1_CONST_SIGNAL     : std_logic;
   signal U2_A_CONST_SIGNAL      : std_logic_vector (3 downto 0);
   signal U2_B_CONST_SIGNAL      : std_logic_vector (3 downto 0);
   signal U2_CI_CONST_SIGNAL     : std_logic;
   signal X                      : std_logic_vector (8 downto 0);
   component AND2
      port ( I0 : in    std_logic; 
             I1 : in    std_logic; 
             O  : out   std_logic);
   end component;

   component ADD4
      port ( A      : in    std_logic_vector (3 downto 0); 
             B      : in    std_logic_vector (3 downto 0); 
             CI     : in    std_logic; 
             S      : out   std_logic_vector (3 downto 0); 
             CO     : out   std_logic);
   end component;

begin
   B(2 downto 0) <= b"010";
   B(3) <= '1';
   N <= '0';
   U1_I0_CONST_SIGNAL <= '1';
   U1_I1_CONST_SIGNAL <= '0';
   U2_A_CONST_SIGNAL(3 downto 0) <= b"1010";
   U2_B_CONST_SIGNAL(3 downto 0) <= x"F";
   U2_CI_CONST_SIGNAL <= '1';
   X(8 downto 0) <= o"245";
   Y(7 downto 0) <= x"A5";
   Z <= '1';
   U1 : AND2
      port map (I0=>U1_I0_CONST_SIGNAL,
                I1=>U1_I1_CONST_SIGNAL,
                O=>O1);
   U2 : ADD4
      port map (A(3 downto 0)=>U2_A_CONST_SIGNAL(3 downto 0),
                B(3 downto 0)=>U2_B_CONST_SIGNAL(3 downto 0),
                CI=>U2_CI_CONST_SIGNAL,
                CO=>open,
                S(3 downto 0)=>S1(3 downto 0));
end BEHAVIORAL;

-- synopsys translate_off
configuration CFG_constants of  constants is
   for BEHAVIORAL
      for U2 : ADD4
         use configuration WORK.CFG_ADD4;
      end for;
      for U1 : AND2
         use configuration WORK.CFG_AND2;
      end for;
   end for;
end CFG_constants;
-- synopsys translate_on

