
library ieee;
use ieee.std_logic_1164.ALL;
use ieee.numeric_std.ALL;
library KESTRA;
use KESTRA.Vcomponents.ALL;

entity X is
port ( A      : in    std_logic; 
       B      : in    std_logic_vector (3 downto 0); 
       Y      : out   std_logic; 
       Z      : out   std_logic_vector (3 downto 0));
end X;
architecture BEHAVIORAL of X is
component BUF1
generic( INIT : bit_vector :=  b"0110");
port ( I : in    std_logic; 
       O : out   std_logic);
end component;

component REG4
port ( D      : in    std_logic_vector (3 downto 0); 
       Q      : out   std_logic_vector (3 downto 0));
end component;

begin
U1 : BUF1
generic map( INIT => b"0110")
port map (I=>A,
          O=>Y);
U2 : REG4
port map (D(3 downto 0)=>B(3 downto 0),
          Q(3 downto 0)=>Z(3 downto 0));
end BEHAVIORAL;

