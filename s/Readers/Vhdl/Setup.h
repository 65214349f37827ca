// What the user of a VhdlReader has asked for.
#pragma once

#include "Orn_Hdl/Readers.h"

#include <functional>
#include <string>
#include <string_view>
#include <vector>

namespace Orn_Hdl::Readers {

struct VhdlSetup {
    std::string top;
    std::vector<std::string> libraries;
    ReaderNames names = ReaderNames::Simple;
    std::function<bool(std::string_view name)> keepsName;
    bool keepsComments = false;
    bool keepsAttributes = true;
    bool keepsDontCares = false;
};

} // namespace Orn_Hdl::Readers
