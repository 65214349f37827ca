#include "import/UniqueNames.h"

#include "import/LegalNames.h"

namespace Tool::Import {

std::string UniqueNames::ClaimSimilar(std::string_view name, char initial) {
    const std::string wanted = MakeLegalName(name, initial);
    return ClaimNumbered(wanted, IsLegalName(wanted), [](std::string_view) { return true; });
}

} // namespace Tool::Import
