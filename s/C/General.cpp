// The functions of the C interface that need no handle.
#include "C/Calls.h"
#include "Orn_Hdl/Commands.h"
#include "Port/Version.h"

#include <cstdlib>

namespace CInterface = Orn_Hdl::CInterface;

extern "C" {

const char* orn_hdl_version(void) {
    return ORN_HDL_VERSION;
}

const char* orn_hdl_status_text(orn_hdl_status_t status) {
    switch (status) {
    case ORN_HDL_OK:
        return "success";
    case ORN_HDL_END:
        return "no further element";
    case ORN_HDL_NULL_HANDLE:
        return "null handle";
    case ORN_HDL_DEAD_HANDLE:
        return "handle of something that does not exist any more";
    case ORN_HDL_WRONG_KIND:
        return "handle of another kind";
    case ORN_HDL_INVALID_ARGUMENT:
        return "invalid argument";
    case ORN_HDL_NOT_FOUND:
        return "not found";
    case ORN_HDL_EXISTS:
        return "name taken";
    case ORN_HDL_FAILED:
        return "refused by the library";
    case ORN_HDL_FILE:
        return "file cannot be read or written";
    case ORN_HDL_DIFFERS:
        return "netlist differs from its design";
    case ORN_HDL_BUSY:
        return "busy with a callback";
    case ORN_HDL_STOPPED:
        return "stopped by a callback";
    case ORN_HDL_NO_MEMORY:
        return "out of memory";
    case ORN_HDL_UNEXPECTED:
        return "unexpected failure";
    default:
        return "unknown status";
    }
}

void orn_hdl_free(char* text) {
    std::free(text);
}

orn_hdl_status_t orn_hdl_is_keyword(orn_hdl_language_t language, const char* word, int* reserved) {
    return CInterface::Attempt(nullptr, [&] {
        CInterface::Require(reserved != nullptr);
        const bool isReserved = CInterface::ToLanguage(language) == Orn_Hdl::Language::Verilog
                                    ? Orn_Hdl::Engine::IsVerilogKeyword(word)
                                    : Orn_Hdl::Engine::IsVhdlKeyword(word);
        *reserved = isReserved ? 1 : 0;
    });
}

orn_hdl_status_t orn_hdl_get_command(size_t index, orn_hdl_command_t* command) {
    return CInterface::Attempt(nullptr, [&] {
        CInterface::Require(command != nullptr);
        const auto& catalogue = Orn_Hdl::CommandFactory::GetCatalogue();
        if (index >= catalogue.size()) {
            CInterface::End(ORN_HDL_END);
        }
        *command = {catalogue[index].phrase, catalogue[index].arguments, catalogue[index].help};
    });
}

} // extern "C"
