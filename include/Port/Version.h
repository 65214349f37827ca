/// \file
/// Values that the build gives to the library.
#pragma once

#include "Port/Export.h"
#include "Port/String.h"

namespace Port {

/// Names and values fixed when the library was built.
class ORN_HDL_API Version {
public:
    /// \return the value of `key`: "version" gives the project's version, anything else "".
    static String getValue(const char* key);
};

} // namespace Port
