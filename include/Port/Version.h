/// \file
/// Values that the build gives to the library.
#pragma once

#include "Port/Export.h"
#include "Port/String.h"

namespace Port {

/// Names and values fixed when the library was built.
class ORN_HDL_API Version {
public:
    /// The value of a name: "version" gives the project's version, anything else "".
    static String getValue(TextView key);
};

} // namespace Port
