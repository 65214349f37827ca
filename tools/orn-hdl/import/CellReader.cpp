#include "import/CellReader.h"

#include <algorithm>
#include <iterator>

namespace Tool::Import {

namespace {

/// The type of cells without pins that only record the origin of flattened cells.
constexpr std::string_view ScopeInfo("$scopeinfo");

/// The type of cells that are state machines, and the parameters that are their tables.
constexpr std::string_view StateMachine("$fsm");
constexpr std::string_view Tables[] = {"STATE_TABLE", "TRANS_TABLE"};

/// Makes texts of the tables of a state machine. Most have digits "-", and are texts anyway; in the
/// others, too, an x says something.
void KeepTables(Module& module, const Cell& cell) {
    for (std::uint32_t i = 0; i < cell.parameters.count; ++i) {
        NamedValue& parameter = module.values[cell.parameters.start + i];
        if (parameter.value.kind == Value::Bits &&
            std::find(std::begin(Tables), std::end(Tables), parameter.name) != std::end(Tables)) {
            parameter.value.kind = Value::Text;
        }
    }
}

} // namespace

void CellReader::Read(Module& module, std::string_view name) {
    Cell cell;
    cell.name = name;
    type_.clear();
    connections_.clear();
    directions_.clear();
    walker_.ForEachField([&](std::string_view key) { ReadPart(module, cell, key); });
    if (type_.empty()) {
        walker_.Fail("a cell needs a type");
    }
    if (type_ == ScopeInfo) {
        return;
    }
    if (type_ == StateMachine) {
        KeepTables(module, cell);
    }
    cell.type = GetOrAddType(type_);
    AddPins(module, cell);
    module.cells.push_back(cell);
}

void CellReader::ReadPart(Module& module, Cell& cell, std::string_view key) {
    if (key == "hide_name") {
        cell.hidden = walker_.ReadFlag();
    } else if (key == "type") {
        type_ = walker_.ReadText();
    } else if (key == "parameters") {
        cell.parameters = parts_.ReadValues(module);
    } else if (key == "attributes" && keepAttributes_) {
        cell.attributes = parts_.ReadValues(module);
    } else if (key == "port_directions") {
        walker_.ForEachField([&](std::string_view pin) {
            const std::string_view name = parts_.KeepOnce(pin);
            directions_.emplace_back(name, parts_.ReadDirection());
        });
    } else if (key == "connections") {
        walker_.ForEachField([&](std::string_view pin) {
            const std::string_view name = parts_.KeepOnce(pin);
            connections_.emplace_back(name, parts_.ReadBits(module));
        });
    } else {
        walker_.Skip();
    }
}

std::uint32_t CellReader::GetOrAddType(std::string_view name) {
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

std::uint32_t CellReader::GetOrAddPin(CellType& type, std::string_view name, std::size_t guess) {
    // Cells of one type mostly have their pins in one order. Of equal names there is one copy.
    return guess < type.pins.size() && type.pins[guess].name.data() == name.data()
               ? static_cast<std::uint32_t>(guess)
               : type.GetOrAddPin(name);
}

void CellReader::AddPins(Module& module, Cell& cell) {
    CellType& type = design_.types[cell.type];
    for (std::size_t i = 0; i < directions_.size(); ++i) {
        const auto& [name, direction] = directions_[i];
        TypePin& pin = type.pins[GetOrAddPin(type, name, i)];
        if (pin.direction == Direction::Unspecified) {
            pin.direction = direction;
        }
    }
    cell.connections.start = static_cast<std::uint32_t>(module.connections.size());
    cell.connections.count = static_cast<std::uint32_t>(connections_.size());
    ++cellNumber_;
    for (std::size_t i = 0; i < connections_.size(); ++i) {
        const auto& [name, bits] = connections_[i];
        const std::uint32_t pin = GetOrAddPin(type, name, i);
        if (lastCells_.size() <= pin) {
            lastCells_.resize(pin + 1);
        }
        if (std::exchange(lastCells_[pin], cellNumber_) == cellNumber_) {
            walker_.FailAt("connections", name, "the pin is connected twice");
        }
        module.connections.push_back(Connection{pin, bits});
    }
}

} // namespace Tool::Import
