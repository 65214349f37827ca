/// \file
/// The upper of the two floors: a bare replay of the benchmark design's command file. Names are
/// views into the file, one open-addressing table finds them, objects know each other by index.
/// Nothing is checked, sorted or kept of the commands; only the commands of that file are known.
#include "text_io.h"

#include <algorithm>
#include <cstdint>
#include <exception>
#include <iostream>
#include <limits>
#include <string>
#include <string_view>
#include <vector>

namespace {

using Index = std::uint32_t;
constexpr Index None = std::numeric_limits<Index>::max();

/// From a name to the index of the component, instance or signal that bears it. The name itself is
/// compared through the vector that the index leads into, which the caller knows.
class NameTable {
public:
    void Add(std::string_view name, Index index) {
        if (++used_ * 2 > slots_.size()) {
            Grow();
        }
        Place({Hash(name), index});
    }

    template <typename Objects> Index Find(std::string_view name, const Objects& objects) const {
        const std::uint32_t hash = Hash(name);
        for (std::size_t at = hash & mask_; slots_[at].index != None; at = (at + 1) & mask_) {
            const Slot& slot = slots_[at];
            if (slot.hash == hash && slot.index < objects.size() &&
                objects[slot.index].name == name) {
                return slot.index;
            }
        }
        return None;
    }

private:
    struct Slot {
        std::uint32_t hash = 0;
        Index index = None;
    };

    static std::uint32_t Hash(std::string_view name) {
        std::uint32_t hash = 2166136261u;
        for (const char character : name) {
            hash = (hash ^ static_cast<unsigned char>(character)) * 16777619u;
        }
        return hash ^ (hash >> 15);
    }

    void Place(Slot slot) {
        std::size_t at = slot.hash & mask_;
        while (slots_[at].index != None) {
            at = (at + 1) & mask_;
        }
        slots_[at] = slot;
    }

    void Grow() {
        std::vector<Slot> old(std::max<std::size_t>(64, slots_.size() * 2));
        old.swap(slots_);
        mask_ = slots_.size() - 1;
        for (const Slot& slot : old) {
            if (slot.index != None) {
                Place(slot);
            }
        }
    }

    std::vector<Slot> slots_;
    std::size_t mask_ = 0;
    std::size_t used_ = 0;
};

struct Component {
    std::string_view name;
    std::vector<std::string_view> pins;
};

struct Signal {
    std::string_view name;
    std::string_view direction; ///< empty unless it is a port
    Index firstPin;             ///< head of the list of its pins
};

struct Instance {
    std::string_view name;
    Index component;
    Index firstPin; ///< its pins stand side by side
    Index firstAttribute;
};

struct Pin {
    Index signal;
    Index nextOfSignal;
};

struct Attribute {
    std::string_view name;
    std::string_view value;
    bool isWritten;
    Index nextOfInstance;
};

class Model {
public:
    void Replay(const bench::FileText& commands) {
        bench::Words words;
        for (const char* at = commands.begin(); at != commands.end();) {
            at = words.Split(at, commands.end());
            Execute(words);
        }
    }

    void WriteVerilog(bench::Output& out, bool onePinPerLine) const {
        out << "`timescale 1ns / 1ps\n\n";
        WritePortList(out);
        WriteDeclarations(out);
        for (const Instance& instance : instances_) {
            WriteInstance(out, instance, onePinPerLine);
        }
        out << "endmodule\n";
    }

private:
    void Execute(const bench::Words& words) {
        if (words[0] == "CONNECT") {
            Connect(words[2], words[3]);
        } else if (words[1] == "INSTANCE" && words[2] == "ATTRIBUTE") {
            ChangeAttribute(words);
        } else if (words[1] == "INSTANCE") {
            AddInstance(words[2], words[3]);
        } else if (words[1] == "SIGNAL") {
            AddSignal(words[2], "");
        } else if (words[1] == "PORT" && words[0] == "ADD") {
            AddSignal(words[2], words[3]);
        } else if (words[1] == "PIN") {
            components_[FindComponent(words[2])].pins.push_back(words[3]);
        } else if (words[1] == "COMPONENT") {
            names_.Add(words[2], static_cast<Index>(components_.size()));
            components_.push_back({words[2], {}});
        } else if (words[1] == "NETLIST") {
            name_ = words[3];
        }
    }

    Index FindComponent(std::string_view name) const { return names_.Find(name, components_); }

    void AddSignal(std::string_view name, std::string_view direction) {
        names_.Add(name, static_cast<Index>(signals_.size()));
        signals_.push_back({name, direction, None});
    }

