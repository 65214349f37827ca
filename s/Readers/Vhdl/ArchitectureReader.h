// The second walk over a file: the statements of one architecture become a netlist.
#pragma once

#include "Readers/Vhdl/Attributes.h"
#include "Readers/Vhdl/Expressions.h"
#include "Readers/Vhdl/InstanceReader.h"
#include "Readers/Vhdl/Notes.h"
#include "Readers/Vhdl/Setup.h"
#include "Readers/Vhdl/Types.h"

#include <string>

namespace Orn_Hdl::Readers::Vhdl {

class ArchitectureReader {
public:
    ArchitectureReader(Scanner& scanner, const Design& design, const ModuleHead& entity,
                       const Architecture& architecture, NetlistMaker& maker,
                       const VhdlSetup& setup);

    /// Reads the entity and the architecture of the file that the scanner has opened.
    void Read();

    /// Whether an attribute has a type other than string.
    bool HasTypedAttributes() const noexcept { return attributes_.HasTypes(); }
    /// Whether an instance names an entity, which needs no component declaration.
    bool HasEntityInstances() const noexcept { return instances_.HasEntities(); }

private:
    void SkipToUnit(const Clauses& clauses, Keyword keyword);
    void DeclareGenerics();
    void DeclarePorts();
    void ReadEntity();
    void RefuseHidden();
    void CheckEnd(const std::string& unit);
    void ReadPortNames();
    void SkipParentheses();
    void ReadDeclaration();
    void ReadSignals();
    void ReadSubtype();
    void ReadComponent();
    void ReadBinding();
    void ReadStatement();
    void ReadLabelled(const std::string& label, const Place& place);
    void ReadAssignment();
    void ReadNamedAssignment(const std::string& name, const Place& place);
    void FinishAssignment();
    void Assign();
    [[noreturn]] void Refuse();

    Parser parser_;
    Scanner& scanner_;
    const Design& design_;
    const ModuleHead& entity_;
    const Architecture& architecture_;
    NetlistMaker& maker_;
    Notes notes_;
    ExpressionReader expressions_;
    AttributeReader attributes_;
    InstanceReader instances_;
    Subtypes subtypes_;
    Expression target_;
    Expression value_;
    std::string name_;
};

} // namespace Orn_Hdl::Readers::Vhdl
