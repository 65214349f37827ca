
library ieee;
use ieee.std_logic_1164.ALL;
use ieee.numeric_std.ALL;
library KESTRA;
use KESTRA.Vcomponents.ALL;

entity X is
end X;
architecture BEHAVIORAL of X is
signal N : std_logic;
begin
end BEHAVIORAL;

