// The input chooses commands and arguments by the grammar of the command language.

#include "Scripts.h"

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    Fuzz::Bytes bytes(data, size);
    Fuzz::CheckScript(Fuzz::MakeScript(bytes));
    return 0;
}
