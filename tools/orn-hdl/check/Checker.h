// Checks of a model while it is replayed.
#pragma once

#include "Orn_Hdl/Check.h"
#include "check/Located.h"

#include <cstdint>
#include <string>
#include <unordered_map>
#include <vector>

namespace Orn_Hdl {
class Model;
class StringArray;
} // namespace Orn_Hdl

namespace Tool::Checking {

/// Stands in the place of a model's write commands: they are where the design is checked, and
/// nothing is written. What a write changes in the design is done before the next command.
class Checker {
public:
    Checker(Orn_Hdl::Model& model, Orn_Hdl::Check::Targets targets)
        : model_(model), targets_(targets) {}

    /// Whether a line is a write command with a file to write.
    static bool IsWrite(const Orn_Hdl::StringArray& words);
    /// Checks the design for the language of a write command.
    void CheckWrite(const Orn_Hdl::StringArray& words, std::uint64_t line,
                    std::vector<Located>& findings);
    /// Checks the design for all targets.
    void CheckAll(std::uint64_t line, std::vector<Located>& findings);
    /// To be called before a command is carried out that is no write command.
    void BeforeCommand(const Orn_Hdl::StringArray& words);
    /// Whether the design has been checked since the last command that could change it.
    bool IsChecked() const noexcept { return isChecked_; }

private:
    void Add(Orn_Hdl::Check::Targets targets, std::uint64_t line, std::vector<Located>& findings);
    void WriteIntoNothing();

    Orn_Hdl::Model& model_;
    const Orn_Hdl::Check::Targets targets_;
    bool isChecked_ = false;
    bool pendingVerilog_ = false;
    bool pendingVhdl_ = false;
    /// What was told already, with its place among the findings.
    std::unordered_map<std::string, std::size_t> told_;
};

} // namespace Tool::Checking
