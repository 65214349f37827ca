-- package: functions of the word-level cells.
library ieee;
use ieee.std_logic_1164.all;

package orn_hdl_cells is
   -- A parameter as a number; one of 32 bits is signed.
   function number (value : bit_vector) return integer;
   -- A number as a parameter.
   function bits_of (value : integer) return bit_vector;
   -- Whether a parameter is not 0.
   function is_set (value : bit_vector) return boolean;
   -- The lowest bits of a parameter, which has zeros above its own.
   function value_of (value : bit_vector; width : natural) return std_logic_vector;
   -- What a register has at first, from digits 0, 1 and U; bits without a digit have U.
   function first_value (digits : string; width : natural) return std_logic_vector;
   -- The highest index of a port, which has one bit at least.
   function highest (width : integer) return natural;
   function largest (a, b : integer) return integer;
   -- Whether a control input has its active level.
   function is_active (control : std_logic; polarity : bit_vector) return boolean;

   function zeros (width : natural) return std_logic_vector;
   function copies (value : std_logic; width : natural) return std_logic_vector;
   -- A value in the lowest bit, with zeros above it.
   function bit_of (value : std_logic; width : natural) return std_logic_vector;
   -- The lowest bits of an operand, made shorter or longer.
   function extend (a : std_logic_vector; count : natural; is_signed : boolean; width : natural)
      return std_logic_vector;

   function all_ones (a : std_logic_vector) return std_logic;
   function any_one (a : std_logic_vector) return std_logic;
   function odd_ones (a : std_logic_vector) return std_logic;

   -- Arithmetic on operands of the same width. An unknown bit makes the whole result unknown.
   function sum (a, b : std_logic_vector; carry : std_logic) return std_logic_vector;
   function difference (a, b : std_logic_vector) return std_logic_vector;
   function product (a, b : std_logic_vector) return std_logic_vector;
   -- Division of signed operands; by 0 the result is unknown.
   function quotient (a, b : std_logic_vector; is_floored : boolean) return std_logic_vector;
   function remainder (a, b : std_logic_vector; is_floored : boolean) return std_logic_vector;
   function power (a : std_logic_vector; a_width : natural; a_signed : boolean;
                   b : std_logic_vector; b_width : natural; b_signed : boolean; width : natural)
      return std_logic_vector;

   function equal (a, b : std_logic_vector) return std_logic;
   function identical (a, b : std_logic_vector) return std_logic;
   -- Comparison of signed operands of the same width.
   function less (a, b : std_logic_vector) return std_logic;

   -- How far an operand is shifted to the right.
   function distance (b : std_logic_vector; count : natural; is_signed : boolean) return integer;
   function moved (a : std_logic_vector; by : integer; keeps_sign : boolean) return std_logic_vector;
   -- The lowest bits of a, unknown where b is.
   function resized (a, b : std_logic_vector; width : natural) return std_logic_vector;
   -- The bits of a from an index on, unknown beyond a and where b is.
   function part (a : std_logic_vector; count : natural; from : integer; b : std_logic_vector;
                  width : natural) return std_logic_vector;

   function choice (a, b : std_logic_vector; s : std_logic) return std_logic_vector;
   function chosen_part (a, s : std_logic_vector; count : natural; width : positive)
      return std_logic_vector;
   function one_hot (a, b, s : std_logic_vector) return std_logic_vector;
   function placed (a, s : std_logic_vector; count : natural; width : positive)
      return std_logic_vector;
   function bit_of_table (values : bit_vector; a : std_logic_vector; count : natural)
      return std_logic;
   function fits (a : std_logic_vector; rows : bit_vector; depth : natural) return std_logic;
   function carries (p, g : std_logic_vector; carry : std_logic) return std_logic_vector;

   -- For $macc: a sum of terms, each one or two numbers of a, and of single bits. CONFIG has the
   -- width of the fields of a term, then for each term whether it is signed and subtracted, and how
   -- wide its numbers are.
   function accumulated (a : std_logic_vector; config : bit_vector; single : std_logic_vector;
                         count : natural; width : natural) return std_logic_vector;
   function field (value : bit_vector; low, count : natural) return natural;

   -- For $fsm: rows of a table. A row has, from the left, a state, a pattern of inputs, the next
   -- state and the outputs; its "-" fit any value.
   -- The last row of a state whose pattern fits the inputs; -1 for none.
   function row_of (table : string; rows, states, inputs, outputs : natural; state : integer;
                    control : std_logic_vector) return integer;
   function next_state (table : string; row, states, inputs, outputs : integer;
                        otherwise : integer) return integer;
   function outputs_of (table : string; row, states, inputs, outputs : integer; width : natural)
      return std_logic_vector;

   -- For memories: bit number i of a parameter, a clock's edge, and an address.
   function flag (value : bit_vector; i : natural) return boolean;
   function ticks (is_clocked, is_rising : boolean; last, now : std_logic) return boolean;
   -- The number of a memory's word; -1 for none.
   function word_number (address : std_logic_vector; offset : integer; size : natural)
      return integer;
