// Eight bytes, first in, first out.
module fifo(input            clk,
            input            rst,
            input            push,
            input            pop,
            input      [7:0] in_data,
            output     [7:0] out_data,
            output           is_full,
            output           is_empty,
            output reg [3:0] level);

   reg [7:0] store [0:7];
   reg [2:0] head, tail;
   integer   word;

   assign is_full  = level == 4'd8;
   assign is_empty = level == 4'd0;
   assign out_data = store[tail];

   wire pushes = push && !is_full;
   wire pops   = pop && !is_empty;

   always @(posedge clk or posedge rst)
      if (rst) begin
         head  <= 3'd0;
         tail  <= 3'd0;
         level <= 4'd0;
         for (word = 0; word < 8; word = word + 1)
            store[word] <= 8'd0;
      end else begin
         if (pushes) begin
            store[head] <= in_data;
            head <= head + 3'd1;
         end
         if (pops)
            tail <= tail + 3'd1;
         level <= level + {3'd0, pushes} - {3'd0, pops};
      end
endmodule
