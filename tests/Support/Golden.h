/// \file
/// The golden designs: a command file each, beside the netlists that it must give to the byte.
/// Every golden netlist was accepted by real tools first (golden/accept.sh).
#pragma once

#include "Support/EngineScript.h"
#include "Support/TemporaryFolder.h"

#include <algorithm>
#include <filesystem>
#include <stdexcept>
#include <string>
#include <vector>

namespace Support {

inline std::filesystem::path GoldenFolder() {
    return std::filesystem::path(ORN_HDL_TEST_DATA) / "golden";
}

/// The names of all golden designs, sorted.
inline std::vector<std::string> GoldenNames() {
    std::vector<std::string> names;
    for (const auto& entry : std::filesystem::directory_iterator(GoldenFolder())) {
        if (entry.path().extension() == ".cmd") {
            names.push_back(entry.path().stem().string());
        }
    }
    std::sort(names.begin(), names.end());
    return names;
}

inline std::string GoldenText(const std::string& file) {
    const std::filesystem::path path = GoldenFolder() / file;
    if (!std::filesystem::exists(path)) {
        throw std::runtime_error("no golden file " + file);
    }
    return ReadWholeFile(path.string());
}

/// What a design is in one language once it was written in the other, where that differs: the one
/// writer renames objects, the other adds some.
inline std::string GoldenTextAfterOther(const std::string& name, const std::string& other,
                                        const std::string& extension) {
    const std::string file = name + ".after_" + other + extension;
    return std::filesystem::exists(GoldenFolder() / file) ? GoldenText(file)
                                                          : GoldenText(name + extension);
}

/// A model in which a golden design was built.
class GoldenDesign : public EngineScript {
public:
    explicit GoldenDesign(const std::string& name) : EngineScript(GoldenText(name + ".cmd")) {}
};

} // namespace Support
