// Escaped and reserved names of modules, ports, instances and nets.
module \entity (input \in , input \out , input clk, output reg \signal );
  wire \process ;
  assign \process = \in ^ \out ;
  always @(posedge clk) \signal <= \process ;
endmodule

module \bus.of[2] #(parameter \generic = 3) (input [\generic -1:0] \downto , output [\generic -1:0] \a+b );
  assign \a+b = ~\downto ;
endmodule

module Entity_(input [1:0] Data, input [1:0] data, output [1:0] DATA);
  assign DATA = Data & data;
endmodule

module odd_names(input clk, input [2:0] \in , input \a.b , input [1:0] \x[1] , output [2:0] \end ,
                 output \architecture , output [1:0] Mixed, output [1:0] mixed);
  wire \u1.signal ;
  wire [2:0] \begin , \$weird$1 ;
  \entity \u[0] (.\in (\in [0]), .\out (\a.b ), .clk(clk), .\signal (\architecture ));
  \entity \u.1 (.\in (\in [1]), .\out (\architecture ), .clk(clk), .\signal (\u1.signal ));
  \bus.of[2] #(.\generic (3)) port(.\downto (\in ), .\a+b (\begin ));
  \bus.of[2] #(.\generic (3)) map(.\downto (\begin ^ {3{\u1.signal }}), .\a+b (\$weird$1 ));
  Entity_ \generate (.Data(\x[1] ), .data(\in [1:0]), .DATA(Mixed));
  assign \end = \$weird$1 ;
  assign mixed = ~Mixed;
endmodule
