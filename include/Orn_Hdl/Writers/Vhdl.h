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

class DirectText;

/// Writes single VHDL constructs (IEEE 1076-1993) with their parts unchanged. Unless a function
/// says otherwise, it ends the line.
class ORN_HDL_API VhdlStatements {
public:
    /// \param out not owned; it must outlive the statements.
    explicit VhdlStatements(OutStream& out) noexcept : out_(out) {}

    /// std_logic, the line left open.
    void WriteStdLogic();
    /// (FIRST downto SECOND), or "to" for an ascending range; the line left open.
    void WriteBusIndex(int first, int second);
    /// std_logic_vector (RANGE), the line left open.
    void WriteStdLogicVector(int first, int second);
    /// A reference: a bus name with its range, or any other name unchanged; the line left open.
    void WriteBus(const char* name);
    /// The clauses for the IEEE packages.
    void WriteIEEELibrary();
    /// The clauses for the package of cells.
    /// \param guard whether translate_off comments hide the clauses from synthesis.
    void WriteKestraLibrary(bool guard);
    /// A library clause for each library.
    void WriteUserLibrary(const StringArray& libraries);
    /// A use clause for each name.
    void WriteUseUserLibrary(const StringArray& useClauses);
    /// A comment line with the source file, if any, and the time.
    void WriteTimeStamp(const char* sourceFileName);
    /// The object's comment, each line prefixed by "-- ".
    void WriteComment(const Object* object);
    /// signal NAME : std_logic;
    /// \param width the column width to which the name is padded.
    void WriteSignalStatement(const char* name, int width);
    /// signal NAME : std_logic_vector (RANGE); for a name without a range, signal NAME : std_logic;
    /// \param width the column width to which the name is padded.
    void WriteSignalVectorStatement(const char* name, int width);
    /// The declaration of a port, the line left open.
    /// \param width the column width to which the name is padded.
    void WritePortStatement(const char* name, const Polarity& polarity, int width);
    /// LEFT <= RIGHT
    void WriteSignalAssignment(const char* left, const char* right);
    /// NAME <= CONSTANT
    /// \param singleBit writes a character literal, '0' or '1', whatever the value's base.
    void WriteConstantSignalAssignment(const char* name, bool singleBit,
                                       const BitVectorValue& value);
    /// NAME : TYPE :=  VALUE, the line left open. Null writes nothing.
    void WriteGenericMapAttrType(Attribute* attribute);
    /// NAME => VALUE, the line left open. Null writes nothing.
    void WriteGenericMapAttr(Attribute* attribute);
    /// NAME => NAME, which passes on the entity's generic of that name, the line left open. Null
    /// writes nothing.
    void WriteGenericMapInitAttr(Attribute* attribute);
    /// attribute NAME : TYPE ; null writes nothing.
    /// \param typed whether the attribute has its own type or is a string.
    /// \param width the column width to which the name is padded.
    void WriteAttrDeclaration(Attribute* attribute, bool typed, int width);
    /// Declares the holder's attributes whose synthesis option is "ASSIGN" and whose names are not
    /// in `declared` yet, and adds their names. Null writes nothing.
    /// \param typed whether attributes have their own types or are strings.
    /// \param width the column width to which names are padded.
    void WriteAttrDeclaration(const AttributeHolder* holder, StringSet& declared, bool typed,
                              int width);
    /// attribute NAME of OBJECT : CLASS is VALUE; null writes nothing.
    /// \param typed whether the value is a literal of the attribute's own type or a string.
    void WriteAttrAssignment(Attribute* attribute, const char* objectName, const char* objectClass,
                             bool typed);
    /// Specifies the holder's attributes whose synthesis option is not "NONE". Null writes nothing.
    /// \param typed whether values are literals of the attributes' own types or strings.
    void WriteAttrAssignment(const AttributeHolder* holder, const char* objectName,
                             const char* objectClass, bool typed);

private:
    friend class VhdlNetlister;
    friend class WritePortAssignmentVisitor;

    // Overloads for names that are not copied.
    void WriteBus(std::string_view name);
    void WriteSignalStatement(std::string_view name, int width);
    ORN_HDL_LOCAL static void WriteSignalStatement(DirectText& text, std::string_view name,
                                                   int width);
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
    /// Writes "string"; null writes nothing.
    void VisitAttributeString(AttributeString* attribute) override;
    /// Writes "integer"; null writes nothing.
    void VisitAttributeInteger(AttributeInteger* attribute) override;
    /// Writes "real"; null writes nothing.
    void VisitAttributeFloat(AttributeFloat* attribute) override;
    /// Writes "bit"; null writes nothing.
    void VisitAttributeBit(AttributeBit* attribute) override;
    /// Writes "bit_vector"; null writes nothing.
    void VisitAttributeBitVector(AttributeBitVector* attribute) override;
    /// Writes "boolean"; null writes nothing.
    void VisitAttributeBoolean(AttributeBoolean* attribute) override;
    /// Writes the user's own type; null writes nothing.
    void VisitAttributeUser(AttributeUser* attribute) override;

private:
    OutStream& out_;
};

/// Writes an attribute's value as a VHDL literal.
class ORN_HDL_API WriteVhdlAttrValueVisitor : public AttributeVisitor {
public:
    /// \param out not owned; it must outlive the visitor.
    explicit WriteVhdlAttrValueVisitor(OutStream& out) noexcept : out_(out) {}
    /// Writes the text in double quotes; null writes nothing.
    void VisitAttributeString(AttributeString* attribute) override;
    /// Writes the digits; null writes nothing.
    void VisitAttributeInteger(AttributeInteger* attribute) override;
    /// Writes the digits; null writes nothing.
    void VisitAttributeFloat(AttributeFloat* attribute) override;
    /// Writes a character literal; null writes nothing.
    void VisitAttributeBit(AttributeBit* attribute) override;
    /// Writes a bit string literal; null writes nothing.
    void VisitAttributeBitVector(AttributeBitVector* attribute) override;
    /// Writes the text as it is; null writes nothing.
    void VisitAttributeBoolean(AttributeBoolean* attribute) override;
    /// Writes the text as it is, "" when it is empty; null writes nothing.
    void VisitAttributeUser(AttributeUser* attribute) override;

private:
    OutStream& out_;
};

/// Writes a netlist as a VHDL entity, an architecture named BEHAVIORAL and a configuration.
class ORN_HDL_API VhdlNetlister {
public:
    /// \param out not owned; it must outlive the netlister.
    explicit VhdlNetlister(OutStream& out);
    /// A netlister for the same stream.
    VhdlNetlister(const VhdlNetlister& other);
    /// The stream stays open.
    ~VhdlNetlister();

    /// Sorts the netlist, makes the dummy signals that it needs, and writes it. If the netlist or
    /// the options are null, nothing is written.
    void WriteNetlist(Netlist* netlist, const HdlOptions* options);

private:
    friend class LegalNetlist;
    class ORN_HDL_LOCAL Writer;

    /// Writes the netlist whether the options ask for a legal one or not.
    void WriteLiterally(Netlist& netlist, const HdlOptions& options);

    OutStream& out_;
    std::unique_ptr<VhdlStatements> statements_;
    StringSet declared_;
};

} // namespace Orn_Hdl
