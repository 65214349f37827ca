// The first walk over a file: which modules there are, with which ports, and what they instantiate.
#pragma once

#include "Readers/Heads.h"
#include "Readers/Verilog/Parser.h"

#include <cstdint>
#include <optional>
#include <set>
#include <string>
#include <string_view>
#include <vector>

namespace Orn_Hdl::Readers {

class HeadReader {
public:
    /// \param isLibrary whether the file's modules are components alone. Of a module that is known
    ///        already, the first one counts.
    HeadReader(Scanner& scanner, Heads& heads, bool isLibrary)
        : parser_(scanner), scanner_(scanner), heads_(heads), isLibrary_(isLibrary) {}

    /// Reads the file that the scanner has opened.
    void Read();

private:
    void ReadModule();
    ModuleHead& AddHead(const std::string& name, const Place& place);
    void ReadParameterPorts();
    void ReadPorts();
    void ReadPortName();
    void ReadPortExpression();
    void SkipDefault(PortHead& port);
    void ReadStatement();
    void ReadPortDeclaration(bool isInHead);
    void SkipNetType();
    std::optional<Range> ReadRange(PortHead& port);
    void ReadParameters(bool isLocal, bool isInHead);
    void ReadParameter(bool isLocal);
    void ReadUse();
    std::optional<std::int64_t> Resolve(std::string_view name,
                                        std::vector<std::string>* used) const;

    Parser parser_;
    Scanner& scanner_;
    Heads& heads_;
    const bool isLibrary_;
    /// The file that was opened.
    std::uint32_t source_ = 0;
    ModuleHead* head_ = nullptr;
    /// Takes what is read of a module that is known already.
    ModuleHead ignored_;
    std::set<std::string, std::less<>> used_;
    std::string lastUsed_;
    std::string name_;
};

} // namespace Orn_Hdl::Readers
