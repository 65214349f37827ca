// `orn-hdl run --check`: lets nothing be written that a tool of its language rejects or misreads.
#pragma once

#include "Orn_Hdl/Check.h"
#include "Orn_Hdl/Language.h"

#include <cstdint>
#include <string>
#include <vector>

namespace Orn_Hdl {
class Model;
class StringArray;
} // namespace Orn_Hdl

namespace Tool::Checking {

/// Checks a model before it is written, and reports what is wrong with it.
class WriteGate {
public:
    /// \param file the command file, as the user named it; must outlive this.
    WriteGate(Orn_Hdl::Model& model, const std::string& file) : model_(model), file_(file) {}

    /// Whether a line may be carried out: any line may that does not write.
    bool Allows(const Orn_Hdl::StringArray& words, std::uint64_t line);
    /// Whether the design may be written in a language, behind a line.
    bool Allows(Orn_Hdl::Language language, std::uint64_t line);
    /// Tells what keeps a legal netlist from being written behind a line. \return whether there is
    /// anything.
    bool Tell(const std::vector<Orn_Hdl::Check::Finding>& errors, std::uint64_t line);

private:
    Orn_Hdl::Model& model_;
    const std::string& file_;
};

} // namespace Tool::Checking
