// The input is a cell library behind a byte that chooses its form. It is read, or refused with the
// line of the error.

#include "Bytes.h"
#include "Check.h"
#include "cells/CellDeclaration.h"

#include <algorithm>

namespace Cells = Tool::Cells;

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    Fuzz::Bytes bytes(data, size);
    const bool isLiberty = bytes.Choose(2) == 1;
    const std::string_view text = bytes.Rest();
    const std::size_t lines =
        1 + static_cast<std::size_t>(std::count(text.begin(), text.end(), '\n'));
    try {
        for (const Cells::CellDeclaration& cell :
             isLiberty ? Cells::ReadLibertyCells(text) : Cells::ReadVerilogCells(text)) {
            Fuzz::Check(!cell.name.empty(), "a cell has a name");
            for (const Cells::CellPort& port : cell.ports) {
                Fuzz::Check(isLiberty || !port.name.empty(), "a port has a name");
            }
        }
    } catch (const Cells::Error& error) {
        Fuzz::Check(error.GetLine() >= 1 && error.GetLine() <= lines, "the line is in the text");
    }
    return 0;
}
