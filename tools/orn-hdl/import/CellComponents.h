// The cells of a library as components.
#pragma once

namespace Orn_Hdl {
class Netlist;
}

namespace Tool::Import {

class CellLibrary;

/// Adds a component for every cell whose pins are known. Power pins are left out.
void AddComponents(const CellLibrary& library, Orn_Hdl::Netlist& netlist);

} // namespace Tool::Import
