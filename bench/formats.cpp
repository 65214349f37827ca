#include "formats.h"

#include <array>

namespace bench {

namespace {

constexpr std::string_view ModuleName = "bench";
constexpr std::string_view AttributeName = "LOC";

/// So that a name can stand in a chain of writes.
struct Net {
    const Design& design;
    std::size_t index;
    friend Output& operator<<(Output& out, const Net& net) {
        net.design.WriteNetName(out, net.index);
        return out;
    }
};

struct Instance {
    const Design& design;
    std::size_t index;
    friend Output& operator<<(Output& out, const Instance& instance) {
        instance.design.WriteInstanceName(out, instance.index);
        return out;
    }
};

struct AttributeValue {
    const Design& design;
    std::size_t index;
    friend Output& operator<<(Output& out, const AttributeValue& value) {
        value.design.WriteAttributeValue(out, value.index);
        return out;
    }
};

/// Calls `visit(net)` for the clock, then the other input ports.
void ForEachInput(const Design& design, auto visit) {
    visit(design.GetClock());
    for (std::size_t net = design.GetSize(); net < design.GetClock(); ++net) {
        visit(net);
    }
}

void ForEachOutput(const Design& design, auto visit) {
    for (std::size_t net = design.GetInnerNetCount(); net < design.GetSize(); ++net) {
        visit(net);
    }
}

void ForEachInnerNet(const Design& design, auto visit) {
    for (std::size_t net = 0; net < design.GetInnerNetCount(); ++net) {
        visit(net);
    }
}

/// Calls `visit(instance, component)`.
void ForEachInstance(const Design& design, auto visit) {
    for (std::size_t instance = 0; instance < design.GetSize(); ++instance) {
        visit(instance, design.GetComponent(instance));
    }
}

/// Calls `visit(pin name, net, whether it is the first)` for the inputs, then the output.
void ForEachPin(const Design& design, std::size_t instance, const Component& component,
                auto visit) {
    for (std::size_t pin = 0; pin < component.inputs.size(); ++pin) {
        visit(component.inputs[pin], design.GetInputNet(instance, pin), pin == 0);
    }
    visit(component.output, instance, false);
}

void WriteCommands(Output& out, const Design& design) {
    out << "SET NETLIST NAME " << ModuleName << "\nSET SYNTHESIS QSN\nSET PORT ONEPERLINE\n";
    for (const Component& component : Design::GetComponents()) {
        out << "ADD COMPONENT " << component.name << '\n';
        for (const char pin : component.inputs) {
            out << "ADD PIN " << component.name << ' ' << pin << " INPUT\n";
        }
        out << "ADD PIN " << component.name << ' ' << component.output << " OUTPUT\n";
    }
    ForEachInput(design, [&](std::size_t net) {
        out << "ADD PORT " << Net{design, net} << " INPUT\n";
    });
    ForEachOutput(design, [&](std::size_t net) {
        out << "ADD PORT " << Net{design, net} << " OUTPUT\n";
    });
    ForEachInnerNet(design, [&](std::size_t net) {
        out << "ADD SIGNAL " << Net{design, net} << '\n';
    });
    ForEachInstance(design, [&](std::size_t index, const Component& component) {
        const Instance instance{design, index};
        out << "ADD INSTANCE " << component.name << ' ' << instance << '\n';
        if (design.HasAttribute(index)) {
            out << "ADD INSTANCE ATTRIBUTE " << instance << ' ' << AttributeName << ' '
                << AttributeValue{design, index} << '\n';
            out << "SET INSTANCE ATTRIBUTE OPTION " << instance << ' ' << AttributeName
                << " -SYNATTR=ASSIGN\n";
        }
        ForEachPin(design, index, component, [&](char pin, std::size_t net, bool) {
            out << "CONNECT SIGNAL " << Net{design, net} << ' ' << instance << '.' << pin << '\n';
        });
    });
}

void WriteVerilog(Output& out, const Design& design) {
    out << "module " << ModuleName << '(';
    ForEachInput(design, [&](std::size_t net) { out << Net{design, net} << ", "; });
    ForEachOutput(design, [&](std::size_t net) {
        out << (net == design.GetInnerNetCount() ? "" : ", ") << Net{design, net};
    });
    out << ");\n";
    ForEachInput(design, [&](std::size_t net) { out << "  input " << Net{design, net} << ";\n"; });
    ForEachOutput(design, [&](std::size_t net) {
        out << "  output " << Net{design, net} << ";\n";
    });
    ForEachInnerNet(design, [&](std::size_t net) {
        out << "  wire " << Net{design, net} << ";\n";
    });
    ForEachInstance(design, [&](std::size_t index, const Component& component) {
        if (design.HasAttribute(index)) {
            out << "  (* " << AttributeName << " = \"" << AttributeValue{design, index}
                << "\" *)\n";
        }
        out << "  " << component.name << ' ' << Instance{design, index} << " (";
        ForEachPin(design, index, component, [&](char pin, std::size_t net, bool isFirst) {
            out << (isFirst ? "." : ", .") << pin << '(' << Net{design, net} << ')';
        });
        out << ");\n";
    });
    out << "endmodule\n";
}

void WriteRtlil(Output& out, const Design& design) {
    out << "attribute \\top 1\nmodule \\" << ModuleName << '\n';
    std::size_t port = 0;
    ForEachInput(design, [&](std::size_t net) {
        out << "  wire input " << ++port << " \\" << Net{design, net} << '\n';
    });
    ForEachOutput(design, [&](std::size_t net) {
        out << "  wire output " << ++port << " \\" << Net{design, net} << '\n';
    });
    ForEachInnerNet(design, [&](std::size_t net) {
        out << "  wire \\" << Net{design, net} << '\n';
    });
    ForEachInstance(design, [&](std::size_t index, const Component& component) {
        if (design.HasAttribute(index)) {
            out << "  attribute \\" << AttributeName << " \"" << AttributeValue{design, index}
                << "\"\n";
        }
        out << "  cell \\" << component.name << " \\" << Instance{design, index} << '\n';
        ForEachPin(design, index, component, [&](char pin, std::size_t net, bool) {
            out << "    connect \\" << pin << " \\" << Net{design, net} << '\n';
        });
        out << "  end\n";
    });
    out << "end\n";
}

/// The number that stands for a net's bit; 0 and 1 are left out by those who write this format.
std::size_t JsonBit(std::size_t net) {
    return net + 2;
}

void WriteJsonCell(Output& out, const Design& design, std::size_t index,
                   const Component& component) {
    out << (index == 0 ? "\n" : ",\n") << "        \"" << Instance{design, index}
        << "\": {\"hide_name\": 0, \"type\": \"" << component.name
        << "\", \"parameters\": {}, \"attributes\": {";
    if (design.HasAttribute(index)) {
        out << '"' << AttributeName << "\": \"" << AttributeValue{design, index} << '"';
    }
    out << "}, \"port_directions\": {";
    for (const char pin : component.inputs) {
        out << '"' << pin << "\": \"input\", ";
    }
    out << '"' << component.output << "\": \"output\"}, \"connections\": {";
    ForEachPin(design, index, component, [&](char pin, std::size_t net, bool isFirst) {
        out << (isFirst ? "\"" : ", \"") << pin << "\": [" << JsonBit(net) << ']';
    });
    out << "}}";
}

void WriteJson(Output& out, const Design& design) {
    out << "{\n  \"creator\": \"benchmark generator\",\n  \"modules\": {\n    \"" << ModuleName
        << "\": {\n      \"attributes\": {\"top\": \"1\"},\n      \"ports\": {";
    std::string_view separator = "\n";
    const auto writePort = [&](std::string_view direction, std::size_t net) {
        out << separator << "        \"" << Net{design, net} << "\": {\"direction\": \""
            << direction << "\", \"bits\": [" << JsonBit(net) << "]}";
        separator = ",\n";
    };
    ForEachInput(design, [&](std::size_t net) { writePort("input", net); });
    ForEachOutput(design, [&](std::size_t net) { writePort("output", net); });
    out << "\n      },\n      \"cells\": {";
    ForEachInstance(design, [&](std::size_t index, const Component& component) {
        WriteJsonCell(out, design, index, component);
    });
    out << "\n      },\n      \"netnames\": {";
    for (std::size_t net = 0; net < design.GetNetCount(); ++net) {
        out << (net == 0 ? "\n" : ",\n") << "        \"" << Net{design, net}
            << "\": {\"hide_name\": 0, \"bits\": [" << JsonBit(net) << "], \"attributes\": {}}";
    }
    out << "\n      }\n    }\n  }\n}\n";
}

/// Mapped BLIF knows neither instance names nor attributes.
void WriteBlif(Output& out, const Design& design) {
    out << ".model " << ModuleName << "\n.inputs";
    ForEachInput(design, [&](std::size_t net) { out << ' ' << Net{design, net}; });
    out << "\n.outputs";
    ForEachOutput(design, [&](std::size_t net) { out << ' ' << Net{design, net}; });
    out << '\n';
    ForEachInstance(design, [&](std::size_t index, const Component& component) {
        if (component.isFlipFlop) {
            out << ".latch " << Net{design, design.GetInputNet(index, 1)} << ' '
                << Net{design, index} << " re " << Net{design, design.GetClock()} << " 2\n";
            return;
        }
        out << ".gate " << component.name;
        ForEachPin(design, index, component, [&](char pin, std::size_t net, bool) {
            out << ' ' << pin << '=' << Net{design, net};
        });
        out << '\n';
    });
    out << ".end\n";
}

/// The gates that `WriteBlif` names, and a buffer: ABC puts one before a flip-flop that reads a
/// port or another flip-flop, and cannot write it as Verilog when the library has none.
void WriteGenlib(Output& out, const Design&) {
    out << "GATE BUF 1 O=A; PIN * NONINV 1 999 1 0 1 0\n";
    for (const Component& component : Design::GetComponents()) {
        if (!component.isFlipFlop) {
            out << "GATE " << component.name << " 1 " << component.output << '='
                << component.function << "; PIN * INV 1 999 1 0 1 0\n";
        }
    }
}

constexpr std::array<Format, 6> Formats = {{
    {"commands", "command file", WriteCommands},
    {"verilog", "structural Verilog, cells as black boxes", WriteVerilog},
    {"rtlil", "text form of the Yosys netlist", WriteRtlil},
    {"json", "JSON netlist as Yosys writes it", WriteJson},
    {"blif", "mapped BLIF, for the gates of genlib", WriteBlif},
    {"genlib", "the gates that blif names", WriteGenlib},
}};

} // namespace

std::span<const Format> GetFormats() noexcept {
    return Formats;
}

} // namespace bench
