#include "Sampling.h"

#include <filesystem>
#include <functional>
#include <string_view>
#include <system_error>

namespace Fuzz {

namespace {

bool isSearching = false;

/// The fuzzer searches unless its command line names inputs, which it then runs one by one.
bool NamesFiles(int argc, char** argv) {
    for (int i = 1; i < argc; ++i) {
        std::error_code error;
        if (argv[i][0] != '-' && std::filesystem::is_regular_file(argv[i], error)) {
            return true;
        }
    }
    return false;
}

} // namespace

const std::vector<Checks>& ChooseChecks(const std::uint8_t* data, std::size_t size,
                                        std::size_t count) {
    static const std::vector<Checks> few{Checks::Few};
    static const std::vector<Checks> all{Checks::All};
    static const std::vector<Checks> both{Checks::All, Checks::Few};
    if (!isSearching) {
        return both;
    }
    const std::string_view bytes(reinterpret_cast<const char*>(data), size);
    return std::hash<std::string_view>()(bytes) % count == 0 ? all : few;
}

} // namespace Fuzz

/// Called by libFuzzer before it runs any input, and by nothing else.
extern "C" int LLVMFuzzerInitialize(int* argc, char*** argv) {
    Fuzz::isSearching = !Fuzz::NamesFiles(*argc, *argv);
    return 0;
}
