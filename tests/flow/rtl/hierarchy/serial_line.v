// Sender and receiver of a serial line, each with a clock divider of its own.
module divider #(parameter COUNT = 4) (input clk, input reset, input restart, output tick);
  reg [3:0] count;
  assign tick = count == COUNT - 1;
  always @(posedge clk)
    if (reset | restart | tick) count <= 4'd0;
    else count <= count + 4'd1;
endmodule

module serial_sender(input clk, input reset, input start, input [7:0] data, output line, output busy);
  reg [9:0] bits;
  reg [3:0] left;
  wire tick;
  divider #(.COUNT(4)) pace(.clk(clk), .reset(reset), .restart(start & ~busy), .tick(tick));
  assign busy = left != 4'd0;
  assign line = bits[0];
  always @(posedge clk)
    if (reset) begin
      bits <= 10'h3ff;
      left <= 4'd0;
    end else if (start & ~busy) begin
      bits <= {1'b1, data, 1'b0};
      left <= 4'd10;
    end else if (busy & tick) begin
      bits <= {1'b1, bits[9:1]};
      left <= left - 4'd1;
    end
endmodule

module serial_receiver(input clk, input reset, input line, output reg [7:0] data, output reg ready);
  reg active;
  reg half;
  reg [3:0] left;
  wire tick;
  divider #(.COUNT(2)) pace(.clk(clk), .reset(reset), .restart(~active), .tick(tick));
  always @(posedge clk)
    if (reset) begin
      active <= 1'b0;
      half <= 1'b0;
      left <= 4'd0;
      data <= 8'd0;
      ready <= 1'b0;
    end else begin
      ready <= 1'b0;
      if (~active) begin
        active <= ~line;
        half <= 1'b0;
        left <= 4'd9;
      end else if (tick) begin
        half <= ~half;
        if (~half) begin
          left <= left - 4'd1;
          if (left == 4'd0) begin
            active <= 1'b0;
            ready <= line;
          end else if (left != 4'd9) data <= {line, data[7:1]};
        end
      end
    end
endmodule

module serial_line(input clk, input reset, input start, input [7:0] send, input cut, output [7:0] got,
                   output ready, output busy);
  wire line;
  serial_sender sender(.clk(clk), .reset(reset), .start(start), .data(send), .line(line), .busy(busy));
  serial_receiver receiver(.clk(clk), .reset(reset), .line(line | cut), .data(got), .ready(ready));
endmodule
