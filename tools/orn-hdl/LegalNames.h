// The table of names that a legal netlist changed or kept.
#pragma once

namespace Orn_Hdl {
class LegalNetlist;
class Netlist;
} // namespace Orn_Hdl

namespace Port {
class Stream;
}

namespace Tool {

/// Writes each object's kind, its name in the design and its name in the netlist, separated by
/// tabs.
void WriteLegalNames(const Orn_Hdl::Netlist& netlist, const Orn_Hdl::LegalNetlist& legal,
                     Port::Stream& out);

} // namespace Tool
