#include "shapes.h"

#include "design.h"

#include <array>
#include <string>
#include <string_view>

namespace bench {

namespace {

/// One net with `size` loads.
void WriteClock(Output& out, std::size_t size) {
    out << "ADD COMPONENT LOAD\nADD PIN LOAD C INPUT\nADD PORT clk INPUT\n";
    for (std::size_t k = 0; k < size; ++k) {
        out << "ADD INSTANCE LOAD u" << k << "\nCONNECT SIGNAL clk u" << k << ".C\n";
    }
}

/// `size` signals in four chains: long enough that recursion along a chain overflows a stack.
void WriteAliasChain(Output& out, std::size_t size) {
    const std::size_t chainLength = size / 4;
    for (std::size_t k = 0; k < size; ++k) {
        out << "ADD SIGNAL s" << k << '\n';
    }
    for (std::size_t k = 1; k < size; ++k) {
        if (k % chainLength != 0) {
            out << "CONNECT SIGNAL s" << k - 1 << " s" << k << '\n';
        }
    }
}

/// A ring of `size` inverters, each driving an output port that the next one reads.
void WriteReadback(Output& out, std::size_t size) {
    out << "ADD COMPONENT INV\nADD PIN INV A INPUT\nADD PIN INV O OUTPUT\n";
    for (std::size_t k = 0; k < size; ++k) {
        out << "ADD PORT q" << k << " OUTPUT\n";
    }
    for (std::size_t k = 0; k < size; ++k) {
        out << "ADD INSTANCE INV u" << k << '\n'
            << "CONNECT SIGNAL q" << (k + size - 1) % size << " u" << k << ".A\n"
            << "CONNECT SIGNAL q" << k << " u" << k << ".O\n";
    }
}

/// `size` / 50 compounds of one bit from each of 32 buses. The buses are output ports that the
/// compounds read, so that every compound's members are replaced when the netlist is written.
void WriteCompounds(Output& out, std::size_t size) {
    constexpr std::size_t Buses = 32;
    constexpr std::size_t BusWidth = 16;
    out << "ADD COMPONENT SOURCE\nADD PIN SOURCE O(15:0) OUTPUT\n"
           "ADD COMPONENT SINK\nADD PIN SINK D(31:0) INPUT\n";
    for (std::size_t bus = 0; bus < Buses; ++bus) {
        out << "ADD PORT b" << bus << "(15:0) OUTPUT\n"
            << "ADD INSTANCE SOURCE source" << bus << '\n'
            << "CONNECT SIGNAL b" << bus << "(15:0) source" << bus << ".O(15:0)\n";
    }
    for (std::size_t k = 0; k < size / 50; ++k) {
        out << "ADD INSTANCE SINK sink" << k << "\nCONNECT SIGNAL ";
        for (std::size_t bus = 0; bus < Buses; ++bus) {
            out << (bus == 0 ? "b" : ",b") << bus << '(' << Random(0, k, bus) % BusWidth << ')';
        }
        out << " sink" << k << ".D(31:0)\n";
    }
}

/// One component with `size` pins, every second one an output, and one instance of it.
void WriteWideComponent(Output& out, std::size_t size) {
    out << "ADD COMPONENT WIDE\n";
    for (std::size_t k = 0; k < size; ++k) {
        out << "ADD PIN WIDE p" << k << (k % 2 == 0 ? " INPUT\n" : " OUTPUT\n");
    }
    out << "ADD INSTANCE WIDE u\n";
    for (std::size_t k = 0; k < size; ++k) {
        out << "CONNECT SIGNAL n" << k << " u.p" << k << '\n';
    }
}

/// `size` parts of one bus, single bits and slices of two in turn.
void WriteSlices(Output& out, std::size_t size) {
    out << "ADD COMPONENT ONE\nADD PIN ONE A INPUT\n"
           "ADD COMPONENT TWO\nADD PIN TWO A(1:0) INPUT\n"
           "ADD SIGNAL d("
        << size << ":0)\n";
    for (std::size_t k = 0; k < size; k += 2) {
        out << "ADD INSTANCE ONE u" << k << "\nCONNECT SIGNAL d(" << k << ") u" << k << ".A\n";
        out << "ADD INSTANCE TWO u" << k + 1 << "\nCONNECT SIGNAL d(" << k + 1 << ':' << k << ") u"
            << k + 1 << ".A(1:0)\n";
    }
}

/// One bus that `size` connections make wider by a bit each.
void WriteWiden(Output& out, std::size_t size) {
    out << "ADD COMPONENT LOAD\nADD PIN LOAD A INPUT\n";
    for (std::size_t k = 0; k < size; ++k) {
        out << "ADD INSTANCE LOAD u" << k << "\nCONNECT SIGNAL d(" << k << ":0) u" << k << ".A\n";
    }
}

/// `size` buses that are each widened once.
void WriteWidenMany(Output& out, std::size_t size) {
    out << "ADD COMPONENT LOAD\nADD PIN LOAD A(7:0) INPUT\nADD INSTANCE LOAD u\n";
    for (std::size_t k = 0; k < size; ++k) {
        out << "ADD SIGNAL b" << k << "(3:0)\n";
    }
    for (std::size_t k = 0; k < size; ++k) {
        out << "CONNECT SIGNAL b" << k << "(7:0) u.A(7:0)\n";
    }
}

/// One bus that is widened `size` times, each time between two of its bits.
void WriteWidenBits(Output& out, std::size_t size) {
    out << "ADD COMPONENT LOAD\nADD PIN LOAD A INPUT\nADD PIN LOAD B INPUT\n";
    for (std::size_t k = 0; k < size; ++k) {
        out << "ADD INSTANCE LOAD u" << k << "\nCONNECT SIGNAL d(" << k << ":0) u" << k
            << ".A\nCONNECT SIGNAL d(" << k << ") u" << k << ".B\n";
    }
}

/// One compound that has a bus as each of its `size` members, which is widened then.
void WriteRepeatedMember(Output& out, std::size_t size) {
    out << "ADD COMPONENT LOAD\nADD PIN LOAD A INPUT\nADD INSTANCE LOAD u\nADD SIGNAL d(1:0)\n"
           "CONNECT SIGNAL d(1:0)";
    for (std::size_t k = 1; k < size; ++k) {
        out << ",d(1:0)";
    }
    out << " u.A\nCONNECT SIGNAL d(2:0) u.A\n";
}

/// `size` compounds, each of which has a bus as a member that the next one widens.
void WriteWidenMembers(Output& out, std::size_t size) {
    out << "ADD COMPONENT LOAD\nADD PIN LOAD A INPUT\nADD SIGNAL x\n";
    for (std::size_t k = 0; k < size; ++k) {
        out << "ADD INSTANCE LOAD u" << k << "\nCONNECT SIGNAL d(" << k + 1 << ":0),x u" << k
            << ".A\n";
    }
}

/// `size` components with one instance each, in a row.
void WriteComponents(Output& out, std::size_t size) {
    for (std::size_t k = 0; k < size; ++k) {
        out << "ADD COMPONENT c" << k << '\n'
            << "ADD PIN c" << k << " A INPUT\n"
            << "ADD PIN c" << k << " O OUTPUT\n"
            << "ADD INSTANCE c" << k << " u" << k << '\n'
            << "CONNECT SIGNAL n" << k << " u" << k << ".A\n"
            << "CONNECT SIGNAL n" << k + 1 << " u" << k << ".O\n";
    }
}

/// `size` attributes on the module, all written as parameters.
void WriteAttributes(Output& out, std::size_t size) {
    for (std::size_t k = 0; k < size; ++k) {
        out << "ADD MODULE ATTRIBUTE a" << k << " value" << k << '\n'
            << "SET MODULE ATTRIBUTE OPTION a" << k << " -GENERIC=SYN\n";
    }
}

/// A module comment of `size` bytes: lines of 1000 characters, made of short words.
void WriteComment(Output& out, std::size_t size) {
    constexpr std::size_t LineLength = 1000;
    constexpr std::size_t WordLength = 8;
    for (std::size_t line = 0; line * LineLength < size; ++line) {
        out << "ADD NOTES ";
        for (std::size_t column = 0; column < LineLength; ++column) {
            const bool isBlank = column % (WordLength + 1) == WordLength;
            out << (isBlank ? ' ' : static_cast<char>('a' + (line + column * 7) % 26));
        }
        out << '\n';
    }
}

/// `size` instances and nets, whose names have 4 kB and differ at their ends.
void WriteLongNames(Output& out, std::size_t size) {
    const std::string common(4000, 'x');
    out << "ADD COMPONENT INV\nADD PIN INV A INPUT\nADD PIN INV O OUTPUT\n";
    for (std::size_t k = 0; k < size; ++k) {
        out << "ADD INSTANCE INV u" << common << k << "\nCONNECT SIGNAL n" << common
            << (k + size - 1) % size << " u" << common << k << ".A\nCONNECT SIGNAL n" << common << k
            << " u" << common << k << ".O\n";
    }
}

/// The frame of a JSON netlist around cells that `writeCells` writes.
template <class WriteCells> void WriteModule(Output& out, WriteCells writeCells) {
    out << R"({"modules": {"shape": {"ports": {"p": {"direction": "input", "bits": [2]}}, )"
        << R"("cells": {)" << '\n';
    writeCells();
    out << R"(}, "netnames": {}}}})" << '\n';
}

/// One imported cell: its number, its only parameter's name, its only pin's name and net.
void WriteCell(Output& out, std::size_t cell, std::string_view parameter, std::size_t pin,
               std::size_t net) {
    out << (cell == 0 ? "" : ",\n") << R"("u)" << cell << R"(": {"type": "C", "parameters": {"P)"
        << parameter << R"(": "1"}, "port_directions": {"A)" << pin
        << R"(": "input"}, "connections": {"A)" << pin << R"(": [)" << net << "]}}";
}

