/// \file
/// `Orn_Hdl::Exception`, the one exception type of the library.
#pragma once

#include "Port/Exception.h"

namespace Orn_Hdl {

/// Every failure that the library reports: the module "DesignEntry", the source unit that raised
/// it, and a fixed message that ends in a line feed (`getLocalized`).
class ORN_HDL_API Exception : public Port::Exception {
public:
    using Port::Exception::Exception;
};

} // namespace Orn_Hdl
