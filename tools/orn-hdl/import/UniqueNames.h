// The names of one scope.
#pragma once

#include "Port/NameScope.h"
#include "import/NameRules.h"

#include <string>
#include <string_view>

namespace Tool::Import {

/// The names of one scope, which follow the rules of the languages asked for.
class UniqueNames : public Port::NameScope {
public:
    explicit UniqueNames(const NameRules& rules) noexcept : rules_(rules) {}

    const NameRules& GetRules() const noexcept { return rules_; }
    /// Claims a name that needs no change. \return false if it is not legal or claimed already.
    bool ClaimLegal(std::string_view name) { return rules_.IsLegal(name) && Claim(name); }
    /// Claims a name that is the same identifier in the netlist: the name itself, or an escaped
    /// form of it. \return the empty text if there is none, or if the identifier is claimed.
    std::string ClaimSame(std::string_view name) { return ClaimForm(name, false); }
    /// Claims a name that is the same identifier in the netlist, for a module: other objects may
    /// have the same identifier, but the library needs different names.
    std::string ClaimModule(std::string_view name) { return ClaimForm(name, true); }
    /// Claims a legal name that resembles `name`, with a number if it is claimed already.
    std::string ClaimSimilar(std::string_view name, char initial);

private:
    std::string ClaimForm(std::string_view name, bool sharesIdentifier);

    const NameRules rules_;
};

} // namespace Tool::Import
