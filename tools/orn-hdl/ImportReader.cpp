#include "ImportReader.h"

#include <simdjson.h>

#include <algorithm>
#include <limits>
#include <unordered_set>
#include <utility>

namespace Tool::Import {

namespace {

namespace ondemand = simdjson::ondemand;

/// Deeper nesting than any netlist has, and less than would harm the stack.
constexpr std::size_t DeepestNesting = 200;

/// The type of cells without pins that only tell where flattened cells came from.
constexpr std::string_view ScopeInfo("$scopeinfo");

/// Gives the numbers of net bits consecutive indices. Numbers up to `limit` have a table; a file
/// written by a program has no others, and one that has must not make that table huge.
class BitNumbers {
public:
    explicit BitNumbers(std::size_t limit) : limit_(limit) {}

    Bit GetIndex(std::int64_t number) {
        const auto place = static_cast<std::uint64_t>(number);
        if (place > limit_) {
            return Claim(others_.try_emplace(number, NoIndex).first->second);
        }
        if (place >= table_.size()) {
            table_.resize(std::max<std::size_t>(place + 1, table_.size() * 2), NoIndex);
        }
        return Claim(table_[place]);
    }
    std::uint32_t GetCount() const noexcept { return count_; }

private:
    static constexpr Bit NoIndex = 0xFFFFFFFF;

    Bit Claim(Bit& index) {
        if (index == NoIndex) {
            index = count_++;
        }
        return index;
    }

    std::size_t limit_;
    std::uint32_t count_ = 0;
    std::vector<Bit> table_;
    std::unordered_map<std::int64_t, Bit> others_;
};

class Reader {
public:
    Reader(Design& design, bool keepAttributes)
        : design_(design), keepAttributes_(keepAttributes) {}

    void Read(std::string text) {
        fileSize_ = text.size();
        text.resize(fileSize_ + simdjson::SIMDJSON_PADDING);
        // Outside of the try block: the message of a failure needs the keys that it holds.
        ondemand::parser parser;
        try {
            ondemand::document document = parser.iterate(text.data(), fileSize_, text.size());
            ondemand::value root = document.get_value();
            ReadFile(root);
            if (document.current_location().error() != simdjson::OUT_OF_BOUNDS) {
                Fail("nothing may follow the netlist");
            }
        } catch (const simdjson::simdjson_error& error) {
            Fail(std::string("no valid JSON: ") + simdjson::error_message(error.error()));
        }
    }

private:
    /// A step of the way from the top of the file to the present value.
    struct Step {
        std::string_view key;
        std::size_t index;
    };
    static constexpr std::size_t NoIndex = std::numeric_limits<std::size_t>::max();

    [[noreturn]] void Fail(const std::string& text) const {
        Path path;
        for (const Step& step : steps_) {
            step.index == NoIndex ? path.AddKey(step.key) : path.AddIndex(step.index);
        }
        throw Error(path.GetText() + (steps_.empty() ? "" : ": ") + text);
    }

    // Walking. A walk that fails leaves its steps in place, for the message.

    template <class Visit> void ForEachField(ondemand::value& value, Visit visit) {
        if (value.type() != ondemand::json_type::object) {
            Fail("an object is expected");
        }
        for (auto field : value.get_object()) {
            const std::string_view key = field.unescaped_key();
            steps_.push_back(Step{key, NoIndex});
            CheckDepth();
            ondemand::value member = field.value();
            visit(key, member);
            steps_.pop_back();
        }
    }

    template <class Visit> void ForEachElement(ondemand::value& value, Visit visit) {
        if (value.type() != ondemand::json_type::array) {
            Fail("a list is expected");
        }
        std::size_t index = 0;
        for (auto element : value.get_array()) {
            steps_.push_back(Step{std::string_view(), index++});
            CheckDepth();
            ondemand::value member = element.value();
            visit(member);
            steps_.pop_back();
        }
    }

    void CheckDepth() const {
        if (steps_.size() > DeepestNesting) {
            Fail("nested too deeply");
        }
    }

    /// Walks over a value that is not needed.
    void Skip(ondemand::value& value) {
        switch (value.type()) {
        case ondemand::json_type::object:
            ForEachField(value, [this](std::string_view, ondemand::value& v) { Skip(v); });
            break;
        case ondemand::json_type::array:
            ForEachElement(value, [this](ondemand::value& v) { Skip(v); });
            break;
        case ondemand::json_type::string:
            std::ignore = std::string_view(value.get_string());
            break;
        case ondemand::json_type::number:
            std::ignore = double(value.get_double());
            break;
        case ondemand::json_type::boolean:
            std::ignore = bool(value.get_bool());
            break;
        case ondemand::json_type::null:
            if (!value.is_null()) {
                Fail("no valid JSON");
            }
            break;
        }
    }

