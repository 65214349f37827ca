// Counts up and down, loads and saturates. Its inner names are words that
// netlist languages keep for themselves.
module counter(input            clk,
               input            rst,
               input            up,
               input            load,
               input      [7:0] value,
               output     [7:0] count,
               output           full,
               output           empty);

   reg  [7:0] register;
   wire [7:0] signal;
   wire       open = register == 8'hFF;
   wire       process_ = register == 8'h00;

   assign signal = load           ? value
                 : up && !open     ? register + 8'd1
                 : !up && !process_ ? register - 8'd1
                 : register;

   always @(posedge clk or posedge rst)
      if (rst) register <= 8'd0;
      else register <= signal;

   assign count = register;
   assign full  = open;
   assign empty = process_;
endmodule
