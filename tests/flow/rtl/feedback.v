// Output ports that are read inside: whole, in part and bit by bit; one net on
// several outputs; an input passed straight on; constant outputs.
module feedback(input            clk,
                input            rst,
                input            bit_in,
                output reg [7:0] lfsr,
                output reg [0:3] ring,
                output reg       toggle,
                output           toggle_again,
                output           toggle_inverted,
                output           passed,
                output     [3:0] part,
                output     [1:0] constant);

   always @(posedge clk or posedge rst)
      if (rst) begin
         lfsr   <= 8'h01;
         ring   <= 4'b1000;
         toggle <= 1'b0;
      end else begin
         lfsr   <= {lfsr[6:0], lfsr[7] ^ lfsr[5] ^ lfsr[4] ^ lfsr[3] ^ bit_in};
         ring   <= {ring[3], ring[0:2]};
         toggle <= !toggle;
      end

   assign toggle_again    = toggle;
   assign toggle_inverted = !toggle;
   assign passed          = bit_in;
   assign part            = {lfsr[7], ring[1], lfsr[1:0]};
   assign constant        = 2'b10;
endmodule
