// Certificates: which netlists were proven to mean what a command file or another netlist does.
#pragma once

#include "Tool.h"

#include "Orn_Hdl/Language.h"

#include <string>
#include <vector>

namespace Orn_Hdl {
class Netlist;
}

namespace Tool {

class JsonWriter;

/// Collects what was proven, and writes it as JSON: the version, the SHA-256 of each file, and how
/// much of each kind every netlist holds.
class Certificate {
public:
    /// \param fileName the file to write; empty for none, and then nothing is collected.
    explicit Certificate(const std::string& fileName) : fileName_(fileName) {}

    /// Whether there is to be one.
    bool IsWanted() const noexcept { return !fileName_.empty(); }
    /// Adds the command file. \param systemName the name under which it can be read again.
    Status AddCommands(const std::string& name, const std::string& systemName);
    /// Adds a netlist that was read, or a library of cells.
    Status AddInput(const std::string& name);
    /// Adds a netlist that was proven.
    /// \param design what was written, with the names and values of a legal netlist; counted now.
    Status AddNetlist(const std::string& name, Orn_Hdl::Language language,
                      const Orn_Hdl::Netlist& design);
    /// Writes the file.
    Status Write() const;

private:
    struct Count {
        const char* name;
        unsigned long long number;
    };
    struct File {
        std::string name;
        std::string digest;
        /// Of a netlist.
        std::string language;
        std::string module;
        std::vector<Count> counts;
    };

    static void WriteFiles(JsonWriter& json, const char* key, const std::vector<File>& files);

    const std::string fileName_;
    std::vector<File> commands_;
    std::vector<File> inputs_;
    std::vector<File> netlists_;
};

} // namespace Tool
