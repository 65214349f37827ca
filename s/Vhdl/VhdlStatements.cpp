#include "Orn_Hdl/Writers/Vhdl.h"

#include "HdlModel/Names/Names.h"
#include "Options/LanguageTraits.h"
#include "Orn_Hdl/Options.h"
#include "Port/Ascii.h"
#include "Streams/DirectText.h"
#include "Writers/OneLine.h"
#include "Writers/Text.h"

namespace Orn_Hdl {

using Port::ViewOf;
using std::string_view;
using Writers::Put;
using Writers::PutLine;
using namespace std::literals::string_view_literals;

namespace {

/// The mode of a port, padded so that the types of the ports are aligned.
string_view Mode(const Polarity& polarity) {
    switch (polarity.GetValue()) {
    case Polarity::Input:
        return "in   "sv;
    case Polarity::BiDirectional:
        return "inout"sv;
    default:
        return "out  "sv;
    }
}

void WriteLines(OutStream& out, string_view keyword, const StringArray& items) {
    for (int i = 0; i < items.GetSize(); ++i) {
        PutLine(out, keyword, " ", items.GetView(i), ";");
    }
}

/// What pads a name and a blank to the width of the column.
Writers::Blanks Padding(string_view name, int width) {
    const std::size_t least = width > 0 ? static_cast<std::size_t>(width) : 0;
    return Writers::Blanks(least > name.size() ? least - name.size() : 0);
}

/// Writes a bit string literal, without a base specifier if the value has no base and length.
void WriteBitString(const BitVectorValue& value, OutStream& out) {
    if (value.HasBaseAndLength()) {
        Put(out, GetBaseLetter(Language::Vhdl, value.GetBase()));
    }
    Put(out, "\"", Writers::OneLine(value.GetValue()).GetView(), "\"");
}

} // namespace

void VhdlStatements::WriteStdLogic() {
    Put(out_, "std_logic");
}

void VhdlStatements::WriteBusIndex(int first, int second) {
    Put(out_, "(", first, " ", (first >= second ? "downto" : "to"), " ", second, ")");
}

void VhdlStatements::WriteStdLogicVector(int first, int second) {
    Put(out_, "std_logic_vector", " ");
    WriteBusIndex(first, second);
}

void VhdlStatements::WriteBus(const char* name) {
    WriteBus(ViewOf(name));
}

void VhdlStatements::WriteBus(string_view name) {
    Names::BusName bus;
    if (Names::ParseBus(name, bus)) {
        Put(out_, bus.base);
        WriteBusIndex(bus.leftIndex, bus.rightIndex);
    } else {
        Put(out_, name);
    }
}

void VhdlStatements::WriteIEEELibrary() {
    PutLine(out_, "library", " ieee;");
    PutLine(out_, "use", " ieee.std_logic_1164.ALL;");
    PutLine(out_, "use", " ieee.numeric_std.ALL;");
}

void VhdlStatements::WriteKestraLibrary(bool guard) {
    if (guard) {
        Writers::WriteHidden(out_, Language::Vhdl, [this] { WriteKestraLibrary(false); });
        return;
    }
    PutLine(out_, "library", " KESTRA;");
    PutLine(out_, "use", " KESTRA.Vcomponents.ALL;");
}

void VhdlStatements::WriteUserLibrary(const StringArray& libraries) {
    WriteLines(out_, "library", libraries);
}

void VhdlStatements::WriteUseUserLibrary(const StringArray& useClauses) {
    WriteLines(out_, "use", useClauses);
}

void VhdlStatements::WriteTimeStamp(const char* sourceFileName) {
    Put(out_, "-- VHDL model");
    if (!ViewOf(sourceFileName).empty()) {
        Put(out_, " created from ", sourceFileName);
    }
    PutLine(out_, " - ", HdlUtilities::CurrentTimeString());
}

void VhdlStatements::WriteComment(const Object* object) {
    if (object != nullptr) {
        Writers::WriteComment(out_, Language::Vhdl, *object);
    }
}

/// Writes a name and at least one blank, padded to the width of the column.
void VhdlStatements::WritePadded(string_view name, int width) {
    Put(out_, name, " ", Padding(name, width).GetView());
}

void VhdlStatements::WriteSignalStatement(const char* name, int width) {
    WriteSignalStatement(ViewOf(name), width);
}

void VhdlStatements::WriteSignalStatement(string_view name, int width) {
    DirectText text(out_);
    WriteSignalStatement(text, name, width);
}

void VhdlStatements::WriteSignalStatement(DirectText& text, string_view name, int width) {
    const Writers::Blanks padding = Padding(name, width);
    text.PutLine("signal", " ", name, " ", padding.GetView(), ":", " ", "std_logic", ";");
}

void VhdlStatements::WriteSignalVectorStatement(const char* name, int width) {
    WriteSignalVectorStatement(ViewOf(name), width);
}

void VhdlStatements::WriteSignalVectorStatement(string_view name, int width) {
    Names::BusName bus;
    if (!Names::ParseBus(name, bus)) {
        WriteSignalStatement(name, width);
        return;
    }
    Put(out_, "signal", " ");
    WritePadded(bus.base, width);
    Put(out_, ":", " ");
    WriteStdLogicVector(bus.leftIndex, bus.rightIndex);
    PutLine(out_, ";");
}

void VhdlStatements::WritePortStatement(const char* name, const Polarity& polarity, int width) {
    WritePortStatement(ViewOf(name), polarity, width);
}

void VhdlStatements::WritePortStatement(string_view name, const Polarity& polarity, int width) {
    Names::BusName bus;
    const bool isBus = Names::ParseBus(name, bus);
    WritePadded(isBus ? bus.base : name, width);
    Put(out_, ":", " ", Mode(polarity), " ");
    if (isBus) {
        WriteStdLogicVector(bus.leftIndex, bus.rightIndex);
    } else {
        WriteStdLogic();
    }
}

void VhdlStatements::WriteSignalAssignment(const char* left, const char* right) {
    WriteSignalAssignment(ViewOf(left), ViewOf(right));
}

void VhdlStatements::WriteSignalAssignment(string_view left, string_view right) {
    WriteBus(left);
    Put(out_, " <= ");
    WriteBus(right);
    PutLine(out_, ";");
}

void VhdlStatements::WriteConstantSignalAssignment(const char* name, bool singleBit,
                                                   const BitVectorValue& value) {
    WriteConstantSignalAssignment(ViewOf(name), singleBit, value);
}

void VhdlStatements::WriteConstantSignalAssignment(string_view name, bool singleBit,
                                                   const BitVectorValue& value) {
    WriteBus(name);
    Put(out_, " <= ");
    if (singleBit) {
        Put(out_, "'", Writers::GetSingleBit(value), "'");
    } else {
        WriteBitString(value, out_);
    }
    PutLine(out_, ";");
}

void VhdlStatements::WriteGenericMapAttrType(Attribute* attribute) {
    if (attribute != nullptr) {
        Put(out_, attribute->GetNameView(), " : ");
        WriteVhdlAttrTypeVisitor type(out_);
        attribute->AcceptAttribute(type);
        Put(out_, " :=  ");
        WriteAttrValue(*attribute, true);
    }
}

void VhdlStatements::WriteGenericMapAttr(Attribute* attribute) {
    if (attribute != nullptr) {
        Put(out_, attribute->GetNameView(), " => ");
        WriteAttrValue(*attribute, true);
    }
}

void VhdlStatements::WriteGenericMapInitAttr(Attribute* attribute) {
    if (attribute != nullptr) {
        Put(out_, attribute->GetNameView(), " => ", attribute->GetNameView());
    }
}

void VhdlStatements::WriteAttrDeclaration(Attribute* attribute, bool typed, int width) {
    if (attribute == nullptr) {
        return;
    }
    Put(out_, "attribute", " ");
    WritePadded(attribute->GetNameView(), width);
    Put(out_, ": ");
    if (typed) {
        WriteVhdlAttrTypeVisitor type(out_);
        attribute->AcceptAttribute(type);
    } else {
        Put(out_, "string");
    }
    PutLine(out_, " ;");
}

void VhdlStatements::WriteAttrDeclaration(const AttributeHolder* holder, StringSet& declared,
                                          bool typed, int width) {
    if (holder == nullptr) {
        return;
    }
    for (Attribute* attribute : holder->GetAttrIterator()) {
        if (attribute->GetSynAttrOption() == Attribute::SynAttrAssign &&
            !declared.IContains(attribute->GetNameView())) {
            WriteAttrDeclaration(attribute, typed, width);
            declared.Add(attribute->GetNameView());
        }
    }
}

void VhdlStatements::WriteAttrAssignment(Attribute* attribute, const char* objectName,
                                         const char* objectClass, bool typed) {
    if (attribute != nullptr) {
        Put(out_, "attribute", " ", attribute->GetNameView(), " ", "of", " ", objectName, " : ",
            objectClass, " ", "is", " ");
        WriteAttrValue(*attribute, typed);
        PutLine(out_, ";");
    }
}

void VhdlStatements::WriteAttrAssignment(const AttributeHolder* holder, const char* objectName,
                                         const char* objectClass, bool typed) {
    if (holder == nullptr) {
        return;
    }
    for (Attribute* attribute : holder->GetAttrIterator()) {
        if (attribute->GetSynAttrOption() != Attribute::SynAttrNone) {
            WriteAttrAssignment(attribute, objectName, objectClass, typed);
        }
    }
}

/// \param typed whether as a literal of the attribute's own type or as a string.
void VhdlStatements::WriteAttrValue(Attribute& attribute, bool typed) {
    if (typed) {
        WriteVhdlAttrValueVisitor value(out_);
        attribute.AcceptAttribute(value);
    } else {
        Writers::WriteQuotedValue(out_, attribute);
    }
}

void WriteVhdlAttrTypeVisitor::VisitAttributeString(AttributeString* attribute) {
    if (attribute != nullptr) {
        Put(out_, "string");
    }
}

void WriteVhdlAttrTypeVisitor::VisitAttributeInteger(AttributeInteger* attribute) {
    if (attribute != nullptr) {
        Put(out_, "integer");
    }
}

void WriteVhdlAttrTypeVisitor::VisitAttributeFloat(AttributeFloat* attribute) {
    if (attribute != nullptr) {
        Put(out_, "real");
    }
}

void WriteVhdlAttrTypeVisitor::VisitAttributeBit(AttributeBit* attribute) {
    if (attribute != nullptr) {
        Put(out_, "bit");
    }
}

void WriteVhdlAttrTypeVisitor::VisitAttributeBitVector(AttributeBitVector* attribute) {
    if (attribute != nullptr) {
        Put(out_, "bit_vector");
    }
}

void WriteVhdlAttrTypeVisitor::VisitAttributeBoolean(AttributeBoolean* attribute) {
    if (attribute != nullptr) {
        Put(out_, "boolean");
    }
}

void WriteVhdlAttrTypeVisitor::VisitAttributeUser(AttributeUser* attribute) {
    if (attribute != nullptr) {
        Put(out_, attribute->GetUserType());
    }
}

void WriteVhdlAttrValueVisitor::VisitAttributeString(AttributeString* attribute) {
    if (attribute != nullptr) {
        Writers::WriteQuotedValue(out_, *attribute);
    }
}

void WriteVhdlAttrValueVisitor::VisitAttributeInteger(AttributeInteger* attribute) {
    if (attribute != nullptr) {
        Put(out_, attribute->GetValueString());
    }
}

void WriteVhdlAttrValueVisitor::VisitAttributeFloat(AttributeFloat* attribute) {
    if (attribute != nullptr) {
        Put(out_, attribute->GetValueString());
    }
}

void WriteVhdlAttrValueVisitor::VisitAttributeBit(AttributeBit* attribute) {
    if (attribute != nullptr) {
        Put(out_, "'", attribute->GetValueString(), "'");
    }
}

void WriteVhdlAttrValueVisitor::VisitAttributeBitVector(AttributeBitVector* attribute) {
    if (attribute != nullptr) {
        WriteBitString(attribute->GetBitVectorValue(), out_);
    }
}

void WriteVhdlAttrValueVisitor::VisitAttributeBoolean(AttributeBoolean* attribute) {
    if (attribute != nullptr) {
        Put(out_, attribute->GetValueString());
    }
}

void WriteVhdlAttrValueVisitor::VisitAttributeUser(AttributeUser* attribute) {
    if (attribute != nullptr) {
        const Port::String value = attribute->GetValueString();
        Put(out_, (value.IsEmpty() ? "\"\"" : value.GetView()));
    }
}

} // namespace Orn_Hdl
