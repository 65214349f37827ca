// Two-way pads: one byte with a common direction and one with its own, each
// through a leaf cell; what the pads show is registered.
module pads(input            clk,
            input            rst,
            input            drive,
            input      [7:0] to_pad,
            inout      [7:0] pad,
            input            drive_single,
            inout            single,
            output reg [7:0] from_pad,
            output           parity);

   wire [7:0] seen;
   wire       single_seen;

   genvar n;
   generate
      for (n = 0; n < 8; n = n + 1) begin : ring
         IOBUF #(.SLEW("FAST")) buffer(.I(to_pad[n]), .T(!drive), .O(seen[n]), .IO(pad[n]));
      end
   endgenerate
   IOBUF alone(.I(from_pad[0]), .T(!drive_single), .O(single_seen), .IO(single));

   always @(posedge clk or posedge rst)
      if (rst) from_pad <= 8'd0;
      else from_pad <= seen ^ {7'd0, single_seen};

   assign parity = ^from_pad;
endmodule
