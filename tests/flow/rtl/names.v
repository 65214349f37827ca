// Names that a netlist language cannot hold as they stand: escaped ones, words
// of either language, ones equal but for letter case, a net and a cell of one
// name, odd underscores; on ports too.
module names(input            clk,
             input            rst,
             input            in,
             input      [3:0] select,
             input      [3:0] Select,
             output reg [3:0] out,
             output           \end ,
             output           _odd__name_);

   wire       \a+b ;
   wire [3:0] \bus[2] ;
   wire       Same, same, SAME;
   wire       AND2_1;
   wire       both;
   wire       const0;

   AND2 both_(.I0(in), .I1(select[0]), .O(both));
   AND2 \a-b (.I0(both), .I1(Select[0]), .O(\a+b ));
   XOR2 AND2_1_(.I0(\a+b ), .I1(in), .O(AND2_1));
   INV  \AND2_1_$inv (.I(AND2_1), .O(Same));
   OR2  Or(.I0(Same), .I1(\a+b ), .O(same));
   NOR2 oR(.I0(same), .I1(select[3]), .O(SAME));
   NAND2 process(.I0(SAME), .I1(AND2_1), .O(\end ));
   XOR2 other(.I0(const0), .I1(1'b1), .O(_odd__name_));

   assign const0   = in & rst;
   assign \bus[2]  = out + select;

   always @(posedge clk or posedge rst)
      if (rst) out <= 4'd0;
      else out <= \bus[2] ^ Select;
endmodule
