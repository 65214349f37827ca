// Serial transmitter and receiver, eight data bits, four clocks a bit.
module uart(input            clk,
            input            rst,
            input            send,
            input      [7:0] tx_data,
            input            loopback,
            input            rxd,
            output           txd,
            output           busy,
            output     [7:0] rx_data,
            output           received);

   uart_tx tx(.clk(clk), .rst(rst), .send(send), .data(tx_data), .line(txd), .busy(busy));
   uart_rx rx(.clk(clk), .rst(rst), .line(loopback ? txd : rxd), .data(rx_data),
              .received(received));
endmodule

module uart_tx(input clk, input rst, input send, input [7:0] data, output line, output busy);
   reg [8:0] shift;
   reg [3:0] bits;
   reg [1:0] phase;

   assign line = shift[0];
   assign busy = bits != 4'd0;

   always @(posedge clk or posedge rst)
      if (rst) begin
         shift <= 9'h1FF;
         bits  <= 4'd0;
         phase <= 2'd0;
      end else if (!busy) begin
         phase <= 2'd0;
         if (send) begin
            shift <= {data, 1'b0};
            bits  <= 4'd10;
         end
      end else begin
         phase <= phase + 2'd1;
         if (phase == 2'd3) begin
            shift <= {1'b1, shift[8:1]};
            bits  <= bits - 4'd1;
         end
      end
endmodule

module uart_rx(input clk, input rst, input line, output reg [7:0] data, output reg received);
   reg [3:0] bits;
   reg [1:0] phase;

   always @(posedge clk or posedge rst)
      if (rst) begin
         data     <= 8'd0;
         received <= 1'b0;
         bits     <= 4'd0;
         phase    <= 2'd0;
      end else begin
         received <= 1'b0;
         phase    <= phase + 2'd1;
         if (bits == 4'd0) begin
            // Sample in the middle of each bit, counted from the start bit's edge.
            phase <= 2'd0;
            if (!line)
               bits <= 4'd10;
         end else if (phase == 2'd1) begin
            bits <= bits - 4'd1;
            if (bits == 4'd1)
               received <= line;
            else if (bits != 4'd10)
               data <= {line, data[7:1]};
         end
      end
endmodule