/// One imported cell with `size` parameters.
void WriteImportedParameters(Output& out, std::size_t size) {
    WriteModule(out, [&] {
        out << R"("u": {"type": "C", "parameters": {)";
        for (std::size_t k = 0; k < size; ++k) {
            out << (k == 0 ? R"("P)" : R"(, "P)") << k << R"(": "1")";
        }
        out << R"(}, "port_directions": {"A": "input"}, "connections": {"A": [2]}})";
    });
}

/// `size` imported cells of one type, each of which adds a parameter to it.
void WriteImportedTypes(Output& out, std::size_t size) {
    WriteModule(out, [&] {
        for (std::size_t k = 0; k < size; ++k) {
            WriteCell(out, k, std::to_string(k), 0, 2);
        }
    });
}

/// `size` imported cells of one type, each of which adds a pin to it.
void WriteImportedPins(Output& out, std::size_t size) {
    WriteModule(out, [&] {
        for (std::size_t k = 0; k < size; ++k) {
            WriteCell(out, k, "", k, 2);
        }
    });
}

/// `size` imported cells on bits whose numbers are far apart.
void WriteImportedBits(Output& out, std::size_t size) {
    constexpr std::size_t Distance = 100'003;
    WriteModule(out, [&] {
        for (std::size_t k = 0; k < size; ++k) {
            WriteCell(out, k, "", 0, 3 + k * Distance);
        }
    });
}

