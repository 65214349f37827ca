// Two-way ports, through two levels of modules.
module two_way_pad(inout pad, input drive, input value, output read);
  assign pad = drive ? value : 1'bz;
  assign read = pad;
endmodule

module two_way_port #(parameter WIDTH = 2)
  (inout [WIDTH-1:0] pads, input drive, input [WIDTH-1:0] value, output [WIDTH-1:0] read);
  genvar i;
  generate
    for (i = 0; i < WIDTH; i = i + 1) begin : pad
      two_way_pad p(.pad(pads[i]), .drive(drive), .value(value[i]), .read(read[i]));
    end
  endgenerate
endmodule

module two_way(input clk, inout [3:0] data, inout strobe, input write, input [3:0] value,
               output reg [3:0] seen, output reg [2:0] strobes);
  wire [3:0] now;
  wire strobe_now;
  two_way_port #(.WIDTH(4)) wide(.pads(data), .drive(write), .value(value ^ seen), .read(now));
  two_way_port #(.WIDTH(1)) narrow(.pads(strobe), .drive(write), .value(value[0]), .read(strobe_now));
  always @(posedge clk) begin
    seen <= now;
    strobes <= {strobes[1:0], strobe_now};
  end
endmodule
