-- Two inverters, one after the other.
--   Written   by hand. This line is a comment and stays in one piece although it is long.

library ieee;
library KESTRA;
use ieee.std_logic_1164.ALL;
use KESTRA.Vcomponents.ALL;
entity comments_and_libraries is
   port ( A : in    std_logic; 
          Y : out   std_logic);
end comments_and_libraries;
architecture BEHAVIORAL of comments_and_libraries is
   -- between the two
   -- and its second line
   signal n1 : std_logic;
   -- an inverter
   component INV
      port ( I : in    std_logic; 
             O : out   std_logic);
   end component;

begin
   -- the first
   U1 : INV
      port map (I=>A,
                O=>n1);
   U2 : INV
      port map (I=>n1,
                O=>Y);
end BEHAVIORAL;

