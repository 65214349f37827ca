/// \file
/// The VHDL writer: `VhdlStatements` writes single constructs, `VhdlNetlister` a whole design.
#pragma once

#include "Orn_Hdl/Attributes.h"
#include "Orn_Hdl/Containers/StringArray.h"
#include "Orn_Hdl/Containers/StringSet.h"
#include "Orn_Hdl/Model/Netlist.h"
#include "Orn_Hdl/Options.h"
#include "Orn_Hdl/Streams.h"
#include "Port/Export.h"

#include <memory>
#include <string_view>

namespace Orn_Hdl {

/// Writes single VHDL constructs (IEEE 1076-1993), literally as it is given them. Unless told
/// otherwise a construct ends its line.
class ORN_HDL_API VhdlStatements {
public:
    /// \param out not owned; it must outlive the statements.
    explicit VhdlStatements(OutStream& out) noexcept : out_(out) {}

    /// std_logic, the line left open.
    void WriteStdLogic();
    /// (FIRST downto SECOND), or "to" when the first is smaller; the line left open.
    void WriteBusIndex(int first, int second);
    /// std_logic_vector (RANGE), the line left open.
    void WriteStdLogicVector(int first, int second);
    /// A reference: of a bus name with its range, of any other name as it is; the line left open.
    void WriteBus(const char* name);
    /// The clauses for the IEEE packages.
    void WriteIEEELibrary();
    /// The clauses for the package of cells.
    /// \param guard whether the clauses stand between translate_off and translate_on.
    void WriteKestraLibrary(bool guard);
    /// A library clause for each.
    void WriteUserLibrary(const StringArray& libraries);
    /// A use clause for each.
    void WriteUseUserLibrary(const StringArray& useClauses);
    /// A comment line with the source file, if any, and the time.
    void WriteTimeStamp(const char* sourceFileName);
    /// The object's comment, every line behind "-- ".
    void WriteComment(const Object* object);
    /// signal NAME : std_logic;
    /// \param width the column width to which the name is padded, here and below.
    void WriteSignalStatement(const char* name, int width);
    /// The same for a bus.
    void WriteSignalVectorStatement(const char* name, int width);
    /// The declaration of a port, the line left open.
    void WritePortStatement(const char* name, const Polarity& polarity, int width);
    /// LEFT <= RIGHT
    void WriteSignalAssignment(const char* left, const char* right);
    /// NAME <= CONSTANT
    /// \param singleBit writes a character literal, '0' or '1', whatever the value's base.
    void WriteConstantSignalAssignment(const char* name, bool singleBit,
                                       const BitVectorValue& value);
    /// NAME : TYPE :=  VALUE, the line left open. Null writes nothing here and below.
    void WriteGenericMapAttrType(Attribute* attribute);
    /// NAME => VALUE, the line left open.
    void WriteGenericMapAttr(Attribute* attribute);
    /// NAME => NAME, the line left open: passes the entity's generic of that name down.
    void WriteGenericMapInitAttr(Attribute* attribute);
    /// attribute NAME : TYPE ;
    /// \param typed whether the attribute has its own type or is a string, here and below.
    void WriteAttrDeclaration(Attribute* attribute, bool typed, int width);
    /// Declares the attributes whose synthesis option is "ASSIGN" and whose names are not in
    /// `declared` yet, and adds these.
    void WriteAttrDeclaration(const AttributeHolder* holder, StringSet& declared, bool typed,
                              int width);
    /// attribute NAME of OBJECT : CLASS is VALUE
    void WriteAttrAssignment(Attribute* attribute, const char* objectName, const char* objectClass,
                             bool typed);
    /// The attributes whose synthesis option is not "NONE".
    void WriteAttrAssignment(const AttributeHolder* holder, const char* objectName,
                             const char* objectClass, bool typed);

private:
    friend class VhdlNetlister;
    friend class WritePortAssignmentVisitor;

    /// As above, for names as the objects hold them.
    void WriteBus(std::string_view name);
    void WriteSignalStatement(std::string_view name, int width);
    void WriteSignalVectorStatement(std::string_view name, int width);
    void WritePortStatement(std::string_view name, const Polarity& polarity, int width);
    void WriteSignalAssignment(std::string_view left, std::string_view right);
    void WriteConstantSignalAssignment(std::string_view name, bool singleBit,
                                       const BitVectorValue& value);
    void WritePadded(std::string_view name, int width);
    void WriteAttrValue(Attribute& attribute, bool typed);

    OutStream& out_;
};

/// Writes the VHDL type of an attribute.
class ORN_HDL_API WriteVhdlAttrTypeVisitor : public AttributeVisitor {
public:
    /// \param out not owned; it must outlive the visitor.
    explicit WriteVhdlAttrTypeVisitor(OutStream& out) noexcept : out_(out) {}
    /// \{
    /// Writes it; null writes nothing.
    void VisitAttributeString(AttributeString* attribute) override;
    void VisitAttributeInteger(AttributeInteger* attribute) override;
    void VisitAttributeFloat(AttributeFloat* attribute) override;
    void VisitAttributeBit(AttributeBit* attribute) override;
    void VisitAttributeBitVector(AttributeBitVector* attribute) override;
    void VisitAttributeBoolean(AttributeBoolean* attribute) override;
    void VisitAttributeUser(AttributeUser* attribute) override;
    /// \}

private:
    OutStream& out_;
};

/// Writes an attribute's value as a VHDL literal.
class ORN_HDL_API WriteVhdlAttrValueVisitor : public AttributeVisitor {
public:
    /// \param out not owned; it must outlive the visitor.
    explicit WriteVhdlAttrValueVisitor(OutStream& out) noexcept : out_(out) {}
    /// \{
    /// Writes it; null writes nothing.
    void VisitAttributeString(AttributeString* attribute) override;
    void VisitAttributeInteger(AttributeInteger* attribute) override;
    void VisitAttributeFloat(AttributeFloat* attribute) override;
    void VisitAttributeBit(AttributeBit* attribute) override;
    void VisitAttributeBitVector(AttributeBitVector* attribute) override;
    void VisitAttributeBoolean(AttributeBoolean* attribute) override;
    void VisitAttributeUser(AttributeUser* attribute) override;
    /// \}

private:
    OutStream& out_;
};

/// Writes a netlist as a VHDL entity, an architecture named BEHAVIORAL and a configuration.
class ORN_HDL_API VhdlNetlister {
public:
    /// \param out not owned; it must outlive the netlister.
    explicit VhdlNetlister(OutStream& out);
    VhdlNetlister(const VhdlNetlister& other);
    ~VhdlNetlister();

    /// Sorts the netlist, makes the stand-in signals that it needs, and writes it. A null netlist,
    /// and null options, write nothing.
    void WriteNetlist(Netlist* netlist, const HdlOptions* options);

private:
    class ORN_HDL_LOCAL Writer;

    OutStream& out_;
    std::unique_ptr<VhdlStatements> statements_;
    StringSet declared_;
};

} // namespace Orn_Hdl
