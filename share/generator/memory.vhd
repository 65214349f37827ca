process (RD_CLK, RD_ARST, RD_ADDR, WR_CLK, WR_EN, WR_ADDR, WR_DATA)
   constant bits : positive := largest(number(WIDTH), 1);
   constant address_bits : positive := largest(number(ABITS), 1);
   subtype word is std_logic_vector(bits - 1 downto 0);
   type words is array (0 to highest(number(SIZE))) of word;

   function contents return words is
      constant all_bits : std_logic_vector(words'length * bits - 1 downto 0) :=
         value_of(INIT, words'length * bits);
      variable result : words;
   begin
      for i in words'range loop
         result(i) := all_bits((i + 1) * bits - 1 downto i * bits);
      end loop;
      return result;
   end contents;

   function address (addresses : std_logic_vector; port_number : natural) return integer is
      constant low : natural := port_number * address_bits;
   begin
      return word_number(addresses(low + address_bits - 1 downto low), number(OFFSET), number(SIZE));
   end address;

   variable memory : words := contents;
   variable data : std_logic_vector(RD_DATA'range) := value_of(RD_INIT_VALUE, RD_DATA'length);
   variable last_read : std_logic_vector(RD_CLK'range) := (others => 'X');
   variable last_write : std_logic_vector(WR_CLK'range) := (others => 'X');
   variable place : integer;

   impure function reads (i : natural) return boolean is
   begin
      return ticks(flag(RD_CLK_ENABLE, i), flag(RD_CLK_POLARITY, i), last_read(i), RD_CLK(i));
   end reads;

   impure function writes (i : natural) return boolean is
   begin
      return ticks(flag(WR_CLK_ENABLE, i), flag(WR_CLK_POLARITY, i), last_write(i), WR_CLK(i));
   end writes;

   -- What port i reads, before anything is written.
   procedure read (i : natural) is
      variable value : word := (others => 'X');
      variable from : integer;
   begin
      from := address(RD_ADDR, i);
      if from >= 0 then
         value := memory(from);
      end if;
      data((i + 1) * bits - 1 downto i * bits) := value;
   end read;

   -- What port i reads of what port j writes at the same time: the new value, or x.
   procedure meet (i, j : natural) is
      constant first : natural := i * address_bits;
      constant second : natural := j * address_bits;
      constant mask : natural := i * number(WR_PORTS) + j;
   begin
      if not writes(j) or RD_ADDR(first + address_bits - 1 downto first) /=
         WR_ADDR(second + address_bits - 1 downto second) then
         return;
      end if;
      for k in 0 to bits - 1 loop
         if WR_EN(j * bits + k) = '1' and flag(RD_TRANSPARENCY_MASK, mask) then
            data(i * bits + k) := WR_DATA(j * bits + k);
         end if;
         if WR_EN(j * bits + k) = '1' and flag(RD_COLLISION_X_MASK, mask) then
            data(i * bits + k) := 'X';
         end if;
      end loop;
   end meet;

   -- What port i reads when it is reset.
   procedure reset (i : natural) is
      constant at_clock : std_logic_vector(RD_DATA'range) := value_of(RD_SRST_VALUE, RD_DATA'length);
      constant at_once : std_logic_vector(RD_DATA'range) := value_of(RD_ARST_VALUE, RD_DATA'length);
   begin
      if RD_SRST(i) = '1' and reads(i) and (RD_EN(i) = '1' or not flag(RD_CE_OVER_SRST, i)) then
         data((i + 1) * bits - 1 downto i * bits) := at_clock((i + 1) * bits - 1 downto i * bits);
      end if;
      if RD_ARST(i) = '1' then
         data((i + 1) * bits - 1 downto i * bits) := at_once((i + 1) * bits - 1 downto i * bits);
      end if;
   end reset;
begin
   for i in 0 to number(RD_PORTS) - 1 loop
      if flag(RD_CLK_ENABLE, i) and RD_EN(i) = '1' and reads(i) then
         read(i);
         for j in 0 to number(WR_PORTS) - 1 loop
            meet(i, j);
         end loop;
      end if;
   end loop;
   for j in 0 to number(WR_PORTS) - 1 loop
      place := address(WR_ADDR, j);
      if place >= 0 and writes(j) then
         for k in 0 to bits - 1 loop
            if WR_EN(j * bits + k) = '1' then
               memory(place)(k) := WR_DATA(j * bits + k);
            end if;
         end loop;
      end if;
   end loop;
   for i in 0 to number(RD_PORTS) - 1 loop
      if not flag(RD_CLK_ENABLE, i) then
         read(i);
      end if;
      reset(i);
   end loop;
   last_read := RD_CLK;
   last_write := WR_CLK;
   RD_DATA <= data;
end process;
