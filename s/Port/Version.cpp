#include "Port/Version.h"

namespace Port {

String Version::getValue(TextView key) {
    return key.GetView() == "version" ? String(ORN_HDL_VERSION) : String();
}

} // namespace Port
