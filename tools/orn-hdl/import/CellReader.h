// Reads cells and collects their types.
#pragma once

#include "import/ImportedDesign.h"
#include "import/JsonWalker.h"
#include "import/PartReader.h"

#include <cstddef>
#include <cstdint>
#include <string>
#include <string_view>
#include <unordered_map>
#include <utility>
#include <vector>

namespace Tool::Import {

class CellReader {
public:
    CellReader(ImportedDesign& design, JsonWalker& walker, PartReader& parts, bool keepAttributes)
        : design_(design), walker_(walker), parts_(parts), keepAttributes_(keepAttributes) {}

    /// Reads a cell into a module. Cells that only record the origin of flattened cells are
    /// omitted.
    void Read(Module& module, std::string_view name);

private:
    void ReadPart(Module& module, Cell& cell, std::string_view key);
    std::uint32_t GetOrAddType(std::string_view name);
    /// The index of a pin.
    /// \param name as `PartReader::KeepOnce` returns it. \param guess the index that it may have.
    std::uint32_t GetOrAddPin(CellType& type, std::string_view name, std::size_t guess);
    /// Adds the pins of the cell that was just read to its type.
    void AddPins(Module& module, Cell& cell);

    ImportedDesign& design_;
    JsonWalker& walker_;
    PartReader& parts_;
    const bool keepAttributes_;
    std::unordered_map<std::string_view, std::uint32_t> typeIndex_;

    // Parts of the present cell; members, so that a cell needs no allocation.
    std::string type_;
    std::vector<std::pair<std::string_view, Span>> connections_;
    std::vector<std::pair<std::string_view, Direction>> directions_;
    /// For each pin, the number of the last cell that connects it.
    std::vector<std::uint64_t> lastCells_;
    std::uint64_t cellNumber_ = 0;
};

} // namespace Tool::Import
