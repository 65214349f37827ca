// What the user of a VerilogReader has asked for.
#pragma once

#include "Orn_Hdl/Readers.h"

#include <functional>
#include <string>
#include <string_view>
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
    std::function<bool(std::string_view name)> keepsName;
    ReaderUndeclared undeclared = ReaderUndeclared::Refuse;
    bool keepsComments = false;
    bool keepsAttributes = true;
    bool keepsDontCares = false;
};

} // namespace Orn_Hdl::Readers