    void AddInstance(std::string_view componentName, std::string_view name) {
        const Index component = FindComponent(componentName);
        names_.Add(name, static_cast<Index>(instances_.size()));
        instances_.push_back({name, component, static_cast<Index>(pins_.size()), None});
        pins_.resize(pins_.size() + components_[component].pins.size(), {None, None});
    }

    void Connect(std::string_view signalName, std::string_view instanceAndPin) {
        const std::size_t dot = instanceAndPin.find('.');
        const Index signal = names_.Find(signalName, signals_);
        const Instance& instance =
            instances_[names_.Find(instanceAndPin.substr(0, dot), instances_)];
        const std::vector<std::string_view>& pinNames = components_[instance.component].pins;
        const std::string_view pinName = instanceAndPin.substr(dot + 1);
        Index pin = 0;
        while (pinNames[pin] != pinName) {
            ++pin;
        }
        pin += instance.firstPin;
        pins_[pin] = {signal, signals_[signal].firstPin};
        signals_[signal].firstPin = pin;
    }

    /// "ADD INSTANCE ATTRIBUTE instance name value", or the option that has the instance's latest
    /// attribute written.
    void ChangeAttribute(const bench::Words& words) {
        if (words[0] == "ADD") {
            Instance& instance = instances_[names_.Find(words[3], instances_)];
            attributes_.push_back({words[4], words[5], false, instance.firstAttribute});
            instance.firstAttribute = static_cast<Index>(attributes_.size() - 1);
        } else {
            const Instance& instance = instances_[names_.Find(words[4], instances_)];
            attributes_[instance.firstAttribute].isWritten = true;
        }
    }

    void WritePortList(bench::Output& out) const {
        out << "module " << name_ << '(';
        std::string separator;
        for (const Signal& signal : signals_) {
            if (!signal.direction.empty()) {
                out << separator << signal.name;
                separator = ", \n" + std::string(name_.size() + 8, ' ');
            }
        }
        out << ");\n\n";
    }

    void WriteDeclarations(bench::Output& out) const {
        for (const Signal& signal : signals_) {
            if (!signal.direction.empty()) {
                out << (signal.direction == "INPUT" ? "    input " : "   output ") << signal.name
                    << ";\n";
            }
        }
        out << '\n';
        for (const Signal& signal : signals_) {
            if (signal.direction.empty()) {
                out << "   wire " << signal.name << ";\n";
            }
        }
        out << '\n';
    }

    void WriteInstance(bench::Output& out, const Instance& instance, bool onePinPerLine) const {
        const Component& component = components_[instance.component];
        const std::string separator =
            onePinPerLine
                ? ", \n" + std::string(component.name.size() + instance.name.size() + 6, ' ')
                : ", ";
        out << "   " << component.name << ' ' << instance.name << " (";
        for (std::size_t i = 0; i < component.pins.size(); ++i) {
            const Pin& pin = pins_[instance.firstPin + i];
            out << (i == 0 ? std::string_view() : separator) << '.' << component.pins[i] << '('
                << (pin.signal == None ? std::string_view() : signals_[pin.signal].name) << ')';
        }
        out << ");\n";
        for (Index i = instance.firstAttribute; i != None; i = attributes_[i].nextOfInstance) {
            const Attribute& attribute = attributes_[i];
            if (attribute.isWritten) {
                out << "   // synthesis attribute " << attribute.name << " of " << instance.name
                    << " is \"" << attribute.value << "\"\n";
            }
        }
    }

    std::string_view name_;
    NameTable names_;
    std::vector<Component> components_;
    std::vector<Signal> signals_;
    std::vector<Instance> instances_;
    std::vector<Pin> pins_;
    std::vector<Attribute> attributes_;
};

} // namespace

int main(int argc, char** argv) {
    const bool isCompact = argc == 4 && std::string_view(argv[3]) == "--compact";
    if (argc != 3 && !isCompact) {
        std::cerr << "usage: orn_bench_floor_views COMMANDS OUTPUT [--compact]\n"
                     "  --compact: an instance is one line, not one a pin\n";
        return 2;
    }
    try {
        const bench::FileText commands(argv[1]);
        Model model;
        model.Replay(commands);
        bench::Output out(argv[2]);
        model.WriteVerilog(out, !isCompact);
        out.Flush();
    } catch (const std::exception& error) {
        std::cerr << "orn_bench_floor_views: " << error.what() << '\n';
        return 1;
    }
    return 0;
}
