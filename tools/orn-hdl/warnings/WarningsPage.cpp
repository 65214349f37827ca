#include "warnings/WarningsPage.h"

#include "warnings/Table.h"

#include <algorithm>
#include <string>

namespace Tool {

Status PrintWarnings() {
    std::string text;
    for (const Warning& warning : GetWarnings()) {
        std::string name(warning.name);
        name.resize(std::max<std::size_t>(name.size() + 1, 20), ' ');
        text.append(name).append(warning.what).append("\n");
    }
    return Print(text);
}

Status PrintWarningsPage() {
    std::string text = "| warning | what is found | what comes of it | example | what helps |\n"
                       "| --- | --- | --- | --- | --- |\n";
    for (const Warning& warning : GetWarnings()) {
        // The last line of the example is the slip.
        const std::string_view slip = warning.example.substr(warning.example.rfind('\n') + 1);
        text.append("| `").append(warning.name).append("` | ").append(warning.what);
        text.append(" | ").append(warning.why).append(" | `").append(slip).append("` | ");
        text.append(warning.help).append(" |\n");
    }
    return Print(text);
}

} // namespace Tool
