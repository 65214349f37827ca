`timescale 1ns / 1ps

module X();


wire N;

endmodule
