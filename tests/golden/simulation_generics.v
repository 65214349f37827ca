`timescale 1ns / 1ps

module simulation_generics(I, 
                           T, 
                           O, 
                           PAD);

   // synopsys translate_off
   parameter MODE = "fast";
   // synopsys translate_on

    input I;
    input T;
   output O;
    inout PAD;


   IOBUF U1 (.I(I), 
             .T(T), 
             .O(O), 
             .IO(PAD));
   // synopsys translate_off
   defparam U1.SLEW = "FAST";
   // synopsys translate_on
endmodule
