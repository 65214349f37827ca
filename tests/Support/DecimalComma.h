// The C library's numbers in a locale that writes "1.234,5" for 1234.5.
#pragma once

#include "Support/Environment.h"
#include "Support/TemporaryFolder.h"

#include <clocale>
#include <cstdlib>
#include <string>

namespace Support {

/// Such a locale, made by localedef, is in use for numbers as long as the object lives.
class DecimalComma {
public:
    DecimalComma() : path_("LOCPATH", folder_.GetPath().c_str()) {
        WriteWholeFile(folder_ / "source", "LC_NUMERIC\ndecimal_point \",\"\nthousands_sep \".\"\n"
                                           "grouping 3;3\nEND LC_NUMERIC\n");
        // Its other parts are missing, which localedef complains of.
        const std::string command = "localedef -c --no-archive -i " + (folder_ / "source") + " " +
                                    (folder_ / "comma") + " >/dev/null 2>&1";
        isSet_ =
            std::system(command.c_str()) >= 0 && std::setlocale(LC_NUMERIC, "comma") != nullptr;
    }
    DecimalComma(const DecimalComma&) = delete;
    DecimalComma& operator=(const DecimalComma&) = delete;
    ~DecimalComma() { std::setlocale(LC_NUMERIC, "C"); }

    bool IsSet() const noexcept { return isSet_; }

private:
    TemporaryFolder folder_;
    EnvironmentVariable path_;
    bool isSet_ = false;
};

} // namespace Support
