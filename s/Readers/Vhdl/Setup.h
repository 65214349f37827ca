// What the user of a VhdlReader has asked for.
#pragma once

#include "Orn_Hdl/Readers.h"

#include <string>
#include <vector>

namespace Orn_Hdl::Readers {

struct VhdlSetup {
    std::string top;
    std::vector<std::string> libraries;
    ReaderNames names = ReaderNames::Simple;
    bool keepsComments = false;
    bool keepsAttributes = true;
};

} // namespace Orn_Hdl::Readers
