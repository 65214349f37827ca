#include "Port/Version.h"

#include "Port/Ascii.h"

namespace Port {

String Version::getValue(const char* key) {
    return ViewOf(key) == "version" ? String(ORN_HDL_VERSION) : String();
}

} // namespace Port
