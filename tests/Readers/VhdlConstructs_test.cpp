// What the VHDL reader accepts, and what becomes of it.
#include "Readers/ReadText.h"

#include <gtest/gtest.h>

#include <string>

namespace {

using Support::VhdlTextReader;

struct Accepted {
    const char* what;
    const char* ports;
    const char* declarations;
    const char* statements;
    /// The lines that the model is written in, each blank a single one.
    const char* written;
};

/// The lines that are not empty, without blanks around them and with single ones inside.
std::string Essence(const std::string& text) {
    std::string result;
    for (const std::string& line : Support::SplitLines(text)) {
        std::string essence;
        for (const char c : line) {
            if (c != ' ' || (!essence.empty() && essence.back() != ' ')) {
                essence += c;
            }
        }
        essence.erase(essence.find_last_not_of(' ') + 1);
        result += essence.empty() ? "" : essence + "\n";
    }
    return result;
}

constexpr Accepted Table[] = {
    {"entity without ports", "", "", "",
     "entity m is\n"
     "port ( );\n"
     "end m;\n"
     "architecture BEHAVIORAL of m is\n"
     "begin\n"
     "end BEHAVIORAL;\n"},
    {"ports of all types and modes",
     "port (A, B : std_logic; C : in STD_ULOGIC; signal D : out bit; E : inout "
     "std_logic_vector(7 downto 0); F : buffer bit_vector(0 to 3); G : in "
     "ieee.std_logic_1164.std_ulogic_vector(2 downto 2));",
     "", "",
     "entity m is\n"
     "port ( A : in std_logic;\n"
     "B : in std_logic;\n"
     "C : in std_logic;\n"
     "G : in std_logic_vector (2 downto 2);\n"
     "D : out std_logic;\n"
     "F : out std_logic_vector (0 to 3);\n"
     "E : inout std_logic_vector (7 downto 0));\n"
     "end m;\n"
     "architecture BEHAVIORAL of m is\n"
     "begin\n"
     "end BEHAVIORAL;\n"},
    {"ranges from constants and arithmetic", "",
     "constant N : natural := 16#A#; constant M, L : integer := 2**3 - N / 5; signal s : "
     "std_logic_vector(N - 1 downto 0); signal t : std_logic_vector(M + 1 to (N * 2));",
     "",
     "entity m is\n"
     "port ( );\n"
     "end m;\n"
     "architecture BEHAVIORAL of m is\n"
     "signal s : std_logic_vector (9 downto 0);\n"
     "signal t : std_logic_vector (7 to 20);\n"
     "begin\n"
     "end BEHAVIORAL;\n"},
    {"signals, slices, bits and concatenations",
     "port (d : in std_logic_vector(7 downto 0); q : out std_logic_vector(7 downto 0));",
     "signal a, b : std_logic; signal v : std_logic_vector(0 to 3);",
     "q(7) <= a; q(6 downto 5) <= d(3 downto 2); b <= d(0); v <= q(4 downto 3) & a & d(7); "
     "q(4 downto 0) <= d(6 downto 4)(5 downto 4) & v(1 to 2) & V(3);",
     "entity m is\n"
     "port ( d : in std_logic_vector (7 downto 0);\n"
     "q : out std_logic_vector (7 downto 0));\n"
     "end m;\n"
     "architecture BEHAVIORAL of m is\n"
     "signal a : std_logic;\n"
     "signal b : std_logic;\n"
     "signal v : std_logic_vector (0 to 3);\n"
     "begin\n"
     "b <= d(0);\n"
     "v(0) <= q(4);\n"
     "v(1) <= q(3);\n"
     "v(2) <= a;\n"
     "v(3) <= d(7);\n"
     "q(4) <= d(5);\n"
     "q(3) <= d(4);\n"
     "q(2) <= v(1);\n"
     "q(1) <= v(2);\n"
     "q(0) <= v(3);\n"
     "q(6 downto 5) <= d(3 downto 2);\n"
     "q(7) <= a;\n"
     "end BEHAVIORAL;\n"},
    {"a labelled assignment, aggregates as targets", "",
     "signal a, b : std_logic; signal v, w : std_logic_vector(1 downto 0);",
     "l1 : a <= b; l2 : (a, b) <= v; (w, b) <= v & a;",
     "entity m is\n"
     "port ( );\n"
     "end m;\n"
     "architecture BEHAVIORAL of m is\n"
     "signal a : std_logic;\n"
     "signal b : std_logic;\n"
     "signal v : std_logic_vector (1 downto 0);\n"
     "signal w : std_logic_vector (1 downto 0);\n"
     "begin\n"
     "a <= b;\n"
     "a <= v(1);\n"
     "b <= v(0);\n"
     "w(1) <= v(1);\n"
     "w(0) <= v(0);\n"
     "b <= a;\n"
     "end BEHAVIORAL;\n"},
    {"literals", "",
     "signal a, b : std_logic; signal v, w, x : std_logic_vector(7 downto 0); signal o : "
     "std_logic_vector(5 downto 0); signal d : std_logic_vector(0 to 3);",
     "a <= '0'; b <= std_logic'('1'); v <= \"00000000\"; w <= X\"A5\"; x <= "
     "b\"0101_1010\"; o <= O\"17\"; d <= 4D\"9\";",
     "entity m is\n"
     "port ( );\n"
     "end m;\n"
     "architecture BEHAVIORAL of m is\n"
     "signal a : std_logic;\n"
     "signal b : std_logic;\n"
     "signal d : std_logic_vector (0 to 3);\n"
     "signal o : std_logic_vector (5 downto 0);\n"
     "signal v : std_logic_vector (7 downto 0);\n"
     "signal w : std_logic_vector (7 downto 0);\n"
     "signal x : std_logic_vector (7 downto 0);\n"
     "begin\n"
     "a <= '0';\n"
     "b <= '1';\n"
     "d(0 to 3) <= b\"1001\";\n"
     "o(5 downto 0) <= o\"17\";\n"
     "v(7 downto 0) <= b\"00000000\";\n"
     "w(7 downto 0) <= x\"A5\";\n"
     "x(7 downto 0) <= b\"01011010\";\n"
     "end BEHAVIORAL;\n"},
    {"sized and signed bit strings of 2008", "",
     "signal a, b, c : std_logic_vector(9 downto 0); signal d : std_logic_vector(2 downto "
     "0);",
     "a <= 10UX\"A5\"; b <= 10SX\"A5\"; c <= 10b\"11\"; d <= 3x\"7\";",
     "entity m is\n"
     "port ( );\n"
     "end m;\n"
     "architecture BEHAVIORAL of m is\n"
     "signal a : std_logic_vector (9 downto 0);\n"
     "signal b : std_logic_vector (9 downto 0);\n"
     "signal c : std_logic_vector (9 downto 0);\n"
     "signal d : std_logic_vector (2 downto 0);\n"
     "begin\n"
     "a(9 downto 0) <= b\"0010100101\";\n"
     "b(9 downto 0) <= b\"1110100101\";\n"
     "c(9 downto 0) <= b\"0000000011\";\n"
     "d(2 downto 0) <= b\"111\";\n"
     "end BEHAVIORAL;\n"},
    {"aggregates", "",
     "signal a : std_logic; signal v, w, x, y, z, n : std_logic_vector(3 downto 0); signal "
     "u : std_logic_vector(0 to 3); signal t : std_logic_vector(7 downto 0);",
     "v <= (others => '0'); w <= ('1', a, others => '0'); x <= (3 => a, 1 downto 0 => '1', "
     "others => v(0)); u <= (3 => '1', 2 => a, 0 | 1 => '0'); y <= (v(0), v(1), v(2), "
     "v(3)); z <= (2 => a, 3 => '1', 0 to 1 => a); n <= (v(3 downto 2), a, '1'); t <= (7 "
     "downto 6 => w(1 downto 0), others => a);",
     "entity m is\n"
     "port ( );\n"
     "end m;\n"
     "architecture BEHAVIORAL of m is\n"
     "signal a : std_logic;\n"
     "signal const_0 : std_logic;\n"
     "signal const_1 : std_logic;\n"
     "signal n : std_logic_vector (3 downto 0);\n"
     "signal t : std_logic_vector (7 downto 0);\n"
     "signal u : std_logic_vector (0 to 3);\n"
     "signal v : std_logic_vector (3 downto 0);\n"
     "signal w : std_logic_vector (3 downto 0);\n"
     "signal x : std_logic_vector (3 downto 0);\n"
     "signal y : std_logic_vector (3 downto 0);\n"
     "signal z : std_logic_vector (3 downto 0);\n"
     "begin\n"
     "const_0 <= '0';\n"
     "const_1 <= '1';\n"
     "v(3 downto 0) <= b\"0000\";\n"
     "n(3) <= v(3);\n"
     "n(2) <= v(2);\n"
     "n(1) <= a;\n"
     "n(0) <= const_1;\n"
     "t(7) <= w(1);\n"
     "t(6) <= w(0);\n"
     "t(5) <= a;\n"
     "t(4) <= a;\n"
     "t(3) <= a;\n"
     "t(2) <= a;\n"
     "t(1) <= a;\n"
     "t(0) <= a;\n"
     "u(0) <= const_0;\n"
     "u(1) <= const_0;\n"
     "u(2) <= a;\n"
     "u(3) <= const_1;\n"
     "w(3) <= const_1;\n"
     "w(2) <= a;\n"
     "w(1) <= const_0;\n"
     "w(0) <= const_0;\n"
     "x(3) <= a;\n"
     "x(2) <= v(0);\n"
     "x(1) <= const_1;\n"
     "x(0) <= const_1;\n"
     "y(3) <= v(0);\n"
     "y(2) <= v(1);\n"
     "y(1) <= v(2);\n"
     "y(0) <= v(3);\n"
     "z(3) <= const_1;\n"
     "z(2) <= a;\n"
     "z(1) <= a;\n"
     "z(0) <= a;\n"
     "end BEHAVIORAL;\n"},
    {"parentheses, qualified expressions and conversions", "",
     "signal a, b : std_logic; signal v, w : std_logic_vector(1 downto 0);",
     "a <= (b); v <= std_logic_vector'(\"01\"); w <= std_logic_vector(v(1) & b);",
     "entity m is\n"
     "port ( );\n"
     "end m;\n"
     "architecture BEHAVIORAL of m is\n"
     "signal a : std_logic;\n"
     "signal b : std_logic;\n"
     "signal v : std_logic_vector (1 downto 0);\n"
     "signal w : std_logic_vector (1 downto 0);\n"
     "begin\n"
     "v(1 downto 0) <= b\"01\";\n"
     "a <= b;\n"
     "w(1) <= v(1);\n"
     "w(0) <= b;\n"
     "end BEHAVIORAL;\n"},
    {"constants and aliases", "",
     "constant C : std_logic_vector(3 downto 0) := \"0110\"; constant U : std_logic_vector "
     ":= X\"F\"; constant Z : std_logic := '0'; signal v : std_logic_vector(7 downto 0); "
     "signal w : std_logic_vector(3 downto 0); signal s, t, y : std_logic; alias A : "
     "std_logic_vector(3 downto 0) is v(7 downto 4); alias B is v(0); alias R : "
     "std_logic_vector(0 to 1) is v(3 downto 2); alias K : std_logic is s;",
     "w <= C(3 downto 1) & Z; A <= U; t <= B; R(0) <= C(2); R(1) <= K; y <= a(7-4);",
     "entity m is\n"
     "port ( );\n"
     "end m;\n"
     "architecture BEHAVIORAL of m is\n"
     "signal s : std_logic;\n"
     "signal t : std_logic;\n"
     "signal v : std_logic_vector (7 downto 0);\n"
     "signal w : std_logic_vector (3 downto 0);\n"
     "signal y : std_logic;\n"
     "begin\n"
     "v(3) <= '1';\n"
     "v(7 downto 4) <= b\"1111\";\n"
     "w(3 downto 0) <= b\"0110\";\n"
     "t <= v(0);\n"
     "v(2) <= s;\n"
     "y <= v(7);\n"
     "end BEHAVIORAL;\n"},
    {"instances by name, in any order and letter case",
     "port (X : in std_logic; Y : out std_logic);",
     "signal n : std_logic; signal d, q : std_logic_vector(3 downto 0);",
     "u1 : inv port map (o => N, i => x); U2 : component cells.INV port map (I => n, O => "
     "Y); u3 : work.cells.reg port map (C => X, D => D, Q => open);",
     "entity m is\n"
     "port ( X : in std_logic;\n"
     "Y : out std_logic);\n"
     "end m;\n"
     "architecture BEHAVIORAL of m is\n"
     "signal d : std_logic_vector (3 downto 0);\n"
     "signal n : std_logic;\n"
     "signal q : std_logic_vector (3 downto 0);\n"
     "begin\n"
     "u1 : INV\n"
     "port map (I=>X,\n"
     "O=>n);\n"
     "U2 : INV\n"
     "port map (I=>n,\n"
     "O=>Y);\n"
     "u3 : REG\n"
     "generic map( W => 4,\n"
     "INIT => x\"00\",\n"
     "NAME => \"none\")\n"
     "port map (C=>X,\n"
     "D(3 downto 0)=>d(3 downto 0),\n"
     "Q=>open);\n"
     "end BEHAVIORAL;\n"},
    {"instances by position", "port (X : in std_logic; Y : out std_logic);",
     "signal d, q : std_logic_vector(3 downto 0);",
     "u1 : INV port map (X, Y); u2 : REG port map (d(3), \"1010\", open); u3 : REG port "
     "map (d(0), d(3 downto 0), Q => q);",
     "entity m is\n"
     "port ( X : in std_logic;\n"
     "Y : out std_logic);\n"
     "end m;\n"
     "architecture BEHAVIORAL of m is\n"
     "signal d : std_logic_vector (3 downto 0);\n"
     "signal q : std_logic_vector (3 downto 0);\n"
     "signal u2_D_CONST_SIGNAL : std_logic_vector (3 downto 0);\n"
     "begin\n"
     "u2_D_CONST_SIGNAL(3 downto 0) <= b\"1010\";\n"
     "u1 : INV\n"
     "port map (I=>X,\n"
     "O=>Y);\n"
     "u2 : REG\n"
     "generic map( W => 4,\n"
     "INIT => x\"00\",\n"
     "NAME => \"none\")\n"
     "port map (C=>d(3),\n"
     "D(3 downto 0)=>u2_D_CONST_SIGNAL(3 downto 0),\n"
     "Q=>open);\n"
     "u3 : REG\n"
     "generic map( W => 4,\n"
     "INIT => x\"00\",\n"
     "NAME => \"none\")\n"
     "port map (C=>d(0),\n"
     "D(3 downto 0)=>d(3 downto 0),\n"
     "Q(3 downto 0)=>q(3 downto 0));\n"
     "end BEHAVIORAL;\n"},
    {"parts of formals", "", "signal a, b : std_logic; signal v, q : std_logic_vector(3 downto 0);",
     "u1 : REG port map (C => a, D(0) => b, D(3 downto 2) => v(1 downto 0), D(1) => '1', "
     "Q(3) => q(0), Q(2 downto 0) => q(3 downto 1)); u2 : ONE port map (I(0) => a, O(2) => "
     "b); u3 : ONE port map (I => v(0 downto 0), O => q(1 downto 1)); u4 : REG port map (C "
     "=> '1', D(3 downto 2) => \"01\", D(1 downto 0) => (others => '1'), Q => q);",
     "entity m is\n"
     "port ( );\n"
     "end m;\n"
     "architecture BEHAVIORAL of m is\n"
     "signal a : std_logic;\n"
     "signal b : std_logic;\n"
     "signal const_1 : std_logic;\n"
     "signal q : std_logic_vector (3 downto 0);\n"
     "signal u4_C_CONST_SIGNAL : std_logic;\n"
     "signal u4_D_CONST_SIGNAL : std_logic_vector (3 downto 0);\n"
     "signal v : std_logic_vector (3 downto 0);\n"
     "begin\n"
     "const_1 <= '1';\n"
     "u4_C_CONST_SIGNAL <= '1';\n"
     "u4_D_CONST_SIGNAL(3 downto 0) <= b\"0111\";\n"
     "u1 : REG\n"
     "generic map( W => 4,\n"
     "INIT => x\"00\",\n"
     "NAME => \"none\")\n"
     "port map (C=>a,\n"
     "D(3 downto 2)=>v(1 downto 0),\n"
     "D(1)=>const_1,\n"
     "D(0)=>b,\n"
     "Q(3)=>q(0),\n"
     "Q(2 downto 0)=>q(3 downto 1));\n"
     "u2 : ONE\n"
     "port map (I(0)=>a,\n"
     "O(2)=>b);\n"
     "u3 : ONE\n"
     "port map (I(0)=>v(0),\n"
     "O(2)=>q(1));\n"
     "u4 : REG\n"
     "generic map( W => 4,\n"
     "INIT => x\"00\",\n"
     "NAME => \"none\")\n"
     "port map (C=>u4_C_CONST_SIGNAL,\n"
     "D(3 downto 0)=>u4_D_CONST_SIGNAL(3 downto 0),\n"
     "Q(3 downto 0)=>q(3 downto 0));\n"
     "end BEHAVIORAL;\n"},
    {"actuals: aggregates, concatenations, literals", "",
     "signal a, b : std_logic; signal v, q : std_logic_vector(3 downto 0);",
     "u1 : REG port map (C => '0', D => (a, b, '0', '1'), Q => q); u2 : REG port map (C => "
     "a, D => a & v(2 downto 0), Q => open); u3 : REG port map (C => a, D => (3 => a, "
     "others => '0'), Q => open); u4 : REG port map (C => a, D => X\"C\", Q => open); u5 : "
     "REG port map (C => std_logic'('1'), D => std_logic_vector'(\"0011\"), Q => open);",
     "entity m is\n"
     "port ( );\n"
     "end m;\n"
     "architecture BEHAVIORAL of m is\n"
     "signal a : std_logic;\n"
     "signal b : std_logic;\n"
     "signal const_0 : std_logic;\n"
     "signal const_1 : std_logic;\n"
     "signal q : std_logic_vector (3 downto 0);\n"
     "signal u1_C_CONST_SIGNAL : std_logic;\n"
     "signal u4_D_CONST_SIGNAL : std_logic_vector (3 downto 0);\n"
     "signal u5_C_CONST_SIGNAL : std_logic;\n"
     "signal u5_D_CONST_SIGNAL : std_logic_vector (3 downto 0);\n"
     "signal v : std_logic_vector (3 downto 0);\n"
     "begin\n"
     "const_0 <= '0';\n"
     "const_1 <= '1';\n"
     "u1_C_CONST_SIGNAL <= '0';\n"
     "u4_D_CONST_SIGNAL(3 downto 0) <= x\"C\";\n"
     "u5_C_CONST_SIGNAL <= '1';\n"
     "u5_D_CONST_SIGNAL(3 downto 0) <= b\"0011\";\n"
     "u1 : REG\n"
     "generic map( W => 4,\n"
     "INIT => x\"00\",\n"
     "NAME => \"none\")\n"
     "port map (C=>u1_C_CONST_SIGNAL,\n"
     "D(3)=>a,\n"
     "D(2)=>b,\n"
     "D(1)=>const_0,\n"
     "D(0)=>const_1,\n"
     "Q(3 downto 0)=>q(3 downto 0));\n"
     "u2 : REG\n"
     "generic map( W => 4,\n"
     "INIT => x\"00\",\n"
     "NAME => \"none\")\n"
     "port map (C=>a,\n"
     "D(3)=>a,\n"
     "D(2 downto 0)=>v(2 downto 0),\n"
     "Q=>open);\n"
     "u3 : REG\n"
     "generic map( W => 4,\n"
     "INIT => x\"00\",\n"
     "NAME => \"none\")\n"
     "port map (C=>a,\n"
     "D(3)=>a,\n"
     "D(2)=>const_0,\n"
     "D(1)=>const_0,\n"
     "D(0)=>const_0,\n"
     "Q=>open);\n"
     "u4 : REG\n"
     "generic map( W => 4,\n"
     "INIT => x\"00\",\n"
     "NAME => \"none\")\n"
     "port map (C=>a,\n"
     "D(3 downto 0)=>u4_D_CONST_SIGNAL(3 downto 0),\n"
     "Q=>open);\n"
     "u5 : REG\n"
     "generic map( W => 4,\n"
     "INIT => x\"00\",\n"
     "NAME => \"none\")\n"
     "port map (C=>u5_C_CONST_SIGNAL,\n"
     "D(3 downto 0)=>u5_D_CONST_SIGNAL(3 downto 0),\n"
     "Q=>open);\n"
     "end BEHAVIORAL;\n"},
    {"direct instantiation of entities", "",
     "signal v : std_logic_vector(0 to 3); signal p : std_logic;",
     "u1 : entity work.UP(rtl) port map (v, p); u2 : entity UP port map (P => p, A => v);",
     "entity m is\n"
     "port ( );\n"
     "end m;\n"
     "architecture BEHAVIORAL of m is\n"
     "signal p : std_logic;\n"
     "signal v : std_logic_vector (0 to 3);\n"
     "component UP\n"
     "port ( A : in std_logic_vector (0 to 3);\n"
     "P : inout std_logic);\n"
     "end component;\n"
     "begin\n"
     "u1 : UP\n"
     "port map (A(0 to 3)=>v(0 to 3),\n"
     "P=>p);\n"
     "u2 : UP\n"
     "port map (A(0 to 3)=>v(0 to 3),\n"
     "P=>p);\n"
     "end BEHAVIORAL;\n"},
    {"generic maps", "",
     "signal c : std_logic; signal d, q : std_logic_vector(3 downto 0); constant N : "
     "integer := 3;",
     "u1 : REG generic map (W => 8, INIT => X\"FF\", NAME => \"a\"\"b\" & \"c\") port map "
     "(c, d, open); u2 : REG generic map (N + 4, \"00000001\") port map (c, d, open); u3 : "
     "REG generic map (INIT => X\"00\", NAME => open) port map (c, d, open); u4 : REG "
     "generic map (W => -1) port map (c, d, open);",
     "entity m is\n"
     "port ( );\n"
     "end m;\n"
     "architecture BEHAVIORAL of m is\n"
     "signal c : std_logic;\n"
     "signal d : std_logic_vector (3 downto 0);\n"
     "signal q : std_logic_vector (3 downto 0);\n"
     "begin\n"
     "u1 : REG\n"
     "generic map( W => 8,\n"
     "INIT => x\"FF\",\n"
     "NAME => \"a\"bc\")\n"
     "port map (C=>c,\n"
     "D(3 downto 0)=>d(3 downto 0),\n"
     "Q=>open);\n"
     "u2 : REG\n"
     "generic map( W => 7,\n"
     "INIT => b\"00000001\",\n"
     "NAME => \"none\")\n"
     "port map (C=>c,\n"
     "D(3 downto 0)=>d(3 downto 0),\n"
     "Q=>open);\n"
     "u3 : REG\n"
     "generic map( W => 4,\n"
     "INIT => x\"00\",\n"
     "NAME => \"none\")\n"
     "port map (C=>c,\n"
     "D(3 downto 0)=>d(3 downto 0),\n"
     "Q=>open);\n"
     "u4 : REG\n"
     "generic map( W => -1,\n"
     "INIT => x\"00\",\n"
     "NAME => \"none\")\n"
     "port map (C=>c,\n"
     "D(3 downto 0)=>d(3 downto 0),\n"
     "Q=>open);\n"
     "end BEHAVIORAL;\n"},
    {"an instance without a port map, and ports without a connection", "", "",
     "u1 : INV; u2 : INV port map (O => open, I => open);",
     "entity m is\n"
     "port ( );\n"
     "end m;\n"
     "architecture BEHAVIORAL of m is\n"
     "begin\n"
     "u1 : INV\n"
     "port map (I=>open,\n"
     "O=>open);\n"
     "u2 : INV\n"
     "port map (I=>open,\n"
     "O=>open);\n"
     "end BEHAVIORAL;\n"},
    {"components of the architecture", "",
     "component BOX generic (T : time := 1 ns; S : SPEED := FAST; R : real := 1.5e-1; B : "
     "boolean := true; Z : std_logic := '1'; V : std_logic_vector(1 downto 0) := \"10\"); "
     "port (I : in bit; Q : out bit); end component; signal a, b : std_logic; for all : "
     "BOX use entity work.BOX(rtl);",
     "u1 : BOX port map (a, b); u2 : BOX generic map (T => 2.5 ns, S => SLOW, R => 2.0, B "
     "=> FALSE, Z => '0', V => b\"01\") port map (b, a);",
     "entity m is\n"
     "port ( );\n"
     "end m;\n"
     "architecture BEHAVIORAL of m is\n"
     "signal a : std_logic;\n"
     "signal b : std_logic;\n"
     "component BOX\n"
     "generic( T : time := 1 ns;\n"
     "S : SPEED := FAST;\n"
     "R : real := 0.15;\n"
     "B : boolean := TRUE;\n"
     "Z : bit := '1';\n"
     "V : bit_vector := b\"10\");\n"
     "port ( I : in std_logic;\n"
     "Q : out std_logic);\n"
     "end component;\n"
     "begin\n"
     "u1 : BOX\n"
     "generic map( T => 1 ns,\n"
     "S => FAST,\n"
     "R => 0.15,\n"
     "B => TRUE,\n"
     "Z => '1',\n"
     "V => b\"10\")\n"
     "port map (I=>a,\n"
     "Q=>b);\n"
     "u2 : BOX\n"
     "generic map( T => 2.5 ns,\n"
     "S => SLOW,\n"
     "R => 2.0,\n"
     "B => FALSE,\n"
     "Z => '0',\n"
     "V => b\"01\")\n"
     "port map (I=>b,\n"
     "Q=>a);\n"
     "end BEHAVIORAL;\n"},
    {"attributes", "port (X : in std_logic);",
     "attribute KEEP : string; attribute N : integer; attribute F : real; attribute OK : "
     "boolean; attribute V : bit_vector(0 to 3); attribute K : kind; attribute keep of x : "
     "signal is \"yes\"; signal s : std_logic_vector(1 downto 0); attribute N of s : "
     "signal is 5; attribute F of u1, u2 : label is 2.50; attribute OK of u2 : label is "
     "true; attribute V of u2 : label is X\"A\"; attribute K of u2 : label is some_kind; "
     "attribute KEEP of INV : component is \"c\"; attribute loc of U1 : label is \"P1\"; "
     "attribute KEEP of m : entity is \"e\"; attribute KEEP of a : architecture is \"e\"; "
     "constant C : integer := 1; attribute KEEP of C : constant is \"c\";",
     "u1 : INV port map (X, s(0)); u2 : INV port map (X, s(1));",
     "entity m is\n"
     "port ( X : in std_logic);\n"
     "attribute keep : string ;\n"
     "attribute keep of X : signal is \"yes\";\n"
     "end m;\n"
     "architecture BEHAVIORAL of m is\n"
     "attribute N : integer ;\n"
     "attribute F : real ;\n"
     "attribute OK : boolean ;\n"
     "attribute V : bit_vector ;\n"
     "attribute K : kind ;\n"
     "signal s : std_logic_vector (1 downto 0);\n"
     "attribute N of s : signal is 5;\n"
     "attribute F of u1 : label is 2.50;\n"
     "attribute loc of u1 : label is \"P1\";\n"
     "attribute F of u2 : label is 2.50;\n"
     "attribute OK of u2 : label is TRUE;\n"
     "attribute V of u2 : label is x\"A\";\n"
     "attribute K of u2 : label is some_kind;\n"
     "begin\n"
     "u1 : INV\n"
     "port map (I=>X,\n"
     "O=>s(0));\n"
     "u2 : INV\n"
     "port map (I=>X,\n"
     "O=>s(1));\n"
     "end BEHAVIORAL;\n"},
    {"extended identifiers", "port (\\a b\\ : in std_logic);",
     "signal \\signal\\, \\abc\\, abc, \\ABC\\, \\x\\\\y\\ : std_logic; signal \\d[0]\\ : "
     "std_logic_vector(1 downto 0);",
     "\\abc\\ <= \\a b\\; ABC <= \\ABC\\; \\signal\\ <= \\d[0]\\(1); \\u/1\\ : INV port "
     "map (I => \\x\\\\y\\, O => \\d[0]\\(0));",
     "entity m is\n"
     "port ( a_b : in std_logic);\n"
     "end m;\n"
     "architecture BEHAVIORAL of m is\n"
     "signal abc : std_logic;\n"
     "signal abc_2 : std_logic;\n"
     "signal ABC_3 : std_logic;\n"
     "signal d_0 : std_logic_vector (1 downto 0);\n"
     "signal signal_2 : std_logic;\n"
     "signal x_y : std_logic;\n"
     "begin\n"
     "abc <= a_b;\n"
     "abc_2 <= ABC_3;\n"
     "signal_2 <= d_0(1);\n"
     "u_1 : INV\n"
     "port map (I=>x_y,\n"
     "O=>d_0(0));\n"
     "end BEHAVIORAL;\n"},
    {"words that IEEE 1076-2008 reserves", "", "signal default, context, property : std_logic;",
     "default <= context;",
     "entity m is\n"
     "port ( );\n"
     "end m;\n"
     "architecture BEHAVIORAL of m is\n"
     "signal context : std_logic;\n"
     "signal default : std_logic;\n"
     "signal property : std_logic;\n"
     "begin\n"
     "default <= context;\n"
     "end BEHAVIORAL;\n"},
    {"subtypes, as GHDL declares them", "port (d : in std_logic_vector(1 downto 0));",
     "subtype typwrap_d is std_logic_vector(1 downto 0); signal wrap_d : TYPWRAP_D;\n"
     "subtype unused is integer range 0 to 3; subtype b is std_logic; signal s : b;",
     "wrap_d <= d; s <= wrap_d(0);",
     "entity m is\nport ( d : in std_logic_vector (1 downto 0));\nend m;\n"
     "architecture BEHAVIORAL of m is\nsignal s : std_logic;\n"
     "signal wrap_d : std_logic_vector (1 downto 0);\nbegin\ns <= wrap_d(0);\n"
     "wrap_d(1 downto 0) <= d(1 downto 0);\nend BEHAVIORAL;\n"},
    {"block comments, and character literals that look like ends", "",
     "signal a : std_logic; /* a ; block \n"
     " comment */ attribute A1 : string; attribute A1 of a : signal is \"; -- "
     "\"\"none\"\"\";",
     "a <= '0'; -- ';'",
     "entity m is\n"
     "port ( );\n"
     "end m;\n"
     "architecture BEHAVIORAL of m is\n"
     "attribute A1 : string ;\n"
     "signal a : std_logic;\n"
     "attribute A1 of a : signal is \"; -- \"none\"\";\n"
     "begin\n"
     "a <= '0';\n"
     "end BEHAVIORAL;\n"},
};

TEST(VhdlConstructs, AreReadAndWritten) {
    for (const Accepted& accepted : Table) {
        SCOPED_TRACE(accepted.what);
        VhdlTextReader text;
        const std::string failure = text.GetFailure(
            std::string("library ieee;\nuse ieee.std_logic_1164.all;\nentity m is ") +
            accepted.ports + " end entity m;\narchitecture a of m is " + accepted.declarations +
            "\nbegin\n" + accepted.statements + "\nend architecture a;\n");
        EXPECT_EQ(failure, "");
        EXPECT_EQ(Essence(text.Write()), accepted.written);
    }
}

} // namespace
