// The names of one scope.
#pragma once

#include "Port/NameScope.h"

#include <string>

namespace Orn_Hdl::Legal {

/// The names of one scope.
class Scope : public Port::NameScope {
public:
    /// Claims the wanted name, or else the first of it with _1, _2 and so on that is free here and
    /// in the other scope. What is claimed is legal.
    /// \param other may be null.
    std::string ClaimSimilar(const std::string& wanted, const Scope* other = nullptr);
};

} // namespace Orn_Hdl::Legal