    // Plain values.

    std::string_view ReadText(ondemand::value& value) {
        if (value.type() != ondemand::json_type::string) {
            Fail("a text is expected");
        }
        return value.get_string();
    }

    std::int64_t ReadInteger(ondemand::value& value) {
        std::int64_t number = 0;
        if (value.type() != ondemand::json_type::number || value.get_int64().get(number)) {
            Fail("an integer is expected");
        }
        return number;
    }

    bool ReadFlag(ondemand::value& value) { return ReadInteger(value) != 0; }

    /// The value of a parameter or attribute. Digits are a bit vector; a text that would look like
    /// one has blanks behind it, one more than belong to it.
    Value ReadValue(ondemand::value& value) {
        Value result;
        if (value.type() == ondemand::json_type::number) {
            const std::int64_t number = ReadInteger(value);
            result.kind = Value::Integer;
            result.integer = static_cast<std::int32_t>(number);
            if (result.integer != number) {
                Fail("the number does not fit 32 bits");
            }
            return result;
        }
        std::string_view text = ReadText(value);
        const std::size_t digits = std::min(text.find_first_not_of("01xz"), text.size());
        const std::size_t end = std::min(text.find_first_not_of(' ', digits), text.size());
        if (digits > 0 && digits == text.size()) {
            result.kind = Value::Bits;
        } else if (end == text.size() && end > digits) {
            text.remove_suffix(1);
        }
        result.text = design_.Keep(text);
        return result;
    }

    Span ReadValues(Module& module, ondemand::value& value) {
        const auto start = static_cast<std::uint32_t>(module.values.size());
        ForEachField(value, [&](std::string_view name, ondemand::value& member) {
            module.values.push_back(NamedValue{design_.Keep(name), ReadValue(member)});
        });
        return Span{start, static_cast<std::uint32_t>(module.values.size()) - start};
    }

    Bit ReadBit(ondemand::value& value) {
        if (value.type() == ondemand::json_type::number) {
            const std::int64_t number = ReadInteger(value);
            if (number < 0) {
                Fail("the number of a net is negative");
            }
            return bitNumbers_->GetIndex(number);
        }
        const std::string_view text = ReadText(value);
        const std::size_t constant = std::string_view("01xz").find(text);
        if (text.size() != 1 || constant == std::string_view::npos) {
            Fail("a bit is a number or one of \"0\", \"1\", \"x\" and \"z\"");
        }
        return Zero + static_cast<Bit>(constant);
    }

    Span ReadBits(Module& module, ondemand::value& value) {
        const auto start = static_cast<std::uint32_t>(module.bits.size());
        ForEachElement(value,
                       [&](ondemand::value& member) { module.bits.push_back(ReadBit(member)); });
        return Span{start, static_cast<std::uint32_t>(module.bits.size()) - start};
    }

    Direction ReadDirection(ondemand::value& value) {
        const std::string_view text = ReadText(value);
        if (text == "input") {
            return Direction::Input;
        }
        if (text == "output") {
            return Direction::Output;
        }
        if (text != "inout") {
            Fail("a direction is \"input\", \"output\" or \"inout\"");
        }
        return Direction::InOut;
    }

    // The parts of a netlist.

    void ReadFile(ondemand::value& root) {
        bool hasModules = false;
        ForEachField(root, [&](std::string_view key, ondemand::value& value) {
            if (key == "modules") {
                hasModules = true;
                ForEachNamed(value, [&](std::string_view name, ondemand::value& module) {
                    ReadModule(name, module);
                });
            } else {
                Skip(value);
            }
        });
        if (!hasModules) {
            Fail("no netlist: \"modules\" is missing");
        }
    }

    /// As `ForEachField`, refusing a second field of a name.
    template <class Visit> void ForEachNamed(ondemand::value& value, Visit visit) {
        std::pmr::monotonic_buffer_resource memory;
        std::pmr::unordered_set<std::string_view> names(&memory);
        ForEachField(value, [&](std::string_view name, ondemand::value& member) {
            const std::string_view kept = design_.Keep(name);
            if (!names.insert(kept).second) {
                Fail("the name occurs twice");
            }
            visit(kept, member);
        });
    }

