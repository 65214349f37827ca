// The input is a command file as it stands.

#include "Scripts.h"

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const Fuzz::Bytes bytes(data, size);
    Fuzz::CheckScript(Fuzz::SplitScript(bytes.Rest()));
    return 0;
}
