#include "import/CellLibrary.h"

#include "import/DesignReader.h"

#include "Port/Ascii.h"
#include "cells/CellDeclaration.h"

#include <algorithm>
#include <cstdlib>

namespace Tool::Import {

namespace {

bool EndsIn(std::string_view name, std::string_view ending) noexcept {
    return name.size() >= ending.size() &&
           Port::EqualIgnoringCase(name.substr(name.size() - ending.size()), ending);
}

Direction ToDirection(Cells::PortDirection direction) noexcept {
    switch (direction) {
    case Cells::PortDirection::Input:
        return Direction::Input;
    case Cells::PortDirection::Output:
        return Direction::Output;
    case Cells::PortDirection::InOut:
        return Direction::InOut;
    default:
        return Direction::Unspecified;
    }
}

ModulePort MakePort(const Cells::CellPort& declared, ImportedDesign& design) {
    ModulePort port;
    port.name = design.Keep(declared.name);
    port.direction = ToDirection(declared.direction);
    port.isPower = declared.isPower;
    const auto [left, right] = declared.range;
    port.range = BitRange{std::min(left, right), left < right};
    // A width of 0 is that of the cells.
    port.bits.count = declared.width == Cells::CellPort::Unknown
                          ? 0
                          : static_cast<std::uint32_t>(std::abs(left - right) + 1);
    return port;
}

NamedValue MakeDefault(const Cells::CellParameter& declared, ImportedDesign& design) {
    NamedValue result;
    result.name = design.Keep(declared.name);
    result.value.text = design.Keep(declared.text);
    result.value.integer = declared.integer;
    switch (declared.kind) {
    case Cells::CellParameter::Bits:
        result.value.kind = Value::Bits;
        break;
    case Cells::CellParameter::Text:
        result.value.kind = Value::Text;
        break;
    case Cells::CellParameter::Integer:
        result.value.kind = Value::Integer;
        break;
    default:
        result.value.kind = Value::Expression;
    }
    return result;
}

} // namespace

void CellLibrary::Add(const std::string& fileName, const std::string& text) {
    if (EndsIn(fileName, ".json")) {
        AddJson(text);
        return;
    }
    const bool isLiberty = EndsIn(fileName, ".lib") || EndsIn(fileName, ".liberty");
    const std::vector<Cells::CellDeclaration> cells =
        isLiberty ? Cells::ReadLibertyCells(text) : Cells::ReadVerilogCells(text);
    ImportedDesign& design = *designs_.emplace_back(std::make_unique<ImportedDesign>());
    design.modules.reserve(cells.size());
    for (const Cells::CellDeclaration& cell : cells) {
        Module& module = design.modules.emplace_back();
        module.name = design.Keep(cell.name);
        for (const Cells::CellPort& port : cell.ports) {
            module.ports.push_back(MakePort(port, design));
        }
        for (const Cells::CellParameter& parameter : cell.parameters) {
            module.defaults.push_back(MakeDefault(parameter, design));
        }
        Index(module);
    }
}

void CellLibrary::AddJson(std::string_view text) {
    designs_.push_back(ReadDesign(text, false));
    for (Module& module : designs_.back()->modules) {
        if (module.blackBox || !module.top) {
            Index(module);
        }
    }
}

void CellLibrary::Index(Module& module) {
    module.isLibraryCell = true;
    cells_.emplace(module.name, &module);
}

const Module* CellLibrary::Find(std::string_view name) const {
    const auto found = cells_.find(name);
    return found == cells_.end() ? nullptr : found->second;
}

} // namespace Tool::Import
