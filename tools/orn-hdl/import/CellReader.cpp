#include "import/CellReader.h"

namespace Tool::Import {

namespace {

/// The type of cells without pins that only record the origin of flattened cells.
constexpr std::string_view ScopeInfo("$scopeinfo");

} // namespace

void CellReader::Read(Module& module, std::string_view name, JsonValue& value) {
    Cell cell;
    cell.name = name;
    type_ = std::string_view();
    connections_.clear();
    directions_.clear();
    walker_.ForEachField(
        value, [&](std::string_view key, JsonValue& part) { ReadPart(module, cell, key, part); });
    if (type_.empty()) {
        walker_.Fail("a cell needs a type");
    }
    if (type_ == ScopeInfo) {
        return;
    }
    cell.type = GetOrAddType(type_);
    AddPins(module, cell);
    module.cells.push_back(cell);
}

void CellReader::ReadPart(Module& module, Cell& cell, std::string_view key, JsonValue& part) {
    if (key == "hide_name") {
        cell.hidden = walker_.ReadFlag(part);
    } else if (key == "type") {
        type_ = walker_.ReadText(part);
    } else if (key == "parameters") {
        cell.parameters = parts_.ReadValues(module, part);
    } else if (key == "attributes" && keepAttributes_) {
        cell.attributes = parts_.ReadValues(module, part);
    } else if (key == "port_directions") {
        walker_.ForEachField(part, [&](std::string_view pin, JsonValue& direction) {
            directions_.emplace_back(pin, parts_.ReadDirection(direction));
        });
    } else if (key == "connections") {
        walker_.ForEachField(part, [&](std::string_view pin, JsonValue& bits) {
            connections_.emplace_back(pin, parts_.ReadBits(module, bits));
        });
    } else {
        walker_.Skip(part);
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

std::uint32_t CellReader::GetOrAddPin(CellType& type, std::string_view name) {
    const auto known = type.pinIndex.find(name);
    return known != type.pinIndex.end() ? known->second : type.GetOrAddPin(design_.Keep(name));
}

void CellReader::AddPins(Module& module, Cell& cell) {
    CellType& type = design_.types[cell.type];
    for (const auto& [name, direction] : directions_) {
        TypePin& pin = type.pins[GetOrAddPin(type, name)];
        if (pin.direction == Direction::Unspecified) {
            pin.direction = direction;
        }
    }
    cell.connections.start = static_cast<std::uint32_t>(module.connections.size());
    cell.connections.count = static_cast<std::uint32_t>(connections_.size());
    ++cellNumber_;
    for (const auto& [name, bits] : connections_) {
        const std::uint32_t pin = GetOrAddPin(type, name);
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
