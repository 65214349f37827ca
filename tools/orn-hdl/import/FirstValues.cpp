#include "import/FirstValues.h"

#include "import/CellModels.h"

#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

namespace Tool::Import {

namespace {

constexpr std::string_view Output = "Q";
constexpr std::string_view Parameter = "INIT";
/// What VHDL's std_logic has before anything is assigned.
constexpr char Uninitialised = 'U';
constexpr std::uint32_t NoPin = 0xFFFFFFFF;

/// Calls `look` with each bit of a net and its digit of the net's first value, if both are known.
template <class Look>
void ForEachKnown(const Module& module, const FirstValue& value, const Look& look) {
    const Span& bits = module.nets[value.net].bits;
    const std::size_t count = std::min<std::size_t>(bits.count, value.digits.size());
    for (std::size_t i = 0; i < count; ++i) {
        const Bit bit = module.GetBit(bits, static_cast<std::uint32_t>(i));
        const char digit = value.digits[value.digits.size() - 1 - i];
        if (IsNet(bit) && (digit == '0' || digit == '1')) {
            look(bit, digit);
        }
    }
}

class FirstValueSetter {
public:
    explicit FirstValueSetter(ImportedDesign& design);

    void SetAll();

private:
    /// What is known of a module's net bits.
    enum class State : std::uint8_t { Unknown, Zero, One, Taken };
    using States = std::vector<State>;

    static States GetStates(const Module& module);
    const Span* FindOutput(const Module& module, const Cell& cell) const;
    void FindTypes(const Module& module, const States& states);
    void SetCells(Module& module, States& states);
    void SetCell(Module& module, Cell& cell, const Span& bits, States& states);
    static void DropTaken(Module& module, const States& states);

    ImportedDesign& design_;
    /// By the index of the type: the pin that a register drives, and whether one has a first value.
    std::vector<std::uint32_t> outputs_;
    std::vector<bool> isNeeded_;
};

FirstValueSetter::FirstValueSetter(ImportedDesign& design)
    : design_(design), isNeeded_(design.types.size()) {
    for (const CellType& type : design.types) {
        const auto pin = type.pinIndex.find(Output);
        const bool isRegister = pin != type.pinIndex.end() && HasModelWithFirstValue(type.name);
        outputs_.push_back(isRegister ? pin->second : NoPin);
    }
}

FirstValueSetter::States FirstValueSetter::GetStates(const Module& module) {
    States states;
    for (const FirstValue& value : module.firstValues) {
        ForEachKnown(module, value, [&](Bit bit, char digit) {
            states.resize(module.netBits);
            states[bit] = digit == '1' ? State::One : State::Zero;
        });
    }
    return states;
}

/// The bits that a register drives; null if the cell is none.
const Span* FirstValueSetter::FindOutput(const Module& module, const Cell& cell) const {
    const std::uint32_t pin = outputs_[cell.type];
    for (std::uint32_t i = 0; pin != NoPin && i < cell.connections.count; ++i) {
        const Connection& connection = module.connections[cell.connections.start + i];
        if (connection.pin == pin) {
            return &connection.bits;
        }
    }
    return nullptr;
}

void FirstValueSetter::FindTypes(const Module& module, const States& states) {
    for (const Cell& cell : module.cells) {
        const Span* const bits = states.empty() ? nullptr : FindOutput(module, cell);
        for (std::uint32_t i = 0; bits != nullptr && i < bits->count; ++i) {
            const Bit bit = module.GetBit(*bits, i);
            if (IsNet(bit) && states[bit] != State::Unknown) {
                isNeeded_[cell.type] = true;
            }
        }
    }
}

void FirstValueSetter::SetCells(Module& module, States& states) {
    for (Cell& cell : module.cells) {
        if (isNeeded_[cell.type]) {
            const Span* const bits = FindOutput(module, cell);
            SetCell(module, cell, bits == nullptr ? Span() : *bits, states);
        }
    }
}

void FirstValueSetter::SetCell(Module& module, Cell& cell, const Span& bits, States& states) {
    std::string digits;
    for (std::uint32_t i = bits.count; i-- > 0;) {
        const Bit bit = module.GetBit(bits, i);
        State unknown = State::Unknown;
        State& state = IsNet(bit) && !states.empty() ? states[bit] : unknown;
        digits += state == State::Zero ? '0' : state == State::One ? '1' : Uninitialised;
        state = state == State::Unknown ? state : State::Taken;
    }
    const Span former = cell.parameters;
    cell.parameters = Span{static_cast<std::uint32_t>(module.values.size()), former.count + 1};
    for (std::uint32_t i = 0; i < former.count; ++i) {
        const NamedValue value = module.values[former.start + i];
        module.values.push_back(value);
    }
    module.values.push_back({Parameter, Value{Value::Text, design_.Keep(digits), 0}});
}

/// Drops the first values that registers have.
void FirstValueSetter::DropTaken(Module& module, const States& states) {
    const auto isTaken = [&](const FirstValue& value) {
        bool result = !states.empty();
        ForEachKnown(module, value, [&](Bit bit, char /*digit*/) {
            result = result && states[bit] == State::Taken;
        });
        return result;
    };
    module.firstValues.erase(
        std::remove_if(module.firstValues.begin(), module.firstValues.end(), isTaken),
        module.firstValues.end());
}

void FirstValueSetter::SetAll() {
    for (const Module& module : design_.modules) {
        FindTypes(module, GetStates(module));
    }
    for (Module& module : design_.modules) {
        States states = GetStates(module);
        SetCells(module, states);
        DropTaken(module, states);
    }
}

} // namespace

void SetFirstValues(ImportedDesign& design) {
    FirstValueSetter(design).SetAll();
}

} // namespace Tool::Import