    void ReadModule(std::string_view name, ondemand::value& value) {
        Module& module = design_.modules.emplace_back();
        module.name = name;
        BitNumbers bitNumbers(fileSize_);
        bitNumbers_ = &bitNumbers;
        ForEachField(value, [&](std::string_view key, ondemand::value& part) {
            if (key == "attributes") {
                ReadModuleAttributes(module, part);
            } else if (key == "parameter_default_values") {
                ForEachField(part, [&](std::string_view parameter, ondemand::value& v) {
                    module.defaults.push_back(NamedValue{design_.Keep(parameter), ReadValue(v)});
                });
            } else if (key == "ports") {
                ForEachNamed(part, [&](std::string_view port, ondemand::value& v) {
                    ReadPort(module, port, v);
                });
            } else if (key == "cells") {
                ForEachNamed(part, [&](std::string_view cell, ondemand::value& v) {
                    ReadCell(module, cell, v);
                });
            } else if (key == "netnames") {
                ForEachNamed(part, [&](std::string_view net, ondemand::value& v) {
                    ReadNet(module, net, v);
                });
            } else if (key == "memories") {
                ForEachField(part, [&](std::string_view, ondemand::value& v) {
                    module.hasMemories = true;
                    Skip(v);
                });
            } else {
                Skip(part);
            }
        });
        module.netBits = bitNumbers.GetCount();
    }

    void ReadModuleAttributes(Module& module, ondemand::value& value) {
        ForEachField(value, [&](std::string_view key, ondemand::value& attribute) {
            const Value v = ReadValue(attribute);
            const bool isSet = v.kind == Value::Integer
                                   ? v.integer != 0
                                   : v.text.find_first_not_of("0xz") != std::string_view::npos;
            module.blackBox |= isSet && (key == "blackbox" || key == "whitebox");
            module.top |= isSet && key == "top";
        });
    }

    bool ReadRange(std::string_view key, ondemand::value& value, Range& range) {
        if (key == "offset") {
            range.offset = ReadInteger(value);
        } else if (key == "upto") {
            range.upto = ReadFlag(value);
        } else {
            return false;
        }
        return true;
    }

    void ReadPort(Module& module, std::string_view name, ondemand::value& value) {
        ModulePort port;
        port.name = name;
        ForEachField(value, [&](std::string_view key, ondemand::value& part) {
            if (key == "direction") {
                port.direction = ReadDirection(part);
            } else if (key == "bits") {
                port.bits = ReadBits(module, part);
            } else if (!ReadRange(key, part, port.range)) {
                Skip(part);
            }
        });
        if (port.direction == Direction::Untold) {
            Fail("a port needs a direction");
        }
        if (port.bits.count == 0) {
            Fail("a port needs at least one bit");
        }
        module.ports.push_back(port);
    }

    void ReadNet(Module& module, std::string_view name, ondemand::value& value) {
        Net net;
        net.name = name;
        ForEachField(value, [&](std::string_view key, ondemand::value& part) {
            if (key == "hide_name") {
                net.hidden = ReadFlag(part);
            } else if (key == "bits") {
                net.bits = ReadBits(module, part);
            } else if (key == "attributes" && keepAttributes_) {
                net.attributes = ReadValues(module, part);
            } else if (!ReadRange(key, part, net.range)) {
                Skip(part);
            }
        });
        module.nets.push_back(net);
    }

    void ReadCell(Module& module, std::string_view name, ondemand::value& value) {
        Cell cell;
        cell.name = name;
        std::string_view type;
        connections_.clear();
        directions_.clear();
        ForEachField(value, [&](std::string_view key, ondemand::value& part) {
            if (key == "hide_name") {
                cell.hidden = ReadFlag(part);
            } else if (key == "type") {
                type = ReadText(part);
            } else if (key == "parameters") {
                cell.parameters = ReadValues(module, part);
            } else if (key == "attributes" && keepAttributes_) {
                cell.attributes = ReadValues(module, part);
            } else if (key == "port_directions") {
                ForEachField(part, [&](std::string_view pin, ondemand::value& v) {
                    directions_.emplace_back(pin, ReadDirection(v));
                });
            } else if (key == "connections") {
                ForEachField(part, [&](std::string_view pin, ondemand::value& v) {
                    connections_.emplace_back(pin, ReadBits(module, v));
                });
            } else {
                Skip(part);
            }
        });
        if (type.empty()) {
            Fail("a cell needs a type");
        }
        if (type == ScopeInfo) {
            return;
        }
        cell.type = GetOrAddType(type);
        AddPins(module, cell);
        module.cells.push_back(cell);
    }

