#include "Writers/Text.h"

#include "Options/LanguageTraits.h"
#include "Orn_Hdl/Options.h"
#include "Writers/OneLine.h"

#include <algorithm>
#include <array>
#include <string>

namespace Orn_Hdl::Writers {

std::string_view GetBaseName(const Pin& pin) {
    const std::string_view name = pin.GetNameView();
    return pin.GetPinType() == PinTypeScalar ? name : Names::BeforeParenthesis(name);
}

Port::String GetUnquotedValue(const Attribute& attribute) {
    const Port::String value = HdlUtilities::RemoveQuotes(attribute.GetValueString().CStr());
    return OneLine(value).GetView();
}

void WriteQuotedValue(OutStream& out, const Attribute& attribute) {
    Put(out, "\"", GetUnquotedValue(attribute), "\"");
}

std::string_view GetSingleBit(const BitVectorValue& value) {
    const std::string_view digits = value.GetValue();
    return !digits.empty() && digits.back() == '0' ? "0" : "1";
}

Blanks::Blanks(std::size_t count) {
    static constexpr auto Some = [] {
        std::array<char, 256> blanks{};
        blanks.fill(' ');
        return blanks;
    }();
    if (count > Some.size()) {
        long_.assign(count, ' ');
        view_ = long_;
    } else {
        view_ = std::string_view(Some.data(), count);
    }
}

void WriteBlanks(OutStream& out, std::size_t count) {
    out << Blanks(count).GetView();
}

std::string InComment(Language language, std::string_view text) {
    return std::string(TraitsOf(language).commentPrefix).append(" ").append(text);
}

void WriteComment(OutStream& out, Language language, const Object& object) {
    std::string_view comment = object.GetCommentView();
    while (!comment.empty()) {
        const std::size_t end = std::min(comment.find('\n'), comment.size());
        if (end > 0) {
            out << InComment(language, "") << OneLine(comment.substr(0, end)).GetView() << "\n";
        }
        comment.remove_prefix(std::min(end + 1, comment.size()));
    }
}

} // namespace Orn_Hdl::Writers
