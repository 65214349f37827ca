// How a fuzz target fails: it prints what does not hold and aborts, which the fuzzer reports as a
// crash.
#pragma once

#include <cstdio>
#include <cstdlib>

namespace Fuzz {

/// Aborts unless `holds`. The texts are literals: a check is made far too often to allocate.
/// \param subject what the sentence `what` is about, where that is not the same for every caller.
inline void Check(bool holds, const char* what, const char* subject = "") {
    if (!holds) {
        std::fprintf(stderr, "does not hold: %s%s%s\n", subject, *subject == '\0' ? "" : ": ",
                     what);
        std::abort();
    }
}

} // namespace Fuzz
