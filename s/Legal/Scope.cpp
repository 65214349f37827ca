#include "Legal/Scope.h"

#include "Legal/Identifiers.h"
#include "Port/Ascii.h"

#include <cstdint>

namespace Orn_Hdl::Legal {

std::size_t Scope::Hash::operator()(std::string_view name) const noexcept {
    // FNV-1a over the letters in one case.
    std::uint64_t hash = 14695981039346656037U;
    for (const char c : name) {
        hash = (hash ^ static_cast<unsigned char>(Port::ToUpper(c))) * 1099511628211U;
    }
    return hash;
}

bool Scope::Equal::operator()(std::string_view a, std::string_view b) const noexcept {
    return Port::EqualIgnoringCase(a, b);
}

bool Scope::Claim(std::string_view name) {
    return !IsTaken(name) && taken_.emplace(name).second;
}

std::string Scope::ClaimSimilar(std::string_view wanted, const Scope* other) {
    const auto isFree = [&](std::string_view name) {
        return !IsTaken(name) && (other == nullptr || !other->IsTaken(name));
    };
    std::string name(wanted);
    if (!isFree(name) || !IsLegal(name)) {
        std::size_t& number = numbers_[name];
        do {
            name.assign(wanted).append("_").append(std::to_string(++number));
        } while (!isFree(name));
    }
    taken_.insert(name);
    return name;
}

} // namespace Orn_Hdl::Legal
