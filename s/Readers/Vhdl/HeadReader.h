// The first walk over a file: which design units there are, with which ports and generics, and what
// they instantiate.
#pragma once

#include "Readers/Vhdl/Design.h"
#include "Readers/Vhdl/Parser.h"

#include "Readers/NetlistSink.h"

#include <cstddef>
#include <set>
#include <string>
#include <string_view>

namespace Orn_Hdl::Readers::Vhdl {

class HeadReader {
public:
    /// \param isLibrary whether the file's entities are components alone. Of a head that is known
    ///        already, the first one counts.
    /// \param sink gets the bindings of configurations; null when nobody wants them.
    HeadReader(Scanner& scanner, Design& design, bool isLibrary, NetlistSink* sink = nullptr);

    /// Reads the file that the scanner has opened.
    void Read();

private:
    void ReadUnit();
    void ReadContextWord();
    void ReadEntity();
    void ReadArchitecture();
    void ReadPackage();
    void ReadComponent(Heads& heads);
    ModuleHead& AddHead(Heads& heads, const std::string& name, const Place& place);
    void TakeComments();
    void ReadGenerics(ModuleHead& head);
    void ReadGeneric(ModuleHead& head);
    void ReadPorts(ModuleHead& head);
    void ReadPort(ModuleHead& head);
    bool SkipDefault();
    bool ReadItems(Heads* components);
    bool ReadEnd();
    void ReadSubprogram();
    void ReadLabelled();
    void AddUse(bool isEntity, const Place& place);
    void SkipUnit(const Place& begin);
    std::optional<std::int64_t> Resolve(const ModuleHead& head, std::string_view name,
                                        std::vector<std::string>* used) const;

    Parser parser_;
    Scanner& scanner_;
    Design& design_;
    const bool isLibrary_;
    NetlistSink* const sink_;
    /// The clauses in front of the next design unit.
    Clauses clauses_;
    /// Takes what is read of a head that is known already.
    ModuleHead ignored_;
    Architecture* architecture_ = nullptr;
    std::set<std::string, std::less<>> used_;
    std::string lastUsed_;
    bool wasEntity_ = false;
    /// How many subprograms and generate statements are open.
    std::size_t subprograms_ = 0;
    std::size_t generates_ = 0;
    bool isHidden_ = false;
    std::string name_;
    std::vector<std::string> names_;
};

/// Reads a library or use clause.
void ReadClause(Parser& parser, Clauses& clauses);

} // namespace Orn_Hdl::Readers::Vhdl
