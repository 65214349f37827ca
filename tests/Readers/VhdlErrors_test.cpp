// What the VHDL reader refuses, and how it says so.
#include "Readers/ReadText.h"

#include <gtest/gtest.h>

#include <string>

namespace {

using Support::VhdlTextReader;

struct Refused {
    const char* what;
    const char* text;
    /// The first line of the message.
    const char* message;
};

constexpr Refused Table[] = {
    {"process",
     "entity m is  end entity m;\n"
     "architecture a of m is signal a, b : std_logic; signal v, w : std_logic_vector(3 "
     "downto 0);\n"
     "begin\n"
     "process (a) begin b <= a; end process;\n"
     "end architecture a;\n",
     "top.vhd:4:1: error: \"process\" describes behaviour: synthesise the design first"},
    {"labelled process",
     "entity m is  end entity m;\n"
     "architecture a of m is signal a, b : std_logic; signal v, w : std_logic_vector(3 "
     "downto 0);\n"
     "begin\n"
     "p : process (a) begin b <= a; end process p;\n"
     "end architecture a;\n",
     "top.vhd:4:5: error: \"process\" describes behaviour: synthesise the design first"},
    {"for generate",
     "entity m is  end entity m;\n"
     "architecture a of m is signal a, b : std_logic; signal v, w : std_logic_vector(3 "
     "downto 0);\n"
     "begin\n"
     "g : for i in 0 to 3 generate v(i) <= a; end generate g;\n"
     "end architecture a;\n",
     "top.vhd:4:5: error: a generate statement: a model has no copies that depend on a "
     "value; synthesise the design first"},
    {"if generate",
     "entity m is  end entity m;\n"
     "architecture a of m is signal a, b : std_logic; signal v, w : std_logic_vector(3 "
     "downto 0);\n"
     "begin\n"
     "g : if true generate a <= b; end generate;\n"
     "end architecture a;\n",
     "top.vhd:4:5: error: a generate statement: a model has no copies that depend on a "
     "value; synthesise the design first"},
    {"block",
     "entity m is  end entity m;\n"
     "architecture a of m is signal a, b : std_logic; signal v, w : std_logic_vector(3 "
     "downto 0);\n"
     "begin\n"
     "k : block begin a <= b; end block;\n"
     "end architecture a;\n",
     "top.vhd:4:5: error: a block, which is a level of its own: a model has one level; "
     "flatten the design first"},
    {"conditional assignment",
     "entity m is  end entity m;\n"
     "architecture a of m is signal a, b : std_logic; signal v, w : std_logic_vector(3 "
     "downto 0);\n"
     "begin\n"
     "a <= b when v(0) = '1' else '0';\n"
     "end architecture a;\n",
     "top.vhd:4:8: error: \"when\" describes behaviour: synthesise the design first"},
    {"selected assignment",
     "entity m is  end entity m;\n"
     "architecture a of m is signal a, b : std_logic; signal v, w : std_logic_vector(3 "
     "downto 0);\n"
     "begin\n"
     "with v select a <= '1' when others;\n"
     "end architecture a;\n",
     "top.vhd:4:1: error: \"with\" describes behaviour: synthesise the design first"},
    {"operator",
     "entity m is  end entity m;\n"
     "architecture a of m is signal a, b : std_logic; signal v, w : std_logic_vector(3 "
     "downto 0);\n"
     "begin\n"
     "a <= a and b;\n"
     "end architecture a;\n",
     "top.vhd:4:8: error: \"and\" describes behaviour: synthesise the design first"},
    {"not",
     "entity m is  end entity m;\n"
     "architecture a of m is signal a, b : std_logic; signal v, w : std_logic_vector(3 "
     "downto 0);\n"
     "begin\n"
     "a <= not b;\n"
     "end architecture a;\n",
     "top.vhd:4:6: error: \"not\" describes behaviour: synthesise the design first"},
    {"operator in a port map",
     "entity m is  end entity m;\n"
     "architecture a of m is signal a, b : std_logic; signal v, w : std_logic_vector(3 "
     "downto 0);\n"
     "begin\n"
     "u : INV port map (I => not a, O => b);\n"
     "end architecture a;\n",
     "top.vhd:4:24: error: \"not\" describes behaviour: synthesise the design first"},
    {"arithmetic",
     "entity m is  end entity m;\n"
     "architecture a of m is signal a, b : std_logic; signal v, w : std_logic_vector(3 "
     "downto 0);\n"
     "begin\n"
     "v <= v + w;\n"
     "end architecture a;\n",
     "top.vhd:4:8: error: \"+\" describes behaviour: synthesise the design first"},
    {"relation",
     "entity m is  end entity m;\n"
     "architecture a of m is signal a, b : std_logic; signal v, w : std_logic_vector(3 "
     "downto 0);\n"
     "begin\n"
     "a <= v = w;\n"
     "end architecture a;\n",
     "top.vhd:4:8: error: \"=\" describes behaviour: synthesise the design first"},
    {"function call",
     "entity m is  end entity m;\n"
     "architecture a of m is signal a, b : std_logic; signal v, w : std_logic_vector(3 "
     "downto 0);\n"
     "begin\n"
     "a <= f(v);\n"
     "end architecture a;\n",
     "top.vhd:4:6: error: the function \"f\" describes behaviour: synthesise the design "
     "first"},
    {"function in a port map",
     "entity m is  end entity m;\n"
     "architecture a of m is signal a, b : std_logic; signal v, w : std_logic_vector(3 "
     "downto 0);\n"
     "begin\n"
     "u : INV port map (I => to_bit(a), O => b);\n"
     "end architecture a;\n",
     "top.vhd:4:24: error: the function \"to_bit\" describes behaviour: synthesise the "
     "design first"},
    {"conversion of a formal",
     "entity m is  end entity m;\n"
     "architecture a of m is signal a, b : std_logic; signal v, w : std_logic_vector(3 "
     "downto 0);\n"
     "begin\n"
     "u : INV port map (to_bit(I) => a, O => b);\n"
     "end architecture a;\n",
     "top.vhd:4:19: error: the function \"to_bit\" describes behaviour: synthesise the "
     "design first"},
    {"function body",
     "entity m is  end entity m;\n"
     "architecture a of m is signal a, b : std_logic; signal v, w : std_logic_vector(3 "
     "downto 0); function f(a : bit) return bit is begin return a; end function f;\n"
     "begin\n"
     "\n"
     "end architecture a;\n",
     "top.vhd:2:93: error: \"function\" describes behaviour: synthesise the design first"},
    {"procedure call",
     "entity m is  end entity m;\n"
     "architecture a of m is signal a, b : std_logic; signal v, w : std_logic_vector(3 "
     "downto 0);\n"
     "begin\n"
     "p(a);\n"
     "end architecture a;\n",
     "top.vhd:4:1: error: the procedure \"p\" describes behaviour: synthesise the design "
     "first"},
    {"assert",
     "entity m is  end entity m;\n"
     "architecture a of m is signal a, b : std_logic; signal v, w : std_logic_vector(3 "
     "downto 0);\n"
     "begin\n"
     "assert false report \"x\";\n"
     "end architecture a;\n",
     "top.vhd:4:1: error: \"assert\" describes behaviour: synthesise the design first"},
    {"delay",
     "entity m is  end entity m;\n"
     "architecture a of m is signal a, b : std_logic; signal v, w : std_logic_vector(3 "
     "downto 0);\n"
     "begin\n"
     "a <= b after 1 ns;\n"
     "end architecture a;\n",
     "top.vhd:4:8: error: a delay of an assignment: a model has none"},
    {"waveform",
     "entity m is  end entity m;\n"
     "architecture a of m is signal a, b : std_logic; signal v, w : std_logic_vector(3 "
     "downto 0);\n"
     "begin\n"
     "a <= b, '1';\n"
     "end architecture a;\n",
     "top.vhd:4:7: error: a delay of an assignment: a model has none"},
    {"transport",
     "entity m is  end entity m;\n"
     "architecture a of m is signal a, b : std_logic; signal v, w : std_logic_vector(3 "
     "downto 0);\n"
     "begin\n"
     "a <= transport b;\n"
     "end architecture a;\n",
     "top.vhd:4:6: error: \"transport\" describes behaviour: synthesise the design first"},
    {"value X",
     "entity m is  end entity m;\n"
     "architecture a of m is signal a, b : std_logic; signal v, w : std_logic_vector(3 "
     "downto 0);\n"
     "begin\n"
     "a <= 'X';\n"
     "end architecture a;\n",
     "top.vhd:4:6: error: the value 'X': a model has the values 0 and 1 alone"},
    {"value U in a string",
     "entity m is  end entity m;\n"
     "architecture a of m is signal a, b : std_logic; signal v, w : std_logic_vector(3 "
     "downto 0);\n"
     "begin\n"
     "v <= \"01U1\";\n"
     "end architecture a;\n",
     "top.vhd:4:6: error: the value 'U': a model has the values 0 and 1 alone"},
    {"value Z in a bit string",
     "entity m is  end entity m;\n"
     "architecture a of m is signal a, b : std_logic; signal v, w : std_logic_vector(3 "
     "downto 0);\n"
     "begin\n"
     "v <= X\"Z\";\n"
     "end architecture a;\n",
     "top.vhd:4:6: error: the value 'Z': a model has the values 0 and 1 alone"},
    {"value -",
     "entity m is  end entity m;\n"
     "architecture a of m is signal a, b : std_logic; signal v, w : std_logic_vector(3 "
     "downto 0);\n"
     "begin\n"
     "v <= (others => '-');\n"
     "end architecture a;\n",
     "top.vhd:4:17: error: the value '-': a model has the values 0 and 1 alone"},
    {"digit of another base",
     "entity m is  end entity m;\n"
     "architecture a of m is signal a, b : std_logic; signal v, w : std_logic_vector(3 "
     "downto 0);\n"
     "begin\n"
     "v <= B\"0102\";\n"
     "end architecture a;\n",
     "top.vhd:4:6: error: the digit 2 in a number of base 2"},
    {"initial value",
     "entity m is  end entity m;\n"
     "architecture a of m is  signal s : std_logic := '0';\n"
     "begin\n"
     "\n"
     "end architecture a;\n",
     "top.vhd:2:46: error: an initial value, which a model's signals do not have: assign "
     "it in a statement, or leave it out"},
    {"type integer",
     "entity m is  end entity m;\n"
     "architecture a of m is signal s : integer;\n"
     "begin\n"
     "\n"
     "end architecture a;\n",
     "top.vhd:2:35: error: the type \"integer\": a model has bits and vectors of bits "
     "(std_logic, std_ulogic, bit and their vectors)"},
    {"unconstrained vector",
     "entity m is  end entity m;\n"
     "architecture a of m is signal s : std_logic_vector;\n"
     "begin\n"
     "\n"
     "end architecture a;\n",
     "top.vhd:2:35: error: a vector without a range"},
    {"range of a bit",
     "entity m is  end entity m;\n"
     "architecture a of m is signal s : std_logic(1 downto 0);\n"
     "begin\n"
     "\n"
     "end architecture a;\n",
     "top.vhd:2:35: error: a range of \"std_logic\", which is a type of one bit"},
    {"null range",
     "entity m is  end entity m;\n"
     "architecture a of m is signal s : std_logic_vector(0 downto 1);\n"
     "begin\n"
     "\n"
     "end architecture a;\n",
     "top.vhd:2:35: error: a range without bits"},
    {"negative range",
     "entity m is  end entity m;\n"
     "architecture a of m is signal s : std_logic_vector(3 downto -1);\n"
     "begin\n"
     "\n"
     "end architecture a;\n",
     "top.vhd:2:35: error: a range with a negative index, which no name in a model can have"},
    {"range that cannot be told",
     "entity m is  end entity m;\n"
     "architecture a of m is signal s : std_logic_vector(N downto 0);\n"
     "begin\n"
     "\n"
     "end architecture a;\n",
     "top.vhd:2:35: error: a range whose value cannot be told"},
    {"array of vectors",
     "entity m is  end entity m;\n"
     "architecture a of m is type t is array (0 to 1) of bit;\n"
     "begin\n"
     "\n"
     "end architecture a;\n",
     "top.vhd:2:24: error: the declaration of a \"type\": a model has bits and vectors of "
     "bits alone"},
    {"shared variable",
     "entity m is  end entity m;\n"
     "architecture a of m is shared variable x : integer;\n"
     "begin\n"
     "\n"
     "end architecture a;\n",
     "top.vhd:2:24: error: \"shared\" describes behaviour: synthesise the design first"},
    {"undeclared signal",
     "entity m is  end entity m;\n"
     "architecture a of m is signal a, b : std_logic; signal v, w : std_logic_vector(3 "
     "downto 0);\n"
     "begin\n"
     "a <= c;\n"
     "end architecture a;\n",
     "top.vhd:4:6: error: the signal \"c\" is not declared"},
    {"undeclared target",
     "entity m is  end entity m;\n"
     "architecture a of m is signal a, b : std_logic; signal v, w : std_logic_vector(3 "
     "downto 0);\n"
     "begin\n"
     "c <= a;\n"
     "end architecture a;\n",
     "top.vhd:4:1: error: the signal \"c\" is not declared"},
    {"undeclared component",
     "entity m is  end entity m;\n"
     "architecture a of m is signal a, b : std_logic; signal v, w : std_logic_vector(3 "
     "downto 0);\n"
     "begin\n"
     "u : XYZ port map (a);\n"
     "end architecture a;\n",
     "top.vhd:4:5: error: the component \"XYZ\" is not declared: declare it, or give a "
     "library file that does"},
    {"undeclared entity",
     "entity m is  end entity m;\n"
     "architecture a of m is signal a, b : std_logic; signal v, w : std_logic_vector(3 "
     "downto 0);\n"
     "begin\n"
     "u : entity work.XYZ port map (a);\n"
     "end architecture a;\n",
     "top.vhd:4:12: error: the entity \"XYZ\" is not declared: a library file has to say "
     "which ports it has"},
    {"undeclared cells",
     "entity m is  end entity m;\n"
     "architecture a of m is signal a, b : std_logic;\n"
     "begin\n"
     "u1 : entity work.XYZ port map (a);\n"
     "u2 : entity work.xyz port map (a);\n"
     "u3 : entity work.ABC port map (a);\n"
     "u4 : DEF port map (a);\n"
     "end architecture a;\n",
     "top.vhd:4:13: error: the cells \"XYZ\", \"ABC\", \"DEF\" are not declared: a library file "
     "has "
     "to say which ports they have"},
    {"undeclared components",
     "entity m is  end entity m;\n"
     "architecture a of m is signal a, b : std_logic;\n"
     "begin\n"
     "u1 : XYZ port map (a);\n"
     "u2 : ABC port map (a);\n"
     "end architecture a;\n",
     "top.vhd:4:6: error: the cells \"XYZ\", \"ABC\" are not declared: declare them, or give a "
     "library file that does"},
    {"undeclared configuration",
     "entity m is  end entity m;\n"
     "architecture a of m is signal a, b : std_logic; signal v, w : std_logic_vector(3 "
     "downto 0);\n"
     "begin\n"
     "u : configuration work.XYZ port map (a);\n"
     "end architecture a;\n",
     "top.vhd:4:19: error: the configuration \"XYZ\" is not declared: instantiate its "
     "entity instead"},
    {"undeclared port",
     "entity m is  end entity m;\n"
     "architecture a of m is signal a, b : std_logic; signal v, w : std_logic_vector(3 "
     "downto 0);\n"
     "begin\n"
     "u : INV port map (X => a);\n"
     "end architecture a;\n",
     "top.vhd:4:19: error: the component \"INV\" has no port \"X\""},
    {"undeclared generic",
     "entity m is  end entity m;\n"
     "architecture a of m is signal a, b : std_logic; signal v, w : std_logic_vector(3 "
     "downto 0);\n"
     "begin\n"
     "u : REG generic map (X => 1) port map (a, v, w);\n"
     "end architecture a;\n",
     "top.vhd:4:22: error: the component \"REG\" has no generic \"X\""},
    {"too many ports",
     "entity m is  end entity m;\n"
     "architecture a of m is signal a, b : std_logic; signal v, w : std_logic_vector(3 "
     "downto 0);\n"
     "begin\n"
     "u : INV port map (a, b, a);\n"
     "end architecture a;\n",
     "top.vhd:4:25: error: the component \"INV\" has 2 ports and no further one"},
    {"too many generics",
     "entity m is  end entity m;\n"
     "architecture a of m is signal a, b : std_logic; signal v, w : std_logic_vector(3 "
     "downto 0);\n"
     "begin\n"
     "u : INV generic map (1) port map (a, b);\n"
     "end architecture a;\n",
     "top.vhd:4:22: error: the component \"INV\" has no further generic that this could be "
     "the value of"},
    {"position behind name",
     "entity m is  end entity m;\n"
     "architecture a of m is signal a, b : std_logic; signal v, w : std_logic_vector(3 "
     "downto 0);\n"
     "begin\n"
     "u : INV port map (I => a, b);\n"
     "end architecture a;\n",
     "top.vhd:4:27: error: a connection by position behind one by name"},
    {"port connected twice",
     "entity m is  end entity m;\n"
     "architecture a of m is signal a, b : std_logic; signal v, w : std_logic_vector(3 "
     "downto 0);\n"
     "begin\n"
     "u : INV port map (I => a, I => b);\n"
     "end architecture a;\n",
     "top.vhd:4:27: error: the port \"I\" is connected already"},
    {"part connected twice",
     "entity m is  end entity m;\n"
     "architecture a of m is signal a, b : std_logic; signal v, w : std_logic_vector(3 "
     "downto 0);\n"
     "begin\n"
     "u : REG port map (D(0) => a, D(0) => b, C => a);\n"
     "end architecture a;\n",
     "top.vhd:4:30: error: a part of the port \"D\" is connected twice"},
    {"part of a port left open",
     "entity m is  end entity m;\n"
     "architecture a of m is signal a, b : std_logic; signal v, w : std_logic_vector(3 "
     "downto 0);\n"
     "begin\n"
     "u : REG port map (C => a, D(3 downto 1) => v(2 downto 0), Q => w);\n"
     "end architecture a;\n",
     "top.vhd:4:27: error: a part of the port \"D\" is not connected: a model's pins are "
     "open as a whole"},
    {"open part",
     "entity m is  end entity m;\n"
     "architecture a of m is signal a, b : std_logic; signal v, w : std_logic_vector(3 "
     "downto 0);\n"
     "begin\n"
     "u : REG port map (C => a, D(0) => open);\n"
     "end architecture a;\n",
     "top.vhd:4:35: error: a part of the port \"D\" that is open: a model's pins are open "
     "as a whole"},
    {"part of a scalar port",
     "entity m is  end entity m;\n"
     "architecture a of m is signal a, b : std_logic; signal v, w : std_logic_vector(3 "
     "downto 0);\n"
     "begin\n"
     "u : INV port map (I(0) => a, O => b);\n"
     "end architecture a;\n",
     "top.vhd:4:19: error: the port \"I\" has one bit and no range"},
    {"part outside a port",
     "entity m is  end entity m;\n"
     "architecture a of m is signal a, b : std_logic; signal v, w : std_logic_vector(3 "
     "downto 0);\n"
     "begin\n"
     "u : REG port map (D(4) => a);\n"
     "end architecture a;\n",
     "top.vhd:4:20: error: the bit 4 is not within \"D\""},
    {"part against a port",
     "entity m is  end entity m;\n"
     "architecture a of m is signal a, b : std_logic; signal v, w : std_logic_vector(3 "
     "downto 0);\n"
     "begin\n"
     "u : REG port map (D(0 to 1) => v(1 downto 0));\n"
     "end architecture a;\n",
     "top.vhd:4:20: error: the part 0 to 1 runs against its signal \"D\""},
    {"width of a port",
     "entity m is  end entity m;\n"
     "architecture a of m is signal a, b : std_logic; signal v, w : std_logic_vector(3 "
     "downto 0);\n"
     "begin\n"
     "u : REG port map (C => a, D => v(2 downto 0), Q => w);\n"
     "end architecture a;\n",
     "top.vhd:4:32: error: the port \"D\" of \"REG\" takes 4 bits here, and not 3 bits"},
    {"bit at a vector",
     "entity m is  end entity m;\n"
     "architecture a of m is signal a, b : std_logic; signal v, w : std_logic_vector(3 "
     "downto 0);\n"
     "begin\n"
     "u : REG port map (C => v, D => v, Q => w);\n"
     "end architecture a;\n",
     "top.vhd:4:24: error: the port \"C\" of \"REG\" takes one bit here, and not 4 bits"},
    {"constant at an output",
     "entity m is  end entity m;\n"
     "architecture a of m is signal a, b : std_logic; signal v, w : std_logic_vector(3 "
     "downto 0);\n"
     "begin\n"
     "u : INV port map (I => a, O => '1');\n"
     "end architecture a;\n",
     "top.vhd:4:32: error: a constant at the port \"O\", which is no input"},
    {"default value of an open port",
     "entity m is  end entity m;\n"
     "architecture a of m is signal a, b : std_logic; signal v, w : std_logic_vector(3 "
     "downto 0);\n"
     "begin\n"
     "u : TIED port map (I => a, O => b);\n"
     "end architecture a;\n",
     "top.vhd:4:34: error: the port \"E\" is open and has a default value, which a model "
     "cannot say: connect it"},
    {"width of an assignment",
     "entity m is  end entity m;\n"
     "architecture a of m is signal a, b : std_logic; signal v, w : std_logic_vector(3 "
     "downto 0);\n"
     "begin\n"
     "v <= w(2 downto 0);\n"
     "end architecture a;\n",
     "top.vhd:4:6: error: a vector of 3 bits is assigned to a vector of 4 bits"},
    {"bit to vector",
     "entity m is  end entity m;\n"
     "architecture a of m is signal a, b : std_logic; signal v, w : std_logic_vector(3 "
     "downto 0);\n"
     "begin\n"
     "v <= a;\n"
     "end architecture a;\n",
     "top.vhd:4:6: error: a bit is assigned to a vector of 4 bits"},
    {"to itself",
     "entity m is  end entity m;\n"
     "architecture a of m is signal a, b : std_logic; signal v, w : std_logic_vector(3 "
     "downto 0);\n"
     "begin\n"
     "a <= A;\n"
     "end architecture a;\n",
     "top.vhd:4:6: error: \"a\" is assigned to itself"},
    {"two constants",
     "entity m is  end entity m;\n"
     "architecture a of m is signal a, b : std_logic; signal v, w : std_logic_vector(3 "
     "downto 0);\n"
     "begin\n"
     "a <= '0'; a <= '1';\n"
     "end architecture a;\n",
     "top.vhd:4:16: error: \"a\" has a constant already, and a model has one"},
    {"constant on the left",
     "entity m is  end entity m;\n"
     "architecture a of m is signal a, b : std_logic; signal v, w : std_logic_vector(3 "
     "downto 0);\n"
     "begin\n"
     "'0' <= a;\n"
     "end architecture a;\n",
     "top.vhd:4:1: error: an instance or an assignment is expected here, not \"'0'\""},
    {"constant on the left, by name",
     "entity m is  end entity m;\n"
     "architecture a of m is signal a, b : std_logic; signal v, w : std_logic_vector(3 "
     "downto 0); constant c : std_logic := '1';\n"
     "begin\n"
     "c <= a;\n"
     "end architecture a;\n",
     "top.vhd:4:1: error: a constant on the left of an assignment"},
    {"index outside",
     "entity m is  end entity m;\n"
     "architecture a of m is signal a, b : std_logic; signal v, w : std_logic_vector(3 "
     "downto 0);\n"
     "begin\n"
     "a <= v(4);\n"
     "end architecture a;\n",
     "top.vhd:4:7: error: the bit 4 is not within \"v\""},
    {"slice outside",
     "entity m is  end entity m;\n"
     "architecture a of m is signal a, b : std_logic; signal v, w : std_logic_vector(3 "
     "downto 0);\n"
     "begin\n"
     "v(3 downto 2) <= w(5 downto 4);\n"
     "end architecture a;\n",
     "top.vhd:4:19: error: the part 5 downto 4 is not within \"w\""},
    {"slice against",
     "entity m is  end entity m;\n"
     "architecture a of m is signal a, b : std_logic; signal v, w : std_logic_vector(3 "
     "downto 0);\n"
     "begin\n"
     "v(3 downto 2) <= w(0 to 1);\n"
     "end architecture a;\n",
     "top.vhd:4:19: error: the part 0 to 1 runs against its signal \"w\""},
    {"slice without bits",
     "entity m is  end entity m;\n"
     "architecture a of m is signal a, b : std_logic; signal v, w : std_logic_vector(3 "
     "downto 0);\n"
     "begin\n"
     "v(3 downto 2) <= w(0 downto 1);\n"
     "end architecture a;\n",
     "top.vhd:4:19: error: the part 0 downto 1 has no bits"},
    {"index of a scalar",
     "entity m is  end entity m;\n"
     "architecture a of m is signal a, b : std_logic; signal v, w : std_logic_vector(3 "
     "downto 0);\n"
     "begin\n"
     "a <= b(0);\n"
     "end architecture a;\n",
     "top.vhd:4:6: error: \"b\" is a signal of one bit and has no range"},
    {"others without a width",
     "entity m is  end entity m;\n"
     "architecture a of m is signal a, b : std_logic; signal v, w : std_logic_vector(3 "
     "downto 0);\n"
     "begin\n"
     "v <= a & (others => '0');\n"
     "end architecture a;\n",
     "top.vhd:4:11: error: \"others\" where nothing says how many bits there are"},
    {"hole in an aggregate",
     "entity m is  end entity m;\n"
     "architecture a of m is signal a, b : std_logic; signal v, w : std_logic_vector(3 "
     "downto 0);\n"
     "begin\n"
     "v <= (3 => a, 0 => b);\n"
     "end architecture a;\n",
     "top.vhd:4:6: error: an aggregate without a value for each index"},
    {"choice twice",
     "entity m is  end entity m;\n"
     "architecture a of m is signal a, b : std_logic; signal v, w : std_logic_vector(3 "
     "downto 0);\n"
     "begin\n"
     "v <= (3 downto 1 => a, 1 => b, 0 => b);\n"
     "end architecture a;\n",
     "top.vhd:4:24: error: an index that another choice has already"},
    {"number as a value",
     "entity m is  end entity m;\n"
     "architecture a of m is signal a, b : std_logic; signal v, w : std_logic_vector(3 "
     "downto 0);\n"
     "begin\n"
     "v <= (1, 2);\n"
     "end architecture a;\n",
     "top.vhd:4:8: error: \"=>\" is expected here, not \",\""},
    {"index variable",
     "entity m is  end entity m;\n"
     "architecture a of m is signal a, b : std_logic; signal v, w : std_logic_vector(3 "
     "downto 0);\n"
     "begin\n"
     "a <= v(i);\n"
     "end architecture a;\n",
     "top.vhd:4:6: error: an index of \"v\" whose value cannot be told"},
    {"name declared twice",
     "entity m is  end entity m;\n"
     "architecture a of m is signal a, b : std_logic; signal v, w : std_logic_vector(3 "
     "downto 0); signal A : std_logic;\n"
     "begin\n"
     "\n"
     "end architecture a;\n",
     "top.vhd:2:100: error: \"A\" is declared already"},
    {"label like a signal",
     "entity m is  end entity m;\n"
     "architecture a of m is signal a, b : std_logic; signal v, w : std_logic_vector(3 "
     "downto 0);\n"
     "begin\n"
     "a : INV port map (a, b);\n"
     "end architecture a;\n",
     "top.vhd:4:1: error: \"a\" is declared already"},
    {"port depends on a generic",
     "entity m is generic (N : integer := 3); port (d : in std_logic_vector(N downto 0)); "
     "end entity m;\n"
     "architecture a of m is \n"
     "begin\n"
     "\n"
     "end architecture a;\n",
     "top.vhd:1:8: error: the port \"d\" depends on the generic \"N\", which a model "
     "cannot say: write a number"},
    {"signal depends on a generic",
     "entity m is generic (N : integer := 3); end entity m;\n"
     "architecture a of m is signal s : std_logic_vector(N downto 0);\n"
     "begin\n"
     "\n"
     "end architecture a;\n",
     "top.vhd:2:52: error: this depends on the generic \"N\", which a model cannot say: "
     "make it a constant"},
    {"generic without a value",
     "entity m is generic (N : integer); end entity m;\n"
     "architecture a of m is \n"
     "begin\n"
     "\n"
     "end architecture a;\n",
     "top.vhd:1:8: error: the generic \"N\" of the entity has no value that is a literal, "
     "and a model has one"},
    {"default of a port",
     "entity m is port (a : in std_logic := '1'); end entity m;\n"
     "architecture a of m is \n"
     "begin\n"
     "\n"
     "end architecture a;\n",
     "top.vhd:1:8: error: the port \"a\" has a default value, which a model cannot say"},
    {"port type",
     "entity m is port (a : in boolean); end entity m;\n"
     "architecture a of m is \n"
     "begin\n"
     "\n"
     "end architecture a;\n",
     "top.vhd:1:8: error: the port \"a\": the type \"boolean\": a model has bits and "
     "vectors of bits (std_logic, std_ulogic, bit and their vectors)"},
    {"linkage",
     "entity m is port (a : linkage bit); end entity m;\n"
     "architecture a of m is \n"
     "begin\n"
     "\n"
     "end architecture a;\n",
     "top.vhd:1:8: error: the port \"a\": the mode linkage: a model has in, out and inout"},
    {"generic as a value",
     "entity m is generic (N : integer := 3); end entity m;\n"
     "architecture a of m is signal a, b : std_logic; signal v, w : std_logic_vector(3 "
     "downto 0);\n"
     "begin\n"
     "u : REG generic map (W => N) port map (a, v, w);\n"
     "end architecture a;\n",
     "top.vhd:4:27: error: the generic \"N\" as a value: a model passes no generic on but "
     "INIT in a design with MHALVEX in its name"},
    {"part of a generic",
     "entity m is  end entity m;\n"
     "architecture a of m is signal a, b : std_logic; signal v, w : std_logic_vector(3 "
     "downto 0);\n"
     "begin\n"
     "u : REG generic map (INIT(0) => '1') port map (a, v, w);\n"
     "end architecture a;\n",
     "top.vhd:4:22: error: a part of the generic \"INIT\", which no attribute of a model "
     "can be"},
    {"value of a generic",
     "entity m is  end entity m;\n"
     "architecture a of m is signal a, b : std_logic; signal v, w : std_logic_vector(3 "
     "downto 0);\n"
     "begin\n"
     "u : REG generic map (W => foo) port map (a, v, w);\n"
     "end architecture a;\n",
     "top.vhd:4:27: error: the generic \"W\": a value that is no number"},
    {"digits of a generic",
     "entity m is  end entity m;\n"
     "architecture a of m is signal a, b : std_logic; signal v, w : std_logic_vector(3 "
     "downto 0);\n"
     "begin\n"
     "u : REG generic map (INIT => \"0000000X\") port map (a, v, w);\n"
     "end architecture a;\n",
     "top.vhd:4:30: error: the generic \"INIT\": the value 'X': a model has the values 0 "
     "and 1 alone"},
    {"attribute of all",
     "entity m is  end entity m;\n"
     "architecture a of m is signal a, b : std_logic; signal v, w : std_logic_vector(3 "
     "downto 0); attribute k : string; attribute k of all : signal is \"x\";\n"
     "begin\n"
     "\n"
     "end architecture a;\n",
     "top.vhd:2:130: error: an attribute of \"all\": name the objects"},
    {"attribute of an undeclared signal",
     "entity m is  end entity m;\n"
     "architecture a of m is signal a, b : std_logic; signal v, w : std_logic_vector(3 "
     "downto 0); attribute k : string; attribute k of x : signal is \"x\";\n"
     "begin\n"
     "\n"
     "end architecture a;\n",
     "top.vhd:2:130: error: the signal \"x\" is not declared"},
    {"attribute of an undeclared label",
     "entity m is  end entity m;\n"
     "architecture a of m is signal a, b : std_logic; signal v, w : std_logic_vector(3 "
     "downto 0); attribute k : string; attribute k of u9 : label is \"x\";\n"
     "begin\n"
     "\n"
     "end architecture a;\n",
     "top.vhd:2:144: error: the label \"u9\" is not declared"},
    {"value of an attribute",
     "entity m is  end entity m;\n"
     "architecture a of m is attribute k : integer; attribute k of m : entity is \"x\";\n"
     "begin\n"
     "\n"
     "end architecture a;\n",
     "top.vhd:2:76: error: the attribute \"k\": a value that is no number"},
    {"binding to another entity",
     "entity m is  end entity m;\n"
     "architecture a of m is component BOX end component; for all : BOX use entity "
     "work.OTHER;\n"
     "begin\n"
     "u : BOX;\n"
     "end architecture a;\n",
     "top.vhd:2:67: error: a binding of \"BOX\" to \"OTHER\": a model's instances are of "
     "components by name; instantiate \"OTHER\" instead"},
    {"binding that is open",
     "entity m is  end entity m;\n"
     "architecture a of m is component BOX end component; for all : BOX use open;\n"
     "begin\n"
     "u : BOX;\n"
     "end architecture a;\n",
     "top.vhd:2:67: error: the binding \"open\": a model has no configuration that leaves "
     "an instance out"},
    {"reserved word as a name",
     "entity m is  end entity m;\n"
     "architecture a of m is signal wait : std_logic;\n"
     "begin\n"
     "\n"
     "end architecture a;\n",
     "top.vhd:2:31: error: \"wait\" is a reserved word and no name of a signal"},
    {"a name of two levels",
     "entity m is  end entity m;\n"
     "architecture a of m is signal a, b : std_logic; signal v, w : std_logic_vector(3 "
     "downto 0);\n"
     "begin\n"
     "a <= work.p.c;\n"
     "end architecture a;\n",
     "top.vhd:4:6: error: a name of another design unit: a model has one level"},
    {"attribute of a name",
     "entity m is  end entity m;\n"
     "architecture a of m is signal a, b : std_logic; signal v, w : std_logic_vector(3 "
     "downto 0);\n"
     "begin\n"
     "a <= b'delayed;\n"
     "end architecture a;\n",
     "top.vhd:4:6: error: an attribute of \"b\" as a value"},
    {"string without an end",
     "entity m is  end entity m;\n"
     "architecture a of m is signal a, b : std_logic; signal v, w : std_logic_vector(3 "
     "downto 0); attribute k : string; attribute k of a : signal is \"x;\n"
     "begin\n"
     "\n"
     "end architecture a;\n",
     "top.vhd:2:144: error: this string does not end in its line"},
    {"extended identifier without an end",
     "entity m is  end entity m;\n"
     "architecture a of m is signal \\a : std_logic;\n"
     "begin\n"
     "\n"
     "end architecture a;\n",
     "top.vhd:2:31: error: this extended identifier does not end in its line"},
    {"character of no token",
     "entity m is  end entity m;\n"
     "architecture a of m is signal a$b : std_logic;\n"
     "begin\n"
     "\n"
     "end architecture a;\n",
     "top.vhd:2:32: error: \":\" is expected here, not \"$\""},
    {"number that letters follow",
     "entity m is  end entity m;\n"
     "architecture a of m is signal a : std_logic_vector(3x downto 0);\n"
     "begin\n"
     "\n"
     "end architecture a;\n",
     "top.vhd:2:52: error: a number that letters follow"},
    {"missing semicolon",
     "entity m is  end entity m;\n"
     "architecture a of m is signal a, b : std_logic; signal v, w : std_logic_vector(3 "
     "downto 0);\n"
     "begin\n"
     "a <= b v <= w;\n"
     "end architecture a;\n",
     "top.vhd:4:8: error: \";\" is expected here, not \"v\""},
    {"no end of architecture",
     "entity m is end; architecture a of m is signal s : std_logic; begin s <= s2;",
     "top.vhd:1:74: error: the signal \"s2\" is not declared"},
    {"no end of entity", "entity m is port (a : in bit);",
     "top.vhd:1:1: error: \"end\" does not follow this"},
    {"no begin", "entity m is end; architecture a of m is signal s : std_logic;",
     "top.vhd:1:31: error: \"begin\" does not follow this"},
    {"architecture without entity", "architecture a of m is begin end;",
     "top.vhd:1:14: error: the entity \"m\" of this architecture is not in front of it"},
    {"two tops",
     "entity m is end; architecture a of m is begin end; entity n is end; architecture a "
     "of n is begin end;",
     "top.vhd: error: no entity instantiates \"m\", \"n\": say which one to read"},
    {"no top", "entity m is end;",
     "top.vhd: error: there is no entity that no other one instantiates"},
    {"entity twice", "entity m is end; entity M is end;",
     "top.vhd:1:25: error: \"M\" is declared already, in top.vhd:1:8"},
    {"context reference", "context lib.ctx; entity m is end; architecture a of m is begin end;",
     "top.vhd:1:1: error: a context reference: a model has library and use clauses; write "
     "them here"},
    {"no design unit", "module m; endmodule",
     "top.vhd:1:1: error: a design unit is expected here, not \"module\""},
    {"configuration with another binding",
     "entity m is end; architecture a of m is component B end component; begin u : B; end; "
     "configuration c of m is for a for u : B use entity work.C(x); end for; end for; end "
     "c;",
     "top.vhd:1:126: error: a binding of \"B\" to \"C\": a model's instances are of "
     "components by name; instantiate \"C\" instead"},
    {"configuration with a port map",
     "entity m is end; architecture a of m is component B end component; begin u : B; end; "
     "configuration c of m is for a for u : B use entity work.B port map (x => y); end "
     "for; end for; end c;",
     "top.vhd:1:126: error: a binding with a generic map or a port map: a model has those "
     "of instances alone"},
    {"component and entity differ",
     "entity B is port (x : in bit); end; entity m is end; architecture a of m is "
     "component B end component; signal s : bit; begin u : B; v : entity work.B port map "
     "(s); end;",
     "top.vhd:1:137: error: the component and the entity \"B\" have different ports, and a "
     "model has one of both"},
    {"empty port list", "entity m is port ( ); end;",
     "top.vhd:1:20: error: an empty list of ports, which VHDL does not have: leave it out"},
    {"comment without an end", "entity m is end; /* comment",
     "top.vhd:1:18: error: this comment does not end"},
};

TEST(VhdlErrors, NameThePlaceAndTheReason) {
    for (const Refused& refused : Table) {
        SCOPED_TRACE(refused.what);
        VhdlTextReader text;
        text.model.AddSignal("former");
        const std::string failure = text.GetFailure(refused.text);
        EXPECT_EQ(failure.substr(0, failure.find('\n')), refused.message);
        EXPECT_NE(text.model.GetSignal("former"), nullptr);
    }
}

TEST(VhdlErrors, ShowTheLineAndTheColumn) {
    VhdlTextReader text;
    EXPECT_EQ(
        text.GetFailure("entity m is end;\narchitecture a of m is\nbegin\n  a <= 'X';\nend;\n"),
        "top.vhd:4:3: error: the signal \"a\" is not declared\n  a <= 'X';\n  ^\n");
}

TEST(VhdlErrors, AreWholeWhereTheyQuoteANul) {
    VhdlTextReader text;
    const std::string failure =
        text.GetFailure(std::string("entity m is end;\n"
                                    "architecture a of m is signal v : bit_vector(1 downto 0);\n"
                                    "begin\n  v <= \"1") +
                        '\0' + "\";\nend;\n");
    EXPECT_EQ(failure, "top.vhd:4:8: error: the value ' ': a model has the values 0 and 1 alone\n"
                       "  v <= \"1 \";\n       ^\n");
}

TEST(VhdlErrors, OfTheFileAsAWhole) {
    VhdlTextReader text;
    EXPECT_EQ(text.GetFailure(""),
              "top.vhd: error: there is no entity that no other one instantiates\n");
    text.reader.SetTop("other");
    EXPECT_EQ(text.GetFailure(""), "top.vhd: error: there is no entity \"other\"\n");
    text.reader.AddLibrary(text.GetPath("none.vhd").c_str());
    EXPECT_EQ(text.GetFailure(""),
              "none.vhd: error: the file cannot be read: No such file or directory\n");
}

} // namespace
