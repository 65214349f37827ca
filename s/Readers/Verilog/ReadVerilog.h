// Reads a Verilog netlist for who does not keep it.
#pragma once

#include "Readers/Heads.h"
#include "Readers/NetlistSink.h"
#include "Readers/Verilog/Setup.h"

#include <string>
#include <vector>

namespace Orn_Hdl::Readers {

/// Reads one module of a file into a sink.
/// \param components the ports of modules that the file does not have.
/// \return the files named by include directives that are kept.
/// \throws Exception for an error, and whatever the sink throws.
std::vector<std::string> ReadVerilog(const char* fileName, const VerilogSetup& setup,
                                     const Heads& components, NetlistSink& sink);

} // namespace Orn_Hdl::Readers
