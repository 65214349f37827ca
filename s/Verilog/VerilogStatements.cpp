#include "Orn_Hdl/Writers/Verilog.h"

#include "HdlModel/Names/Names.h"
#include "Options/LanguageTraits.h"
#include "Port/Ascii.h"
#include "Streams/DirectText.h"
#include "Writers/OneLine.h"
#include "Writers/Text.h"

namespace Orn_Hdl {

using Port::ViewOf;
using std::string_view;
using Writers::OneLine;
using Writers::Put;
using Writers::PutLine;
using namespace std::literals::string_view_literals;

namespace {

/// Replaces a character that would end a number.
constexpr char DigitSeparator = '_';

constexpr string_view ListIndentation = "                      "; // 22 blanks

/// The keyword of a port's direction, padded so that the names of the ports are aligned.
string_view DirectionKeyword(const Polarity& polarity) {
    switch (polarity.GetValue()) {
    case Polarity::Input:
        return " input"sv;
    case Polarity::BiDirectional:
        return " inout"sv;
    default:
        return "output"sv;
    }
}

/// Writes a sized constant, or the bare digits of a value without base and length.
void WriteNumber(const BitVectorValue& value, OutStream& out) {
    if (value.HasBaseAndLength()) {
        Put(out, value.GetLength(), "'", GetBaseLetter(Language::Verilog, value.GetBase()));
    }
    Put(out, OneLine(value.GetValue(), DigitSeparator).GetView());
}

/// Calls `write` with each attribute that has a synthesis option.
template <class Write>
void ForEachSynAttr(const Iterator<Attribute*>& attributes, const Write& write) {
    for (Attribute* attribute : attributes) {
        if (attribute != nullptr && attribute->GetSynAttrOption() != Attribute::SynAttrNone) {
            write(*attribute);
        }
    }
}

} // namespace

void VerilogStatements::NormalizeBusName(Port::StringBase<char>& name) const {
    name.ReplaceChars("(", '[');
    name.ReplaceChars(")", ']');
}

void VerilogStatements::WriteTimeScale(const char* unit, const char* precision) {
    PutLine(out_, "`timescale", " ", unit, " / ", precision);
}

void VerilogStatements::WriteTimeStamp(const char* sourceFileName) {
    Put(out_, "// Verilog model ");
    if (!ViewOf(sourceFileName).empty()) {
        Put(out_, "created from ", sourceFileName);
    }
    PutLine(out_, " - ", HdlUtilities::CurrentTimeString());
}

void VerilogStatements::WritePortDeclaration(const char* name, const Polarity& polarity) {
    WritePortDeclaration(ViewOf(name), polarity);
}

void VerilogStatements::WritePortDeclaration(string_view name, const Polarity& polarity) {
    if (name.empty()) {
        return;
    }
    Put(out_, DirectionKeyword(polarity), " ");
    Names::BusName bus;
    if (Names::ParseBus(name, bus)) {
        WriteRange(bus.leftIndex, bus.rightIndex);
        Put(out_, " ", bus.base);
    } else {
        Put(out_, name);
    }
}

void VerilogStatements::WriteRange(int msb, int lsb) {
    Put(out_, "[", msb, ":", lsb, "]");
}

void VerilogStatements::WriteSignalDeclaration(const char* name) {
    WriteSignalDeclaration(ViewOf(name));
}

void VerilogStatements::WriteSignalDeclaration(string_view name) {
    Names::BusName bus;
    if (Names::ParseBus(name, bus)) {
        WriteWireBus(bus.base, bus.leftIndex, bus.rightIndex);
    } else {
        WriteWire(name);
    }
}

void VerilogStatements::WriteWire(string_view name) {
    DirectText text(out_);
    WriteWire(text, name);
}

void VerilogStatements::WriteWire(DirectText& text, string_view name) {
    text.Put("wire", " ", name);
}

void VerilogStatements::WriteWireBus(string_view base, int msb, int lsb) {
    Put(out_, "wire", " ");
    WriteRange(msb, lsb);
    Put(out_, " ", base);
}

void VerilogStatements::WriteSignalName(const char* name) {
    WriteSignalName(ViewOf(name));
}

void VerilogStatements::WriteSignalName(string_view name) {
    Names::BusName bus;
    if (Names::ParseBus(name, bus)) {
        Put(out_, bus.base);
        WriteRange(bus.leftIndex, bus.rightIndex);
    } else {
        Put(out_, name);
    }
}

void VerilogStatements::WriteSignalAssignment(const char* left, const char* right) {
    Put(out_, "assign", " ");
    WriteSignalName(left);
    Put(out_, " = ");
    WriteSignalName(right);
}

void VerilogStatements::WriteConstantSignalAssignment(const char* name, bool singleBit,
                                                      const BitVectorValue& value) {
    const Names::NormalizedText normalized(ViewOf(name));
    WriteConstantSignalAssignment(normalized.GetView(), singleBit, value);
}

void VerilogStatements::WriteConstantSignalAssignment(string_view name, bool singleBit,
                                                      const BitVectorValue& value) {
    Put(out_, "assign", " ", Names::BaseName(name), " = ");
    WriteConstant(singleBit, value);
}

void VerilogStatements::WriteConstant(bool singleBit, const BitVectorValue& value) {
    if (singleBit) {
        Put(out_, Writers::GetSingleBit(value));
    } else {
        WriteNumber(value, out_);
    }
}

void VerilogStatements::WriteParameterStatement(Attribute* attribute) {
    if (attribute != nullptr) {
        Put(out_, "parameter", " ", attribute->GetNameView(), " = ");
        WriteVerilogAttrValueVisitor value(out_);
        attribute->AcceptAttribute(value);
    }
}

void VerilogStatements::WriteDefParamStatement(Attribute* attribute, const char* instanceName) {
    if (attribute != nullptr) {
        Put(out_, "defparam", " ", instanceName, ".", attribute->GetNameView(), " = ");
        WriteVerilogAttrValueVisitor value(out_);
        attribute->AcceptAttribute(value);
    }
}

void VerilogStatements::WriteDefParamInitStatement(Attribute* attribute, const char* instanceName) {
    if (attribute != nullptr) {
        const string_view name = attribute->GetNameView();
        Put(out_, "defparam", " ", instanceName, ".", name, " = ", name);
    }
}

void VerilogStatements::WriteComment(const Object* object) {
    if (object != nullptr) {
        Writers::WriteComment(out_, Language::Verilog, *object);
    }
}

void VerilogStatements::WriteIncludePath(const StringArray& fileNames) {
    for (int i = 0; i < fileNames.GetSize(); ++i) {
        // One piece of text: a directive must not be broken over two lines.
        Port::String directive("`include \"");
        directive += OneLine(HdlUtilities::RemoveQuotes(fileNames.GetAt(i).CStr())).GetView();
        directive += "\"";
        PutLine(out_, directive);
    }
}

void VerilogStatements::WriteSynplicityAttr(const Iterator<Attribute*>& attributes) {
    bool isFirst = true;
    ForEachSynAttr(attributes, [this, &isFirst](const Attribute& attribute) {
        if (isFirst) {
            Put(out_, "/* synthesis \"");
        } else {
            PutLine(out_, ", \\");
            Put(out_, ListIndentation);
        }
        isFirst = false;
        Put(out_, attribute.GetNameView(), "=", Writers::GetUnquotedValue(attribute));
    });
    if (!isFirst) {
        Put(out_, "\" ", "*/");
    }
}

void VerilogStatements::WriteSynopsysAttr(const Iterator<Attribute*>& attributes) {
    bool isFirst = true;
    ForEachSynAttr(attributes, [this, &isFirst](const Attribute& attribute) {
        if (isFirst) {
            Put(out_, "/* synopsys attribute ");
        } else {
            PutLine(out_);
            Put(out_, ListIndentation);
        }
        isFirst = false;
        Put(out_, attribute.GetNameView(), " ");
        Writers::WriteQuotedValue(out_, attribute);
    });
    if (!isFirst) {
        PutLine(out_, " */");
    }
}

void VerilogStatements::WriteQSNAttr(const Iterator<Attribute*>& attributes,
                                     const char* instanceName) {
    ForEachSynAttr(attributes, [this, instanceName](const Attribute& attribute) {
        WriteQSNAttrStatement(attribute.GetNameView(), instanceName,
                              Writers::GetUnquotedValue(attribute));
    });
}

void VerilogStatements::WriteExemplarAttr(const Iterator<Attribute*>& attributes,
                                          const char* instanceName) {
    ForEachSynAttr(attributes, [this, instanceName](const Attribute& attribute) {
        WriteExemplarAttrStatement(attribute.GetNameView(), instanceName,
                                   Writers::GetUnquotedValue(attribute));
    });
}

void VerilogStatements::WritePrecisionAttr(const Iterator<Attribute*>& attributes,
                                           const char* instanceName) {
    ForEachSynAttr(attributes, [this, instanceName](const Attribute& attribute) {
        WritePrecisionAttrStatement(attribute.GetNameView(), instanceName,
                                    Writers::GetUnquotedValue(attribute));
    });
}

void VerilogStatements::WriteQSNAttrStatement(string_view name, const char* instanceName,
                                              string_view value) {
    PutLine(out_, "// synthesis attribute ", name, " ", "of", " ", instanceName, " ", "is", " ",
            "\"", value, "\"");
}

void VerilogStatements::WriteExemplarAttrStatement(string_view name, const char* instanceName,
                                                   string_view value) {
    PutLine(out_, "// exemplar attribute ", instanceName, " ", name, " ", value);
}

void VerilogStatements::WritePrecisionAttrStatement(string_view name, const char* instanceName,
                                                    string_view value) {
    PutLine(out_, "//pragma attribute ", instanceName, " ", name, " ", value);
}

void WriteVerilogAttrValueVisitor::VisitAttributeString(AttributeString* attribute) {
    if (attribute != nullptr) {
        Writers::WriteQuotedValue(out_, *attribute);
    }
}

void WriteVerilogAttrValueVisitor::VisitAttributeInteger(AttributeInteger* attribute) {
    if (attribute != nullptr) {
        Put(out_, attribute->GetValueString());
    }
}

void WriteVerilogAttrValueVisitor::VisitAttributeFloat(AttributeFloat* attribute) {
    if (attribute != nullptr) {
        Put(out_, attribute->GetValueString());
    }
}

void WriteVerilogAttrValueVisitor::VisitAttributeBit(AttributeBit* attribute) {
    if (attribute != nullptr) {
        Put(out_, "1'b", attribute->GetValueString());
    }
}

void WriteVerilogAttrValueVisitor::VisitAttributeBitVector(AttributeBitVector* attribute) {
    if (attribute != nullptr) {
        WriteNumber(attribute->GetBitVectorValue(), out_);
    }
}

void WriteVerilogAttrValueVisitor::VisitAttributeBoolean(AttributeBoolean* attribute) {
    if (attribute != nullptr) {
        Put(out_, "\"", attribute->GetValueString(), "\"");
    }
}

void WriteVerilogAttrValueVisitor::VisitAttributeUser(AttributeUser* attribute) {
    if (attribute != nullptr) {
        Put(out_, "\"", OneLine(attribute->GetValueString()).GetView(), "\"");
    }
}

} // namespace Orn_Hdl