constexpr std::array<Shape, 19> Shapes = {{
    {"clock", "one net with N loads", WriteClock},
    {"alias-chain", "N signals aliased in four chains", WriteAliasChain},
    {"readback", "N output ports that are read inside", WriteReadback},
    {"compounds", "N/50 compounds of 32 members over the same buses", WriteCompounds},
    {"wide-component", "one component with N pins", WriteWideComponent},
    {"slices", "N slices and bits of one bus", WriteSlices},
    {"widen", "one bus widened N times", WriteWiden},
    {"widen-many", "N buses, each widened once", WriteWidenMany},
    {"widen-bits", "one bus widened N times between its bits", WriteWidenBits},
    {"widen-members", "N compounds, whose members are widened", WriteWidenMembers},
    {"repeated-member", "one compound that repeats a bus N times", WriteRepeatedMember},
    {"components", "N components, one instance each", WriteComponents},
    {"attributes", "N attributes on the module", WriteAttributes},
    {"comment", "a comment of N bytes", WriteComment},
    {"long-names", "N instances and nets with names of 4 kB", WriteLongNames},
    {"import-parameters", "an imported cell with N parameters", WriteImportedParameters,
     Reader::Import},
    {"import-types", "N imported cells, each adds a parameter to their type", WriteImportedTypes,
     Reader::Import},
    {"import-pins", "N imported cells, each adds a pin to their type", WriteImportedPins,
     Reader::Import},
    {"import-bits", "N imported cells on bits with numbers far apart", WriteImportedBits,
     Reader::Import},
}};

} // namespace

std::span<const Shape> GetShapes() noexcept {
    return Shapes;
}

} // namespace bench
