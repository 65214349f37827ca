// Packed structures, in ports and as parts of each other, which Yosys flattens to vectors.
typedef struct packed {
  logic [3:0] kind;
  logic       urgent;
  logic [7:0] size;
} head_t;

typedef struct packed {
  head_t      head;
  logic [7:0] sum;
} message_t;

module sum_up(input logic [12:0] head, output logic [7:0] sum);
  head_t h;
  assign h = head;
  assign sum = h.size + {h.kind, 3'b000, h.urgent};
endmodule

module records(input logic clk, input logic reset, input logic [12:0] head, input logic take,
               output logic [20:0] message, output logic good, output logic [7:0] urgent_size);
  message_t kept;
  logic [7:0] sum_in, sum_kept;
  sum_up in_sum(.head(head), .sum(sum_in));
  sum_up kept_sum(.head(kept.head), .sum(sum_kept));
  always_ff @(posedge clk)
    if (reset) kept <= '0;
    else if (take) begin
      kept.head <= head;
      kept.sum <= sum_in;
    end
  assign message = kept;
  assign good = sum_kept == kept.sum;
  assign urgent_size = kept.head.urgent ? kept.head.size : 8'd0;
endmodule
