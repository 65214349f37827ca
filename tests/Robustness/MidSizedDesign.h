/// \file
/// A design that uses a little of everything, as a command file.
#pragma once

#include <string>

namespace Robustness {

inline std::string MidSizedDesign() {
    std::string lines =
        "SET NETLIST NAME design\nSET PURPOSE to be written\nSET APPLICATION test\n"
        "ADD COMPONENT AND2\nADD PIN AND2 I0 input\nADD PIN AND2 I1 input\nADD PIN AND2 O output\n"
        "ADD COMPONENT REG\nADD PIN REG D(7:0) input 8:H:A5\nADD PIN REG Q(7:0) output\n"
        "ADD PIN REG C input\n"
        "ADD COMPONENT ATTRIBUTE REG INIT 8:H:00\n"
        "SET COMPONENT ATTRIBUTE OPTION REG INIT -GENERIC=SYN\n"
        "ADD COMPONENT ATTRIBUTE AND2 Level HALVEX\n"
        "ADD PORT A(7:0) input\nADD PORT B input\nADD PORT Y(7:0) output\nADD PORT Z output\n"
        "ADD SIGNAL w(3:0)\nADD INSTANCE REG R0\nADD INSTANCE REG R1\n"
        "ADD INSTANCE ATTRIBUTE R0 -TYPE=BitVector INIT 8:B:10101010\n"
        "SET INSTANCE ATTRIBUTE OPTION R0 INIT -GENERIC=SYN -SYNATTR=ASSIGN\n"
        "ADD INSTANCE COMMENT R0 \"holds the sum\"\nADD NOTES a note on the whole\n"
        "CONNECT SIGNAL A(7:0) R0.D(7:0)\nCONNECT SIGNAL Y(7:0) R0.Q(7:0)\n"
        "CONNECT SIGNAL Y(7:0) R1.D(7:0)\nCONNECT SIGNAL B R0.C\n"
        "CONNECT SIGNAL w(3:0),A(3:0) R1.Q(7:0)\nCONNECT SIGNAL w(7:0) w2(7:0)\n"
        "ASSIGN CONSTANT R1.C 1\nASSIGN CONSTANT Z 0\n"
        "ADD SIGNAL ATTRIBUTE w(3:0) -TYPE=Integer KEEP 1\nADD LIBRARY WORK2\n"
        "ADD INCLUDE cells.vh\n";
    for (int i = 0; i < 24; ++i) {
        const std::string name = "U" + std::to_string(i);
        lines += "ADD INSTANCE AND2 " + name + "\nCONNECT SIGNAL n" + std::to_string(i) + " " +
                 name + ".O\nCONNECT SIGNAL n" + std::to_string(i / 2) + " " + name +
                 ".I0\nCONNECT SIGNAL A(" + std::to_string(i % 8) + ") " + name + ".I1\n";
    }
    return lines;
}

} // namespace Robustness
