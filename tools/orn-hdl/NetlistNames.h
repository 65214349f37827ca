// The table of names of an imported netlist.
#pragma once

#include "Orn_Hdl/Readers.h"

#include <string_view>
#include <vector>

namespace Orn_Hdl {
class LegalNetlist;
class Netlist;
class Signal;
} // namespace Orn_Hdl

namespace Port {
class Stream;
}

namespace Tool {

/// The scalar signal or bus of that name, given without a range; null when there is none.
const Orn_Hdl::Signal* FindDeclared(const Orn_Hdl::Netlist& netlist, std::string_view name);

/// Writes each object's kind, its name in the file that was read and its name in the netlists,
/// separated by tabs.
/// \param renamings the names that the reader has replaced.
/// \param legal the legal netlist that is written; null for none.
void WriteNetlistNames(const Orn_Hdl::Netlist& netlist,
                       const std::vector<Orn_Hdl::ReaderRenaming>& renamings,
                       const Orn_Hdl::LegalNetlist* legal, Port::Stream& out);

} // namespace Tool
