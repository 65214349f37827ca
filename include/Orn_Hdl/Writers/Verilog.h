/// \file
/// The Verilog writer: `VerilogStatements` writes single constructs, `VerilogNetlister` a whole
/// design.
#pragma once

#include "Orn_Hdl/Attributes.h"
#include "Orn_Hdl/Containers/PtrArray.h"
#include "Orn_Hdl/Containers/StringArray.h"
#include "Orn_Hdl/Model/Netlist.h"
#include "Orn_Hdl/Options.h"
#include "Orn_Hdl/Streams.h"
#include "Port/Export.h"
#include "Port/String.h"

#include <memory>
#include <string_view>
#include <vector>

namespace Orn_Hdl {

class DirectText;

/// Writes single Verilog constructs (IEEE 1364-1995) with their parts unchanged. Unless a function
/// says otherwise, it leaves the statement open: the caller writes ";" or continues it.
class ORN_HDL_API VerilogStatements {
public:
    /// \param out not owned; it must outlive the statements.
    explicit VerilogStatements(OutStream& out) noexcept : out_(out) {}

    /// Turns every "(" into "[" and every ")" into "]".
    void NormalizeBusName(Port::StringBase<char>& name) const;
    /// `timescale UNIT / PRECISION, and the line end.
    void WriteTimeScale(const char* unit, const char* precision);
    /// A comment line with the source file, if any, and the time.
    void WriteTimeStamp(const char* sourceFileName);
    /// The declaration of a port; an empty name writes nothing.
    void WritePortDeclaration(const char* name, const Polarity& polarity);
    /// wire [RANGE] NAME
    void WriteSignalDeclaration(const char* name);
    /// A reference: a bus name with its range in brackets, or any other name unchanged.
    void WriteSignalName(const char* name);
    /// assign LEFT = RIGHT
    void WriteSignalAssignment(const char* left, const char* right);
    /// assign NAME = CONSTANT, where NAME has no range or index.
    /// \param singleBit writes a bare 0 or 1 whatever the value's base.
    void WriteConstantSignalAssignment(const char* name, bool singleBit,
                                       const BitVectorValue& value);
    /// parameter NAME = VALUE
    void WriteParameterStatement(Attribute* attribute);
    /// defparam INSTANCE.NAME = VALUE
    void WriteDefParamStatement(Attribute* attribute, const char* instanceName);
    /// defparam INSTANCE.NAME = NAME, which passes on the module's parameter of that name.
    void WriteDefParamInitStatement(Attribute* attribute, const char* instanceName);
    /// The object's comment, each line prefixed by "// ".
    void WriteComment(const Object* object);
    /// An `include line for each file.
    void WriteIncludePath(const StringArray& fileNames);

    /// The attributes whose synthesis option is not "NONE", for Synplicity: one comment before the
    /// semicolon of their object's statement.
    void WriteSynplicityAttr(const Iterator<Attribute*>& attributes);
    /// The attributes whose synthesis option is not "NONE", for Synopsys: one comment and a
    /// line end.
    void WriteSynopsysAttr(const Iterator<Attribute*>& attributes);
    /// The attributes whose synthesis option is not "NONE", for QSN: a comment line each.
    void WriteQSNAttr(const Iterator<Attribute*>& attributes, const char* instanceName);
    /// The attributes whose synthesis option is not "NONE", for Exemplar: a comment line each.
    void WriteExemplarAttr(const Iterator<Attribute*>& attributes, const char* instanceName);
    /// The attributes whose synthesis option is not "NONE", for Precision: a comment line each.
    void WritePrecisionAttr(const Iterator<Attribute*>& attributes, const char* instanceName);

private:
    friend class VerilogNetlister;

    // Overloads for names that are not copied.
    void WritePortDeclaration(std::string_view name, const Polarity& polarity);
    void WriteSignalDeclaration(std::string_view name);
    void WriteSignalName(std::string_view name);
    void WriteConstantSignalAssignment(std::string_view name, bool singleBit,
                                       const BitVectorValue& value);
    /// The right side of a constant assignment.
    void WriteConstant(bool singleBit, const BitVectorValue& value);
    void WriteRange(int msb, int lsb);
    void WriteWire(std::string_view name);
    ORN_HDL_LOCAL static void WriteWire(DirectText& text, std::string_view name);
    void WriteWireBus(std::string_view base, int msb, int lsb);
    void WriteQSNAttrStatement(std::string_view name, const char* instanceName,
                               std::string_view value);
    void WriteExemplarAttrStatement(std::string_view name, const char* instanceName,
                                    std::string_view value);
    void WritePrecisionAttrStatement(std::string_view name, const char* instanceName,
                                     std::string_view value);

    OutStream& out_;
};

/// Writes an attribute's value as a Verilog constant.
class ORN_HDL_API WriteVerilogAttrValueVisitor : public AttributeVisitor {
public:
    /// \param out not owned; it must outlive the visitor.
    explicit WriteVerilogAttrValueVisitor(OutStream& out) noexcept : out_(out) {}
    /// Writes the text in double quotes; null writes nothing.
    void VisitAttributeString(AttributeString* attribute) override;
    /// Writes the digits; null writes nothing.
    void VisitAttributeInteger(AttributeInteger* attribute) override;
    /// Writes the digits; null writes nothing.
    void VisitAttributeFloat(AttributeFloat* attribute) override;
    /// Writes a binary constant of one bit; null writes nothing.
    void VisitAttributeBit(AttributeBit* attribute) override;
    /// Writes a sized constant, or the bare digits of a value without base and length; null writes
    /// nothing.
    void VisitAttributeBitVector(AttributeBitVector* attribute) override;
    /// Writes the text in double quotes; null writes nothing.
    void VisitAttributeBoolean(AttributeBoolean* attribute) override;
    /// Writes the text in double quotes; null writes nothing.
    void VisitAttributeUser(AttributeUser* attribute) override;

private:
    OutStream& out_;
};

/// Writes a netlist as one structural Verilog module. It can be used for any number of netlists.
class ORN_HDL_API VerilogNetlister {
public:
    /// \param out not owned; it must outlive the netlister.
    explicit VerilogNetlister(OutStream& out);
    /// The stream stays open.
    ~VerilogNetlister();

    /// Sorts the netlist, makes the dummy signals that it needs, renames its objects if the options
    /// ask for upper or lower case, and writes it. If the netlist is null, nothing is written.
    void WriteNetlist(Netlist* netlist, const HdlOptions& options);
    /// Writes the netlist like the overload with constant options, and records in
    /// `options.hierarchicalInit` whether its instances are given the module's INIT parameter. If
    /// the netlist is null, nothing is written and the options do not change.
    void WriteNetlist(Netlist* netlist, HdlOptions& options);

private:
    friend class LegalNetlist;
    class ORN_HDL_LOCAL Writer;

    /// Writes the netlist whether the options ask for a legal one or not.
    void WriteLiterally(Netlist& netlist, const HdlOptions& options);

    OutStream& out_;
    std::unique_ptr<VerilogStatements> statements_;
};

} // namespace Orn_Hdl
