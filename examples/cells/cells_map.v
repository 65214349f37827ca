// Yosys' internal cells to leaf cells.

module \$_BUF_ (input A, output Y);
   BUF1 _TECHMAP_REPLACE_ (.I(A), .O(Y));
endmodule

module \$_NOT_ (input A, output Y);
   INV _TECHMAP_REPLACE_ (.I(A), .O(Y));
endmodule

module \$_AND_ (input A, input B, output Y);
   AND2 _TECHMAP_REPLACE_ (.I0(A), .I1(B), .O(Y));
endmodule

module \$_OR_ (input A, input B, output Y);
   OR2 _TECHMAP_REPLACE_ (.I0(A), .I1(B), .O(Y));
endmodule

module \$_NAND_ (input A, input B, output Y);
   NAND2 _TECHMAP_REPLACE_ (.I0(A), .I1(B), .O(Y));
endmodule

module \$_NOR_ (input A, input B, output Y);
   NOR2 _TECHMAP_REPLACE_ (.I0(A), .I1(B), .O(Y));
endmodule

module \$_XOR_ (input A, input B, output Y);
   XOR2 _TECHMAP_REPLACE_ (.I0(A), .I1(B), .O(Y));
endmodule

module \$_XNOR_ (input A, input B, output Y);
   XNOR2 _TECHMAP_REPLACE_ (.I0(A), .I1(B), .O(Y));
endmodule

module \$_MUX_ (input A, input B, input S, output Y);
   MUX2 _TECHMAP_REPLACE_ (.I0(A), .I1(B), .S(S), .O(Y));
endmodule

module \$_DFF_P_ (input C, input D, output Q);
   DFF _TECHMAP_REPLACE_ (.C(C), .D(D), .Q(Q));
endmodule

module \$_DFFE_PP_ (input C, input D, input E, output Q);
   DFFE _TECHMAP_REPLACE_ (.C(C), .CE(E), .D(D), .Q(Q));
endmodule

module \$_DFF_PP0_ (input C, input D, input R, output Q);
   DFFC _TECHMAP_REPLACE_ (.C(C), .CLR(R), .D(D), .Q(Q));
endmodule

module \$_DFF_PP1_ (input C, input D, input R, output Q);
   DFFS _TECHMAP_REPLACE_ (.C(C), .PRE(R), .D(D), .Q(Q));
endmodule

module \$_DFFE_PP0P_ (input C, input D, input E, input R, output Q);
   DFFCE _TECHMAP_REPLACE_ (.C(C), .CE(E), .CLR(R), .D(D), .Q(Q));
endmodule

module \$_DFFE_PP1P_ (input C, input D, input E, input R, output Q);
   DFFSE _TECHMAP_REPLACE_ (.C(C), .CE(E), .PRE(R), .D(D), .Q(Q));
endmodule
