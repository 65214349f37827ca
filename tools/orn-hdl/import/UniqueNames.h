// The names of one scope.
#pragma once

#include "Port/NameScope.h"

#include <string>
#include <string_view>

namespace Tool::Import {

/// The names of one scope.
class UniqueNames : public Port::NameScope {
public:
    /// Claims a legal name that resembles `name`, with a number if it is claimed already.
    std::string ClaimSimilar(std::string_view name, char initial);
};

} // namespace Tool::Import