end orn_hdl_cells;

library ieee;
use ieee.numeric_std.all;

package body orn_hdl_cells is
   -- Farther than any operand is wide.
   constant beyond : integer := 2 ** 30;

   function number (value : bit_vector) return integer is
      variable result : integer := 0;
      alias bits : bit_vector(value'length - 1 downto 0) is value;
   begin
      if value'length >= 32 and bits(31) = '1' then
         result := -1;
      end if;
      for i in bits'range loop
         if i < 31 then
            result := result * 2;
            if bits(i) = '1' then
               result := result + 1;
            end if;
         end if;
      end loop;
      return result;
   end number;

   function bits_of (value : integer) return bit_vector is
   begin
      return to_bitvector(std_logic_vector(to_signed(value, 32)));
   end bits_of;

   function is_set (value : bit_vector) return boolean is
   begin
      for i in value'range loop
         if value(i) = '1' then
            return true;
         end if;
      end loop;
      return false;
   end is_set;

   function value_of (value : bit_vector; width : natural) return std_logic_vector is
      alias bits : bit_vector(value'length - 1 downto 0) is value;
      variable result : std_logic_vector(width - 1 downto 0) := (others => '0');
   begin
      for i in result'range loop
         if i < bits'length then
            result(i) := to_stdulogic(bits(i));
         end if;
      end loop;
      return result;
   end value_of;

   function first_value (digits : string; width : natural) return std_logic_vector is
      alias texts : string(digits'length downto 1) is digits;
      variable result : std_logic_vector(width - 1 downto 0) := (others => 'U');
   begin
      for i in result'reverse_range loop
         if i < texts'length then
            case texts(i + 1) is
               when '0' => result(i) := '0';
               when '1' => result(i) := '1';
               when others => null;
            end case;
         end if;
      end loop;
      return result;
   end first_value;

   function highest (width : integer) return natural is
   begin
      return largest(width, 1) - 1;
   end highest;

   function largest (a, b : integer) return integer is
   begin
      if a > b then
         return a;
      end if;
      return b;
   end largest;

   function is_active (control : std_logic; polarity : bit_vector) return boolean is
   begin
      if is_set(polarity) then
         return control = '1';
      end if;
      return control = '0';
   end is_active;

   function zeros (width : natural) return std_logic_vector is
   begin
      return copies('0', width);
   end zeros;

   function copies (value : std_logic; width : natural) return std_logic_vector is
      constant result : std_logic_vector(width - 1 downto 0) := (others => value);
   begin
      return result;
   end copies;

   function bit_of (value : std_logic; width : natural) return std_logic_vector is
      variable result : std_logic_vector(width - 1 downto 0) := (others => '0');
   begin
      result(0) := value;
      return result;
   end bit_of;

   function extend (a : std_logic_vector; count : natural; is_signed : boolean; width : natural)
      return std_logic_vector is
      alias bits : std_logic_vector(a'length - 1 downto 0) is a;
      variable result : std_logic_vector(width - 1 downto 0) := (others => '0');
   begin
      for i in result'reverse_range loop
         if i < count then
            result(i) := bits(i);
         elsif is_signed and count > 0 then
            result(i) := bits(count - 1);
         end if;
      end loop;
      return result;
   end extend;

   function all_ones (a : std_logic_vector) return std_logic is
      variable result : std_logic := '1';
   begin
      for i in a'range loop
         result := result and a(i);
      end loop;
      return result;
   end all_ones;

   function any_one (a : std_logic_vector) return std_logic is
      variable result : std_logic := '0';
   begin
      for i in a'range loop
         result := result or a(i);
      end loop;
      return result;
   end any_one;

   function odd_ones (a : std_logic_vector) return std_logic is
      variable result : std_logic := '0';
   begin
      for i in a'range loop
         result := result xor a(i);
      end loop;
      return result;
   end odd_ones;

   function sum (a, b : std_logic_vector; carry : std_logic) return std_logic_vector is
      constant first : unsigned(a'length - 1 downto 0) := unsigned(a);
      constant second : unsigned(b'length - 1 downto 0) := unsigned(b);
      variable low : unsigned(a'length - 1 downto 0) := (others => '0');
   begin
      if is_x(a & b & carry) then
         return copies('X', a'length);
      end if;
      low(0) := to_x01(carry);
      return std_logic_vector(first + second + low);
   end sum;

   function difference (a, b : std_logic_vector) return std_logic_vector is
   begin
      return sum(a, not b, '1');
   end difference;

   function product (a, b : std_logic_vector) return std_logic_vector is
      variable result : unsigned(2 * a'length - 1 downto 0);
   begin
      if is_x(a) or is_x(b) then
         return copies('X', a'length);
      end if;
      result := unsigned(a) * unsigned(b);
      return std_logic_vector(result(a'length - 1 downto 0));
   end product;

   function quotient (a, b : std_logic_vector; is_floored : boolean) return std_logic_vector is
      variable result : signed(a'length - 1 downto 0);
   begin
      if is_x(a) or is_x(b) or any_one(b) = '0' then
         return copies('X', a'length);
      end if;
      result := signed(a) / signed(b);
      if is_floored and (a(a'left) xor b(b'left)) = '1' and signed(a) rem signed(b) /= 0 then
         result := result - 1;
      end if;
      return std_logic_vector(result);
   end quotient;

   function remainder (a, b : std_logic_vector; is_floored : boolean) return std_logic_vector is
   begin
      if is_x(a) or is_x(b) or any_one(b) = '0' then
         return copies('X', a'length);
      end if;
      if is_floored then
         return std_logic_vector(signed(a) mod signed(b));
      end if;
      return std_logic_vector(signed(a) rem signed(b));
   end remainder;

   function power (a : std_logic_vector; a_width : natural; a_signed : boolean;
                   b : std_logic_vector; b_width : natural; b_signed : boolean; width : natural)
      return std_logic_vector is
      constant full : natural := largest(width, a_width);
      constant base : std_logic_vector(full - 1 downto 0) :=
         extend(a, a_width, a_signed, full);
      constant exponent : std_logic_vector(b_width - 1 downto 0) :=
         extend(b, b_width, false, b_width);
      variable result : std_logic_vector(full - 1 downto 0) := bit_of('1', full);
   begin
      if is_x(a) or is_x(b) then
         return copies('X', width);
      end if;
      if b_signed and b_width > 0 and exponent(b_width - 1) = '1' then
         -- The reciprocal of a power is a whole number for 1 and -1 alone.
         if any_one(base) = '0' then
            return copies('X', width);
         elsif base = bit_of('1', full) then
            return extend(base, full, false, width);
         elsif a_signed and all_ones(base) = '1' then
            if exponent(0) = '0' then
               return bit_of('1', width);
            end if;
            return extend(base, full, false, width);
         end if;
         return zeros(width);
      end if;
      for i in exponent'range loop
         result := product(result, result);
         if exponent(i) = '1' then
            result := product(result, base);
         end if;
      end loop;
      return extend(result, full, false, width);
   end power;

   function equal (a, b : std_logic_vector) return std_logic is
      constant differences : std_logic_vector(a'length - 1 downto 0) := a xor b;
   begin
      return not any_one(differences);
   end equal;

   function identical (a, b : std_logic_vector) return std_logic is
   begin
      if to_x01z(a) = to_x01z(b) then
         return '1';
      end if;
      return '0';
   end identical;

   function less (a, b : std_logic_vector) return std_logic is
   begin
      if is_x(a) or is_x(b) then
         return 'X';
      elsif signed(a) < signed(b) then
         return '1';
      end if;
      return '0';
   end less;

   function distance (b : std_logic_vector; count : natural; is_signed : boolean) return integer is
      alias bits : std_logic_vector(b'length - 1 downto 0) is b;
      variable result : integer := 0;
      variable is_negative : boolean := false;
   begin
      if count > 0 then
         is_negative := is_signed and bits(count - 1) = '1';
      end if;
      for i in count - 1 downto 0 loop
         if result >= beyond / 2 then
            result := beyond;
         else
            result := 2 * result;
            if (bits(i) = '1') /= is_negative then
               result := result + 1;
            end if;
         end if;
      end loop;
      if is_negative then
         return -result - 1;
      end if;
      return result;
   end distance;

   function moved (a : std_logic_vector; by : integer; keeps_sign : boolean)
      return std_logic_vector is
      alias bits : std_logic_vector(a'length - 1 downto 0) is a;
      variable result : std_logic_vector(a'length - 1 downto 0) := (others => '0');
   begin
      if keeps_sign then
         result := (others => bits(bits'left));
      end if;
      for i in result'range loop
         if i + by >= 0 and i + by < bits'length then
            result(i) := bits(i + by);
         elsif i + by < 0 then
            result(i) := '0';
         end if;
      end loop;
      return result;
   end moved;

   function resized (a, b : std_logic_vector; width : natural) return std_logic_vector is
   begin
      if is_x(b) then
         return copies('X', width);
      end if;
      return extend(a, a'length, false, width);
   end resized;

   function part (a : std_logic_vector; count : natural; from : integer; b : std_logic_vector;
                  width : natural) return std_logic_vector is
      alias bits : std_logic_vector(a'length - 1 downto 0) is a;
      variable result : std_logic_vector(width - 1 downto 0) := (others => 'X');
   begin
      for i in result'range loop
         if not is_x(b) and i + from >= 0 and i + from < count then
            result(i) := bits(i + from);
         end if;
      end loop;
      return result;
   end part;

   function choice (a, b : std_logic_vector; s : std_logic) return std_logic_vector is
      alias second : std_logic_vector(a'range) is b;
      variable result : std_logic_vector(a'range) := a;
   begin
      if s = '1' then
         result := b;
      elsif s /= '0' then
         for i in result'range loop
            if a(i) /= second(i) then
               result(i) := 'X';
            end if;
         end loop;
      end if;
      return result;
   end choice;

   function chosen_part (a, s : std_logic_vector; count : natural; width : positive)
      return std_logic_vector is
      alias bits : std_logic_vector(a'length - 1 downto 0) is a;
      constant index : integer := distance(s, count, false);
   begin
      if count > 0 and is_x(s) then
         return copies('X', width);
      end if;
      return bits((index + 1) * width - 1 downto index * width);
   end chosen_part;

   function one_hot (a, b, s : std_logic_vector) return std_logic_vector is
      alias parts : std_logic_vector(b'length - 1 downto 0) is b;
      alias selects : std_logic_vector(s'length - 1 downto 0) is s;
      variable result : std_logic_vector(a'length - 1 downto 0) := a;
      variable is_found : boolean := false;
   begin
      for i in 0 to selects'left loop
         if is_x(selects(i downto i)) or (is_found and selects(i) = '1') then
            return copies('X', a'length);
         elsif selects(i) = '1' then
            result := parts((i + 1) * a'length - 1 downto i * a'length);
            is_found := true;
         end if;
      end loop;
      return result;
   end one_hot;

   function placed (a, s : std_logic_vector; count : natural; width : positive)
      return std_logic_vector is
      constant index : integer := distance(s, count, false);
      variable result : std_logic_vector(width - 1 downto 0) := (others => '0');
   begin
      if count > 0 and is_x(s) then
         return copies('X', width);
      end if;
      result((index + 1) * a'length - 1 downto index * a'length) := a;
      return result;
   end placed;

   function bit_of_table (values : bit_vector; a : std_logic_vector; count : natural)
      return std_logic is
      constant table : std_logic_vector(2 ** count - 1 downto 0) := value_of(values, 2 ** count);
      constant result : std_logic_vector(0 downto 0) := chosen_part(table, a, count, 1);
   begin
      return result(0);
   end bit_of_table;

   function fits (a : std_logic_vector; rows : bit_vector; depth : natural) return std_logic is
      alias bits : std_logic_vector(a'length - 1 downto 0) is a;
      variable row, result : std_logic := '0';
   begin
      for i in 0 to depth - 1 loop
         row := '1';
         for j in 0 to bits'left loop
            if flag(rows, 2 * (i * bits'length + j)) then
               row := row and not bits(j);
            end if;
            if flag(rows, 2 * (i * bits'length + j) + 1) then
               row := row and bits(j);
            end if;
         end loop;
         result := result or row;
      end loop;
      return result;
   end fits;

   function carries (p, g : std_logic_vector; carry : std_logic) return std_logic_vector is
      alias passes : std_logic_vector(p'length - 1 downto 0) is p;
      alias makes : std_logic_vector(p'length - 1 downto 0) is g;
      variable result : std_logic_vector(p'length - 1 downto 0);
      variable present : std_logic := carry;
   begin
      if is_x(p & g & carry) then
         return copies('X', p'length);
      end if;
      for i in 0 to result'left loop
         present := makes(i) or (passes(i) and present);
         result(i) := present;
      end loop;
      return result;
   end carries;

   function field (value : bit_vector; low, count : natural) return natural is
      variable result : natural := 0;
   begin
      for i in low + count - 1 downto low loop
         result := 2 * result;
         if flag(value, i) then
            result := result + 1;
         end if;
      end loop;
      return result;
   end field;

   function accumulated (a : std_logic_vector; config : bit_vector; single : std_logic_vector;
                         count : natural; width : natural) return std_logic_vector is
      alias bits : std_logic_vector(a'length - 1 downto 0) is a;
      alias ones : std_logic_vector(single'length - 1 downto 0) is single;
      constant size : positive := largest(field(config, 0, 4), 1);
      constant terms : integer := (config'length - 4) / (2 + 2 * size);
      variable low, from, first, second : natural := 0;
      variable term, result : std_logic_vector(width - 1 downto 0) := zeros(width);

      -- The next number of a, which may have no bits.
      procedure take (length : in natural; value : out std_logic_vector) is
      begin
         value := extend(bits(from + length - 1 downto from), length, flag(config, low), width);
         from := from + length;
      end take;

      variable factor : std_logic_vector(width - 1 downto 0);
   begin
      for i in 0 to terms - 1 loop
         low := 4 + i * (2 + 2 * size);
         first := field(config, low + 2, size);
         second := field(config, low + 2 + size, size);
         take(first, term);
         if second > 0 then
            take(second, factor);
            term := product(term, factor);
         end if;
         if flag(config, low + 1) then
            result := difference(result, term);
         else
            result := sum(result, term, '0');
         end if;
      end loop;
      for i in 0 to count - 1 loop
         result := sum(result, zeros(width), ones(i));
      end loop;
      return result;
   end accumulated;

   function digit_of (value : character) return std_logic is
   begin
      case value is
         when '0' => return '0';
         when '1' => return '1';
         when others => return 'X';
      end case;
   end digit_of;

   -- A number in a table; -1 for one that has other digits than 0 and 1.
   function number_at (table : string; first, count : natural) return integer is
      variable result : natural := 0;
   begin
      for i in first to first + count - 1 loop
         result := 2 * result;
         if table(i) = '1' then
            result := result + 1;
         elsif table(i) /= '0' then
            return -1;
         end if;
      end loop;
      return result;
   end number_at;

   -- Where a row begins; the first row stands at the right end.
   function start_of (table : string; row, length : natural) return integer is
   begin
      return table'length - (row + 1) * length + 1;
   end start_of;

   function row_of (table : string; rows, states, inputs, outputs : natural; state : integer;
                    control : std_logic_vector) return integer is
      alias digits : string(1 to table'length) is table;
      alias levels : std_logic_vector(control'length - 1 downto 0) is control;
      constant length : natural := 2 * states + inputs + outputs;
      variable start : integer;
      variable is_fitting : boolean;
      variable digit : character;
   begin
      for row in rows - 1 downto 0 loop
         start := start_of(digits, row, length);
         is_fitting := state >= 0 and number_at(digits, start, states) = state;
         for i in 0 to inputs - 1 loop
            digit := digits(start + states + inputs - 1 - i);
            if digit /= '-' then
               is_fitting := is_fitting and digit_of(digit) = to_x01(levels(i));
            end if;
         end loop;
         if is_fitting then
            return row;
         end if;
      end loop;
      return -1;
   end row_of;

   function next_state (table : string; row, states, inputs, outputs : integer;
                        otherwise : integer) return integer is
      alias digits : string(1 to table'length) is table;
      constant length : natural := 2 * states + inputs + outputs;
   begin
      if row < 0 then
         return otherwise;
      end if;
      return number_at(digits, start_of(digits, row, length) + states + inputs, states);
   end next_state;

   function outputs_of (table : string; row, states, inputs, outputs : integer; width : natural)
      return std_logic_vector is
      alias digits : string(1 to table'length) is table;
      variable result : std_logic_vector(width - 1 downto 0) := copies('X', width);
      constant length : natural := 2 * states + inputs + outputs;
      variable last : integer;
   begin
      if row >= 0 then
         last := start_of(digits, row, length) + length - 1;
         for i in 0 to outputs - 1 loop
            result(i) := digit_of(digits(last - i));
         end loop;
      end if;
      return result;
   end outputs_of;

   function flag (value : bit_vector; i : natural) return boolean is
      alias bits : bit_vector(value'length - 1 downto 0) is value;
   begin
      if i >= bits'length then
         return false;
      end if;
      return bits(i) = '1';
   end flag;

   function ticks (is_clocked, is_rising : boolean; last, now : std_logic) return boolean is
   begin
      if not is_clocked then
         return true;
      elsif is_rising then
         return to_x01(last) = '0' and to_x01(now) = '1';
      end if;
      return to_x01(last) = '1' and to_x01(now) = '0';
   end ticks;

   function word_number (address : std_logic_vector; offset : integer; size : natural)
      return integer is
      variable result : integer := -1;
   begin
      if not is_x(address) then
         result := distance(address, address'length, false) - offset;
      end if;
      if result >= size then
         return -1;
      end if;
      return largest(result, -1);
   end word_number;
end orn_hdl_cells;
