-- Leaf cells of the examples and of the flow designs, as in cells.v. Each but INV1
-- has a configuration CFG_name, which the configuration of a netlist asks for.
-- Flip-flop outputs move 1 ps after the clock, so that a clock that passes an
-- alias, and with it a delta cycle, still finds the old values.

library ieee;
use ieee.std_logic_1164.all;

entity BUF1 is
   port (I : in  std_logic;
         O : out std_logic);
end BUF1;

architecture rtl of BUF1 is
begin
   O <= I;
end rtl;

configuration CFG_BUF1 of BUF1 is
   for rtl
   end for;
end CFG_BUF1;

library ieee;
use ieee.std_logic_1164.all;

entity INV is
   port (I : in  std_logic;
         O : out std_logic);
end INV;

architecture rtl of INV is
begin
   O <= not I;
end rtl;

configuration CFG_INV of INV is
   for rtl
   end for;
end CFG_INV;

library ieee;
use ieee.std_logic_1164.all;

entity AND2 is
   port (I0 : in  std_logic;
         I1 : in  std_logic;
         O  : out std_logic);
end AND2;

architecture rtl of AND2 is
begin
   O <= I0 and I1;
end rtl;

configuration CFG_AND2 of AND2 is
   for rtl
   end for;
end CFG_AND2;

library ieee;
use ieee.std_logic_1164.all;

entity OR2 is
   port (I0 : in  std_logic;
         I1 : in  std_logic;
         O  : out std_logic);
end OR2;

architecture rtl of OR2 is
begin
   O <= I0 or I1;
end rtl;

configuration CFG_OR2 of OR2 is
   for rtl
   end for;
end CFG_OR2;

library ieee;
use ieee.std_logic_1164.all;

entity NAND2 is
   port (I0 : in  std_logic;
         I1 : in  std_logic;
         O  : out std_logic);
end NAND2;

architecture rtl of NAND2 is
begin
   O <= I0 nand I1;
end rtl;

configuration CFG_NAND2 of NAND2 is
   for rtl
   end for;
end CFG_NAND2;

library ieee;
use ieee.std_logic_1164.all;

entity NOR2 is
   port (I0 : in  std_logic;
         I1 : in  std_logic;
         O  : out std_logic);
end NOR2;

architecture rtl of NOR2 is
begin
   O <= I0 nor I1;
end rtl;

configuration CFG_NOR2 of NOR2 is
   for rtl
   end for;
end CFG_NOR2;

library ieee;
use ieee.std_logic_1164.all;

entity XOR2 is
   port (I0 : in  std_logic;
         I1 : in  std_logic;
         O  : out std_logic);
end XOR2;

architecture rtl of XOR2 is
begin
   O <= I0 xor I1;
end rtl;

configuration CFG_XOR2 of XOR2 is
   for rtl
   end for;
end CFG_XOR2;

library ieee;
use ieee.std_logic_1164.all;

entity XNOR2 is
   port (I0 : in  std_logic;
         I1 : in  std_logic;
         O  : out std_logic);
end XNOR2;

architecture rtl of XNOR2 is
begin
   O <= not (I0 xor I1);
end rtl;

configuration CFG_XNOR2 of XNOR2 is
   for rtl
   end for;
end CFG_XNOR2;

-- O is I1 when S is high.
library ieee;
use ieee.std_logic_1164.all;

entity MUX2 is
   port (I0 : in  std_logic;
         I1 : in  std_logic;
         S  : in  std_logic;
         O  : out std_logic);
end MUX2;

architecture rtl of MUX2 is
begin
   O <= I1 when S = '1' else I0;
end rtl;

configuration CFG_MUX2 of MUX2 is
   for rtl
   end for;
end CFG_MUX2;

library ieee;
use ieee.std_logic_1164.all;
use ieee.numeric_std.all;

entity MUX4 is
   port (D : in  std_logic_vector (3 downto 0);
         S : in  std_logic_vector (1 downto 0);
         O : out std_logic);
end MUX4;

architecture rtl of MUX4 is
begin
   O <= D(to_integer(unsigned(S)));
end rtl;

configuration CFG_MUX4 of MUX4 is
   for rtl
   end for;
end CFG_MUX4;

-- O is the bit of INIT that I selects.
library ieee;
use ieee.std_logic_1164.all;
use ieee.numeric_std.all;

entity LUT4 is
   generic (INIT : bit_vector (15 downto 0) := X"0000");
   port (I : in  std_logic_vector (3 downto 0);
         O : out std_logic);
end LUT4;

architecture rtl of LUT4 is
begin
   O <= to_stdulogic(INIT(to_integer(unsigned(I))));
end rtl;

configuration CFG_LUT4 of LUT4 is
   for rtl
   end for;
end CFG_LUT4;

library ieee;
use ieee.std_logic_1164.all;
use ieee.numeric_std.all;

entity ADD4 is
   port (A  : in  std_logic_vector (3 downto 0);
         B  : in  std_logic_vector (3 downto 0);
         CI : in  std_logic;
         S  : out std_logic_vector (3 downto 0);
         CO : out std_logic);
end ADD4;

architecture rtl of ADD4 is
   signal carry : unsigned (0 downto 0);
   signal sum   : unsigned (4 downto 0);
begin
   carry(0) <= CI;
   sum <= unsigned('0' & A) + unsigned('0' & B) + carry;
   S <= std_logic_vector(sum(3 downto 0));
   CO <= sum(4);
end rtl;

configuration CFG_ADD4 of ADD4 is
   for rtl
   end for;
end CFG_ADD4;

-- A bus of one bit on either side.
library ieee;
use ieee.std_logic_1164.all;

