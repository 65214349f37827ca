#include "HdlModel/Names/Names.h"
#include "Options/EffectiveAttrs.h"
#include "Options/LanguageTraits.h"
#include "Orn_Hdl/Containers/StringPtrMap.h"
#include "Orn_Hdl/Model/Component.h"
#include "Orn_Hdl/Options.h"
#include "Orn_Hdl/Streams.h"
#include "Orn_Hdl/Writers/NetlistHeader.h"
#include "Port/Ascii.h"
#include "Port/Timestamp.h"
#include "Port/Version.h"

#include <string>

namespace Orn_Hdl {

using Text = Port::StringBase<char>;

const Text HdlUtilities::CurrentTimeString() {
    const UT_TIMESTAMP now;
    return now.getTimeStampMonthNumber() + "/" + now.getTimeStampMonthDay() + "/" +
           now.getTimeStampYear() + " " + now.getTimeStampHour() + ":" + now.getTimeStampMinute() +
           ":" + now.getTimeStampSecond();
}

const Text HdlUtilities::GetVersion() {
    return Port::Version::getValue("version");
}

const Text HdlUtilities::ConvertVhdlBase(int base) {
    return GetBaseLetter(Language::Vhdl, base);
}

const Text HdlUtilities::ConvertVerilogBase(int base) {
    return GetBaseLetter(Language::Verilog, base);
}

const Text HdlUtilities::AddDummySuffix(const char* name) {
    const std::string_view text = Port::ViewOf(name);
    const std::size_t open = text.find('(');
    const std::size_t close = text.find(')');
    if (open == std::string_view::npos || close == std::string_view::npos) {
        return std::string(text).append(Names::DummySuffix);
    }
    std::string result(text.substr(0, open));
    result.append(Names::DummySuffix);
    if (close > open) {
        result.append(text.substr(open, close - open + 1));
    }
    return result;
}

bool HdlUtilities::IsGeneratedName(const char* name) {
    return Names::IsGenerated(Names::BeforeParenthesis(Port::ViewOf(name)));
}

const Text HdlUtilities::RemoveQuotes(const char* text) {
    const std::string_view whole = Port::ViewOf(text);
    Text result = text;
    for (const char quote : {'"', '\''}) {
        if (!whole.empty() && whole.front() == quote && whole.back() == quote) {
            result.Trim(quote);
        }
    }
    return result;
}

const StringArray HdlUtilities::GetAttrNames(const Instance* instance) {
    StringArray names;
    if (instance == nullptr) {
        return names;
    }
    PtrArray<Attribute*> attributes;
    const int own = GetEffectiveAttrs(*instance, attributes);
    // If the component has several attributes of one name, the first one is used.
    IStringPtrMap<const Attribute*> known;
    for (int i = 0; i < attributes.GetSize(); ++i) {
        const Attribute* const attribute = attributes.GetAt(i);
        if (i < own || !known.Contains(attribute->GetNameView())) {
            names.Add(attribute->GetName());
            known.Add(attribute->GetNameView(), attribute);
        }
    }
    return names;
}

void HdlUtilities::WriteHeader(const Text& designName, bool vhdlComments, const HdlOptions& options,
                               OutStream& out) {
    WriteHeader(designName, WithComments(vhdlComments), options, out);
}

void HdlUtilities::WriteHeader(const Text& designName, Language language, const HdlOptions& options,
                               OutStream& out) {
    const auto* const file = dynamic_cast<const TextFileOutStream*>(&out);
    NetlistHeader(options.application, file == nullptr ? Text() : file->GetFileName(),
                  options.command, designName, options.device, options.purpose, options.reference,
                  language, out)
        .Write();
}

} // namespace Orn_Hdl
