#include "import/UniqueNames.h"

namespace Tool::Import {

std::string UniqueNames::ClaimForm(std::string_view name, bool sharesIdentifier) {
    if (ClaimLegal(name)) {
        return std::string(name);
    }
    if (!rules_.MayEscape() || !rules_.IsEscapable(name)) {
        return "";
    }
    // Names that differ in letter case only are the same for the library, and get different
    // numbers of blanks.
    constexpr std::size_t MostBlanks = 4;
    std::string form(name);
    for (std::size_t blanks = 1; blanks <= MostBlanks; ++blanks) {
        if (!sharesIdentifier && IsTaken(form) &&
            NameRules::WithoutEscape(GetSpelling(form)) == name) {
            return "";
        }
        form = NameRules::Escape(name, blanks);
        if (Claim(form)) {
            return form;
        }
    }
    return "";
}

std::string UniqueNames::ClaimSimilar(std::string_view name, char initial) {
    const std::string wanted = MakeSimilarName(name, initial);
    return ClaimNumbered(wanted, rules_.IsLegal(wanted), [](std::string_view) { return true; });
}

} // namespace Tool::Import
