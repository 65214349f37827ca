#include "Legal/Scope.h"

#include "Legal/Identifiers.h"

#include <string_view>

namespace Orn_Hdl::Legal {

std::string Scope::ClaimSimilar(const std::string& wanted, const Scope* other) {
    return ClaimNumbered(wanted, IsLegal(wanted), [other](std::string_view name) {
        return other == nullptr || !other->IsTaken(name);
    });
}

} // namespace Orn_Hdl::Legal
