// The input chooses commands and arguments by the grammar of the command language.

#include "Scripts.h"

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    Fuzz::Bytes bytes(data, size);
    const Fuzz::Script script = Fuzz::MakeScript(bytes);
    for (const Fuzz::Checks checks : Fuzz::ChooseChecks(data, size, Fuzz::ScriptsPerFullCheck)) {
        Fuzz::CheckScript(script, checks);
    }
    return 0;
}
