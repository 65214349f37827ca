// Cell libraries: files that tell the pins and parameters of cell types.
#pragma once

#include "import/ImportedDesign.h"

#include <memory>
#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

namespace Tool::Import {

class CellLibrary {
public:
    /// Adds the cells of a file: Liberty if its name ends in ".lib" or ".liberty", a JSON netlist
    /// if it ends in ".json", and Verilog otherwise. Of several cells of one name, the first one
    /// holds. \throws Cells::Error if the text is no Liberty or Verilog, Error if it is no JSON
    /// netlist.
    void Add(const std::string& fileName, const std::string& text);

    /// Calls `visit` with every cell, in the order of the files.
    template <class Visit> void ForEach(const Visit& visit) const {
        for (const std::unique_ptr<ImportedDesign>& design : designs_) {
            for (const Module& module : design->modules) {
                if (Find(module.name) == &module) {
                    visit(module);
                }
            }
        }
    }
    /// The cell of that name as a leaf module; null if there is none.
    const Module* Find(std::string_view name) const;

private:
    void AddJson(std::string_view text);
    void Index(Module& module);

    /// The texts and the modules of all files.
    std::vector<std::unique_ptr<ImportedDesign>> designs_;
    std::unordered_map<std::string_view, const Module*> cells_;
};

} // namespace Tool::Import
