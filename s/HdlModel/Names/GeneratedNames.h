// Suffixes of the names that the library gives to signals of its own. If a user's name ends in one,
// two signals may get the same name.
#pragma once

#include "Port/Ascii.h"

#include <array>
#include <string_view>

namespace Orn_Hdl::Names {

/// A dummy signal, which carries the value of a port that is used against its direction.
constexpr std::string_view DummySuffix = "_DUMMY";
/// The signal that carries the constant of a pin.
constexpr std::string_view ConstantSuffix = "_CONST_SIGNAL";
/// The signal at an open pin.
constexpr std::string_view OpenSuffix = "_openSignal";

/// All of them. A new suffix belongs here, too.
constexpr std::array GeneratedSuffixes = {DummySuffix, ConstantSuffix, OpenSuffix};

/// Whether a name without a range ends in one of the suffixes, in any letter case.
inline bool IsGenerated(std::string_view name) noexcept {
    for (const std::string_view suffix : GeneratedSuffixes) {
        if (name.size() >= suffix.size() &&
            Port::EqualIgnoringCase(name.substr(name.size() - suffix.size()), suffix)) {
            return true;
        }
    }
    return false;
}

} // namespace Orn_Hdl::Names
