// Restricts the files that WRITE commands may write, for command files that are not trusted.
#pragma once

#include "Orn_Hdl/Model.h"

#include <memory>
#include <optional>
#include <string>

namespace Tool {

/// The rules given on the command line.
struct WriteRules {
    /// The only folder below which files may be written; file names are relative to it.
    std::optional<std::string> folder;
    /// Nothing may be written.
    bool noWrite = false;
};

/// Applies the rules to a model until this object is destroyed. A folder of the rules is the
/// current folder until then.
class RulesInForce {
public:
    /// \throws std::system_error if the folder cannot be entered.
    RulesInForce(Orn_Hdl::Model& model, const WriteRules& rules);
    RulesInForce(const RulesInForce&) = delete;
    RulesInForce& operator=(const RulesInForce&) = delete;
    ~RulesInForce();

private:
    Orn_Hdl::Model& model_;
    std::unique_ptr<Orn_Hdl::OutputGuard> guard_;
};

} // namespace Tool
