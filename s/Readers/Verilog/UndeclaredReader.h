// The walk over a module between the other two, when it instantiates modules that no file declares:
// which ports these have, as their connections tell.
#pragma once

#include "Readers/Heads.h"
#include "Readers/Verilog/Parser.h"

#include <cstddef>
#include <cstdint>
#include <map>
#include <optional>
#include <string>
#include <string_view>
#include <unordered_map>

namespace Orn_Hdl::Readers {

/// Adds a head for every module without one. Its ports are those that connections name, in the
/// order of the file, as wide as what is connected to them first, and without a direction. Anything
/// else that is wrong is left to the walk that follows.
class UndeclaredReader {
public:
    /// \param head the module that is read.
    UndeclaredReader(Scanner& scanner, Heads& heads, const ModuleHead& head)
        : parser_(scanner), scanner_(scanner), heads_(heads), head_(head) {}

    /// Reads the module of the file that the scanner has opened.
    void Read();

private:
    void SkipToModule();
    void ReadStatement();
    void ReadNets();
    void ReadInstances();
    bool ReadOneInstance(ModuleHead& module);
    PortHead& GetPort(ModuleHead& module, std::size_t& hint);
    bool ReadConnection(ModuleHead& module, std::size_t& port);
    /// The width of an expression or of a part of one; nothing when it has none of its own.
    std::optional<std::uint64_t> ReadWidth();
    std::optional<std::uint64_t> ReadNetWidth();
    std::optional<std::uint64_t> ReadSelectionWidth();
    std::optional<std::uint64_t> ReadConcatenationWidth();
    std::optional<std::int64_t> ReadInteger();

    Parser parser_;
    Scanner& scanner_;
    Heads& heads_;
    const ModuleHead& head_;
    /// The widths of all buses.
    std::map<std::string, std::uint64_t, std::less<>> widths_;
    /// Where each port of an undeclared module is.
    std::unordered_map<const ModuleHead*, std::unordered_map<std::string, std::size_t>> indices_;
    ModuleHead* lastHead_ = nullptr;
    std::size_t depth_ = 0;
    std::string name_;
};

} // namespace Orn_Hdl::Readers