entity INV1 is
   port (I : in  std_logic_vector (0 downto 0);
         O : out std_logic_vector (0 downto 0));
end INV1;

architecture rtl of INV1 is
begin
   O <= not I;
end rtl;

-- Mirrors a nibble; both buses count upwards.
library ieee;
use ieee.std_logic_1164.all;

entity REV4 is
   port (I : in  std_logic_vector (0 to 3);
         O : out std_logic_vector (0 to 3));
end REV4;

architecture rtl of REV4 is
begin
   O <= I(3) & I(2) & I(1) & I(0);
end rtl;

configuration CFG_REV4 of REV4 is
   for rtl
   end for;
end CFG_REV4;

library ieee;
use ieee.std_logic_1164.all;

entity DFF is
   port (C : in  std_logic;
         D : in  std_logic;
         Q : out std_logic := '0');
end DFF;

architecture rtl of DFF is
begin
   process (C)
   begin
      if rising_edge(C) then
         Q <= D after 1 ps;
      end if;
   end process;
end rtl;

configuration CFG_DFF of DFF is
   for rtl
   end for;
end CFG_DFF;

-- With clock enable.
library ieee;
use ieee.std_logic_1164.all;

entity DFFE is
   port (C  : in  std_logic;
         CE : in  std_logic;
         D  : in  std_logic;
         Q  : out std_logic := '0');
end DFFE;

architecture rtl of DFFE is
begin
   process (C)
   begin
      if rising_edge(C) then
         if CE = '1' then
            Q <= D after 1 ps;
         end if;
      end if;
   end process;
end rtl;

configuration CFG_DFFE of DFFE is
   for rtl
   end for;
end CFG_DFFE;

-- With asynchronous clear.
library ieee;
use ieee.std_logic_1164.all;

entity DFFC is
   port (C   : in  std_logic;
         CLR : in  std_logic;
         D   : in  std_logic;
         Q   : out std_logic := '0');
end DFFC;

architecture rtl of DFFC is
begin
   process (C, CLR)
   begin
      if CLR = '1' then
         Q <= '0' after 1 ps;
      elsif rising_edge(C) then
         Q <= D after 1 ps;
      end if;
   end process;
end rtl;

configuration CFG_DFFC of DFFC is
   for rtl
   end for;
end CFG_DFFC;

-- With asynchronous preset.
library ieee;
use ieee.std_logic_1164.all;

entity DFFS is
   port (C   : in  std_logic;
         PRE : in  std_logic;
         D   : in  std_logic;
         Q   : out std_logic := '0');
end DFFS;

architecture rtl of DFFS is
begin
   process (C, PRE)
   begin
      if PRE = '1' then
         Q <= '1' after 1 ps;
      elsif rising_edge(C) then
         Q <= D after 1 ps;
      end if;
   end process;
end rtl;

configuration CFG_DFFS of DFFS is
   for rtl
   end for;
end CFG_DFFS;

library ieee;
use ieee.std_logic_1164.all;

entity DFFCE is
   port (C   : in  std_logic;
         CE  : in  std_logic;
         CLR : in  std_logic;
         D   : in  std_logic;
         Q   : out std_logic := '0');
end DFFCE;

architecture rtl of DFFCE is
begin
   process (C, CLR)
   begin
      if CLR = '1' then
         Q <= '0' after 1 ps;
      elsif rising_edge(C) then
         if CE = '1' then
            Q <= D after 1 ps;
         end if;
      end if;
   end process;
end rtl;

configuration CFG_DFFCE of DFFCE is
   for rtl
   end for;
end CFG_DFFCE;

library ieee;
use ieee.std_logic_1164.all;

entity DFFSE is
   port (C   : in  std_logic;
         CE  : in  std_logic;
         PRE : in  std_logic;
         D   : in  std_logic;
         Q   : out std_logic := '0');
end DFFSE;

architecture rtl of DFFSE is
begin
   process (C, PRE)
   begin
      if PRE = '1' then
         Q <= '1' after 1 ps;
      elsif rising_edge(C) then
         if CE = '1' then
            Q <= D after 1 ps;
         end if;
      end if;
   end process;
end rtl;

configuration CFG_DFFSE of DFFSE is
   for rtl
   end for;
end CFG_DFFSE;

-- Four flip-flops with clock enable and asynchronous clear.
library ieee;
use ieee.std_logic_1164.all;

entity REG4 is
   port (C   : in  std_logic;
         CE  : in  std_logic;
         CLR : in  std_logic;
         D   : in  std_logic_vector (3 downto 0);
         Q   : out std_logic_vector (3 downto 0) := "0000");
end REG4;

architecture rtl of REG4 is
begin
   process (C, CLR)
   begin
      if CLR = '1' then
         Q <= "0000" after 1 ps;
      elsif rising_edge(C) then
         if CE = '1' then
            Q <= D after 1 ps;
         end if;
      end if;
   end process;
end rtl;

configuration CFG_REG4 of REG4 is
   for rtl
   end for;
end CFG_REG4;

-- Pad: drives IO with I unless T is high; O is what IO shows.
library ieee;
use ieee.std_logic_1164.all;

entity IOBUF is
   generic (SLEW : string := "SLOW");
   port (I  : in    std_logic;
         T  : in    std_logic;
         O  : out   std_logic;
         IO : inout std_logic);
end IOBUF;

architecture rtl of IOBUF is
begin
   IO <= I when T = '0' else 'Z';
   O <= IO;
end rtl;

configuration CFG_IOBUF of IOBUF is
   for rtl
   end for;
end CFG_IOBUF;
