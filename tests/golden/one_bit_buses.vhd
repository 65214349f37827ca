
library ieee;
use ieee.std_logic_1164.ALL;
use ieee.numeric_std.ALL;
library KESTRA;
use KESTRA.Vcomponents.ALL;

entity one_bit_buses is
   port ( N      : in    std_logic; 
          S      : in    std_logic_vector (0 downto 0); 
          M      : out   std_logic; 
          T      : out   std_logic_vector (0 downto 0); 
          V      : out   std_logic_vector (3 downto 1));
end one_bit_buses;
architecture BEHAVIORAL of one_bit_buses is
   component INV1
      port ( I      : in    std_logic_vector (0 downto 0); 
             O      : out   std_logic_vector (0 downto 0));
   end component;

   component INV
      port ( I : in    std_logic; 
             O : out   std_logic);
   end component;

begin
   V(1) <= N;
   V(2) <= S(0);
   U1 : INV1
      port map (I(0)=>S(0),
                O(0)=>T(0));
   U2 : INV1
      port map (I(0)=>N,
                O(0)=>M);
   U3 : INV
      port map (I=>S(0),
                O=>V(3));
end BEHAVIORAL;

