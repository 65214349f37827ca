// What a fuzz target does when something that must hold does not: it says so and aborts, which the
// fuzzer takes for a crash.
#pragma once

#include <cstdio>
#include <cstdlib>
#include <string>

namespace Fuzz {

inline void Check(bool holds, const std::string& what) {
    if (!holds) {
        std::fprintf(stderr, "does not hold: %s\n", what.c_str());
        std::abort();
    }
}

} // namespace Fuzz
