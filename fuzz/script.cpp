// The input is a command file as it stands.

#include "Scripts.h"

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const Fuzz::Bytes bytes(data, size);
    const Fuzz::Script script = Fuzz::SplitScript(bytes.Rest());
    for (const Fuzz::Checks checks : Fuzz::ChooseChecks(data, size, Fuzz::ScriptsPerFullCheck)) {
        Fuzz::CheckScript(script, checks);
    }
    return 0;
}
