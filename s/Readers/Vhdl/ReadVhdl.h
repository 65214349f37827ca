// Reads a VHDL netlist for who does not keep it.
#pragma once

#include "Readers/NetlistSink.h"
#include "Readers/Vhdl/Setup.h"

#include <string>
#include <vector>

namespace Orn_Hdl {

class Netlist;

namespace Readers {

/// What stands around the architecture.
struct VhdlFrame {
    std::vector<std::string> libraries;
    std::vector<std::string> uses;
    /// The names of the configurations.
    std::vector<std::string> configurations;
    /// The names of the architecture, and of that in the last configuration; empty for none.
    std::string architecture;
    std::string configured;
    /// The entity of the last configuration, and whether synthesis does not see it.
    std::string configuredEntity;
    bool isConfigurationHidden = false;
};

/// Reads one entity of a file, with its architecture, into a sink.
/// \param library has the components that the file does not declare.
/// \throws Exception for an error, and whatever the sink throws.
VhdlFrame ReadVhdl(const char* fileName, const VhdlSetup& setup, const Netlist& library,
                   NetlistSink& sink);

} // namespace Readers
} // namespace Orn_Hdl
