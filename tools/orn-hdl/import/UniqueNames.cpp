#include "import/UniqueNames.h"

#include "Port/Ascii.h"

#include <algorithm>
#include <cstdint>

namespace Tool::Import {

std::size_t UniqueNames::Hash::operator()(std::string_view name) const noexcept {
    // FNV-1a over the letters in one case.
    std::uint64_t hash = 14695981039346656037u;
    for (const char c : name) {
        hash = (hash ^ static_cast<unsigned char>(Port::ToUpper(c))) * 1099511628211u;
    }
    return hash;
}

bool UniqueNames::Equal::operator()(std::string_view a, std::string_view b) const noexcept {
    return Port::EqualIgnoringCase(a, b);
}

std::string_view UniqueNames::Keep(std::string_view name) {
    char* copy = static_cast<char*>(memory_.allocate(name.size(), 1));
    std::copy(name.begin(), name.end(), copy);
    return std::string_view(copy, name.size());
}

bool UniqueNames::Claim(std::string_view name) {
    return !IsTaken(name) && taken_.insert(Keep(name)).second;
}

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
        const auto taken = taken_.find(form);
        if (!sharesIdentifier && taken != taken_.end() &&
            NameRules::WithoutEscape(*taken) == name) {
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
    std::string wanted = MakeSimilarName(name, initial);
    if (ClaimLegal(wanted)) {
        return wanted;
    }
    auto number = numbers_.find(wanted);
    if (number == numbers_.end()) {
        number = numbers_.emplace(Keep(wanted), 0).first;
    }
    std::string numbered;
    do {
        numbered = wanted + "_" + std::to_string(++number->second);
    } while (!Claim(numbered));
    return numbered;
}

} // namespace Tool::Import
