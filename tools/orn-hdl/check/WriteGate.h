// `orn-hdl run --check`: lets nothing be written that a tool of its language rejects or misreads.
#pragma once

#include "Orn_Hdl/Check.h"
#include "Orn_Hdl/Language.h"

#include <cstdint>
#include <vector>

namespace Orn_Hdl {
class Model;
class StringArray;
} // namespace Orn_Hdl

namespace Tool {
class CommandLines;
class Reporter;
} // namespace Tool

namespace Tool::Checking {

/// Checks a model before it is written, and reports what is wrong with it.
class WriteGate {
public:
    /// \param lines the command file; must outlive this object, as must the reporter.
    WriteGate(Orn_Hdl::Model& model, CommandLines& lines, Reporter& reporter)
        : model_(model), lines_(lines), reporter_(reporter) {}

    /// Whether a line may be carried out: any line may that does not write.
    bool Allows(const Orn_Hdl::StringArray& words, std::uint64_t line);
    /// Whether the design may be written in a language, behind a line.
    bool Allows(Orn_Hdl::Language language, std::uint64_t line);
    /// Tells what keeps a legal netlist from being written behind a line. \return whether there is
    /// anything.
    bool Tell(const std::vector<Orn_Hdl::Check::Finding>& errors, std::uint64_t line);

private:
    Orn_Hdl::Model& model_;
    CommandLines& lines_;
    Reporter& reporter_;
};

} // namespace Tool::Checking