    std::uint32_t GetOrAddType(std::string_view name) {
        const auto known = typeIndex_.find(name);
        if (known != typeIndex_.end()) {
            return known->second;
        }
        const auto index = static_cast<std::uint32_t>(design_.types.size());
        CellType& type = design_.types.emplace_back();
        type.name = design_.Keep(name);
        typeIndex_.emplace(type.name, index);
        return index;
    }

    std::uint32_t GetOrAddPin(CellType& type, std::string_view name) {
        const auto known = type.pinIndex.find(name);
        return known != type.pinIndex.end() ? known->second : type.GetOrAddPin(design_.Keep(name));
    }

    /// Enters the pins of the cell that was just read into its type.
    void AddPins(Module& module, Cell& cell) {
        CellType& type = design_.types[cell.type];
        for (const auto& [name, direction] : directions_) {
            TypePin& pin = type.pins[GetOrAddPin(type, name)];
            if (pin.direction == Direction::Untold) {
                pin.direction = direction;
            }
        }
        cell.connections.start = static_cast<std::uint32_t>(module.connections.size());
        cell.connections.count = static_cast<std::uint32_t>(connections_.size());
        ++cellStamp_;
        for (const auto& [name, bits] : connections_) {
            const std::uint32_t pin = GetOrAddPin(type, name);
            if (pinStamps_.size() <= pin) {
                pinStamps_.resize(pin + 1);
            }
            if (std::exchange(pinStamps_[pin], cellStamp_) == cellStamp_) {
                steps_.push_back(Step{"connections", NoIndex});
                steps_.push_back(Step{name, NoIndex});
                Fail("the pin is connected twice");
            }
            module.connections.push_back(Connection{pin, bits});
        }
    }

    Design& design_;
    const bool keepAttributes_;
    std::size_t fileSize_ = 0;
    std::vector<Step> steps_;
    BitNumbers* bitNumbers_ = nullptr;
    std::unordered_map<std::string_view, std::uint32_t> typeIndex_;

    // Of the present cell; members so that a cell costs no allocation.
    std::vector<std::pair<std::string_view, Span>> connections_;
    std::vector<std::pair<std::string_view, Direction>> directions_;
    /// For each pin, the cell that had it last.
    std::vector<std::uint64_t> pinStamps_;
    std::uint64_t cellStamp_ = 0;
};

} // namespace

std::unique_ptr<Design> ReadDesign(std::string text, bool keepAttributes) {
    auto design = std::make_unique<Design>();
    Reader(*design, keepAttributes).Read(std::move(text));
    return design;
}

bool IsLeaf(const Module& module) {
    if (module.blackBox) {
        return true;
    }
    // Without cells, an output that is anything but a bit of its own is driven in the module.
    std::vector<bool> taken(module.netBits);
    const auto isFree = [&](Bit bit) {
        const bool result = IsNet(bit) && !taken[bit];
        if (result) {
            taken[bit] = true;
        }
        return result;
    };
    return module.cells.empty() &&
           std::all_of(module.ports.begin(), module.ports.end(), [&](const ModulePort& port) {
               const auto first = module.bits.begin() + port.bits.start;
               return std::all_of(first, first + port.bits.count, isFree);
           });
}

namespace {

Module& FindModule(Design& design, std::string_view name) {
    for (Module& module : design.modules) {
        if (module.name == name) {
            return module;
        }
    }
    throw Error(std::string("modules: there is no module \"").append(name).append("\""));
}

} // namespace

Module& FindTop(Design& design, std::string_view name) {
    if (!name.empty()) {
        return FindModule(design, name);
    }
    std::vector<Module*> marked;
    std::vector<Module*> full;
    for (Module& module : design.modules) {
        if (module.top) {
            marked.push_back(&module);
        }
        if (!module.blackBox) {
            full.push_back(&module);
        }
    }
    const std::vector<Module*>& candidates = marked.empty() ? full : marked;
    if (candidates.size() != 1) {
        throw Error(candidates.empty()
                        ? "modules: there is no module with contents"
                        : "modules: several modules could be the top one; name it with --top");
    }
    return *candidates.front();
}

} // namespace Tool::Import
