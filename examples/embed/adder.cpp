// Builds a ripple-carry adder of any width with the classes of the design and writes it in both
// languages to memory.
//
// adder WIDTH

#include <Orn_Hdl/Orn_Hdl.h>

#include <cstdlib>
#include <iostream>
#include <memory>
#include <string>
#include <utility>

namespace {

using Orn_Hdl::Polarity;

/// Makes an object of the design and gives it to the netlist, which owns it from then on.
template <class T, class... Arguments>
T* AddNew(Orn_Hdl::Netlist& netlist, const std::string& name, Arguments... arguments) {
    auto made = std::make_unique<T>(name, arguments...);
    T* const object = made.get();
    netlist.Add(made.release());
    return object;
}

template <class T>
T* AddPort(Orn_Hdl::Netlist& netlist, const std::string& name, Polarity::Value direction) {
    T* const port = AddNew<T>(netlist, name);
    port->SetPortPolarity(direction);
    return port;
}

std::string Indexed(const std::string& name, const std::string& index) {
    return name + "(" + index + ")";
}

/// A bit of a bus, which is a signal of its own.
Orn_Hdl::Signal* AddBit(Orn_Hdl::Netlist& netlist, Orn_Hdl::Bus* bus, int bit) {
    return AddNew<Orn_Hdl::BusIndex>(netlist,
                                     Indexed(bus->GetBaseName().CStr(), std::to_string(bit)), bus);
}

std::unique_ptr<Orn_Hdl::Netlist> BuildAdder(int width) {
    auto netlist = std::make_unique<Orn_Hdl::Netlist>("adder" + std::to_string(width));
    netlist->AddComment("A ripple-carry adder.");

    auto* const fullAdder = AddNew<Orn_Hdl::Component>(*netlist, "FULL_ADDER");
    for (const char* input : {"A", "B", "CI"}) {
        fullAdder->AddPin(input, Polarity::Input, "");
    }
    for (const char* output : {"S", "CO"}) {
        fullAdder->AddPin(output, Polarity::Output, "");
    }

    const std::string range = std::to_string(width - 1) + ":0";
    auto* const a = AddPort<Orn_Hdl::Bus>(*netlist, Indexed("A", range), Polarity::Input);
    auto* const b = AddPort<Orn_Hdl::Bus>(*netlist, Indexed("B", range), Polarity::Input);
    auto* const sum = AddPort<Orn_Hdl::Bus>(*netlist, Indexed("SUM", range), Polarity::Output);
    Orn_Hdl::Signal* carry = AddPort<Orn_Hdl::ScalarSignal>(*netlist, "CI", Polarity::Input);
    Orn_Hdl::Signal* const carryOut =
        AddPort<Orn_Hdl::ScalarSignal>(*netlist, "CO", Polarity::Output);

    for (int bit = 0; bit < width; ++bit) {
        const std::string number = std::to_string(bit);
        const Orn_Hdl::Instance& cell =
            *AddNew<Orn_Hdl::Instance>(*netlist, "BIT" + number, fullAdder);
        Orn_Hdl::Signal* const next =
            bit + 1 == width ? carryOut : AddNew<Orn_Hdl::ScalarSignal>(*netlist, "CARRY" + number);
        AddBit(*netlist, a, bit)->Connect(cell.GetPin("A"));
        AddBit(*netlist, b, bit)->Connect(cell.GetPin("B"));
        carry->Connect(cell.GetPin("CI"));
        AddBit(*netlist, sum, bit)->Connect(cell.GetPin("S"));
        next->Connect(cell.GetPin("CO"));
        carry = next;
    }
    return netlist;
}

} // namespace

int main(int argc, char** argv) {
    const int width = argc == 2 ? std::atoi(argv[1]) : 0;
    if (width < 1 || width > 1024) {
        std::cerr << "usage: adder WIDTH, from 1 to 1024\n";
        return 2;
    }
    const std::unique_ptr<Orn_Hdl::Netlist> netlist = BuildAdder(width);

    Orn_Hdl::HdlOptions options;
    options.writeHeader = false;
    options.vhdl.suppressConfiguration = true;
    options.vhdl.useDefaultLibrary = false;
    options.vhdl.libraries.Add("IEEE");
    options.vhdl.useClauses.Add("IEEE.std_logic_1164.all");

    Orn_Hdl::TextMemOutStream verilog;
    Orn_Hdl::VerilogNetlister(verilog).WriteNetlist(netlist.get(), options);
    Orn_Hdl::TextMemOutStream vhdl;
    Orn_Hdl::VhdlNetlister(vhdl).WriteNetlist(netlist.get(), &options);
    std::cout << verilog.GetValue().GetView() << vhdl.GetValue().GetView();
}
