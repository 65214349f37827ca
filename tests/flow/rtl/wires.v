// Hardly any logic: feedthroughs, parts and turns of inputs, ports tied to constants, one net on
// several output ports, unused inputs, an unused output of a cell.
module wires(input a, input [7:0] bus, input [0:3] up, input unused, input [3:0] ignored,
             output same, output twin, output [7:0] copy, output [7:0] turned, output [3:0] part,
             output [11:0] mixed, output zero, output one, output [4:0] five, output half,
             output [0:3] low, output [1:0] pair, output gate, output gate_too, output [2:0] gates);
   wire n;
   AND2 u(.I0(a), .I1(bus[3]), .O(n));
   ADD4 w(.A(bus[3:0]), .B({bus[7:5], 1'b1}), .CI(1'b0), .S(low), .CO());
   assign same = a, twin = a, copy = bus, part = bus[5:2];
   assign turned = {bus[0], bus[1], bus[2], bus[3], bus[4], bus[5], bus[6], bus[7]};
   assign mixed = {up, 2'b10, bus[1], a, up[1:2], 1'b0, n};
   assign zero = 1'b0, one = 1'b1, five = 5'b10110, half = bus[4];
   assign pair = {2{a}};
   assign gate = n, gate_too = n, gates = {n, a, n};
endmodule
