#include "Exception/Failure.h"

#include "Orn_Hdl/Exception.h"

#include <string>

namespace Orn_Hdl {

void Fail(const SourceUnit& unit, int line, std::string_view message,
          std::initializer_list<std::string_view> texts) {
    std::string description;
    for (const std::string_view text : texts) {
        const std::size_t place = message.find("%s");
        description.append(message.substr(0, place)).append(text);
        message.remove_prefix(place + 2);
    }
    description += message;
    Exception exception("DesignEntry", unit.name, unit.revision, line);
    exception.setDescription(description.c_str());
    throw exception;
}

} // namespace Orn_Hdl
