// What the user of a VerilogReader has asked for.
#pragma once

#include "Orn_Hdl/Readers.h"

#include <string>
#include <utility>
#include <vector>

namespace Orn_Hdl::Readers {

struct VerilogSetup {
    std::string top;
    std::vector<std::string> libraries;
    std::vector<std::string> includeFolders;
    std::vector<std::pair<std::string, std::string>> macros;
    VerilogReader::Includes includes = VerilogReader::Includes::Follow;
    ReaderNames names = ReaderNames::Simple;
    bool keepsComments = false;
    bool keepsAttributes = true;
};

} // namespace Orn_Hdl::Readers
