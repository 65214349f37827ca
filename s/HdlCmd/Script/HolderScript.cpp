#include "HdlCmd/Script/HolderScript.h"

#include "HdlCmd/Parsing.h"
#include "HdlCmd/Script/Values.h"

#include <string>

namespace Orn_Hdl::Script {

namespace {

class HolderWriter {
public:
    HolderWriter(const Holder& holder, Lines& lines) : holder_(holder), lines_(lines) {}

    void WriteComment() {
        std::string_view rest = holder_.object.GetCommentView();
        while (!rest.empty()) {
            const std::size_t end = rest.find('\n');
            Write(holder_.phrases.addComment, {rest.substr(0, end)});
            rest.remove_prefix(end == std::string_view::npos ? rest.size() : end + 1);
        }
    }

    void WriteAttribute(const Attribute& attribute) {
        Check(attribute);
        const std::string_view name = attribute.GetNameView();
        const std::string value = GetText(attribute);
        const Port::StringBase<char> type = attribute.GetValueTypeName();
        if (attribute.GetValueType() != Attribute::String) {
            const std::string option = With(AttributeOptionPrefixes::Type, type);
            if (value.empty()) {
                Write(holder_.phrases.addAttribute, {option, name});
            } else {
                Write(holder_.phrases.addAttribute, {option, name, value});
            }
        } else if (value.empty()) {
            Write(holder_.phrases.addAttribute, {name});
        } else {
            Write(holder_.phrases.addAttribute, {name, value});
        }
        WriteUserType(attribute);
        WriteOptions(attribute);
    }

private:
    static std::string With(std::string_view prefix, const Port::StringBase<char>& text) {
        return std::string(prefix).append(text.GetView());
    }

    void Write(const Phrase& phrase, std::initializer_list<std::string_view> words) {
        // At most the object's name and three words of an attribute.
        const std::string_view* const word = words.begin();
        if (!holder_.isNamed) {
            lines_.Write(phrase, words);
        } else if (words.size() == 1) {
            lines_.Write(phrase, {holder_.name, word[0]});
        } else if (words.size() == 2) {
            lines_.Write(phrase, {holder_.name, word[0], word[1]});
        } else {
            lines_.Write(phrase, {holder_.name, word[0], word[1], word[2]});
        }
    }

    /// A second attribute of one name would set the first one's value.
    void Check(const Attribute& attribute) const {
        const Port::StringBase<char> name = attribute.GetName();
        const Attribute* const found = holder_.attributes.GetAttr(name.CStr());
        if (found != nullptr && found != &attribute) {
            FailToExpress("attribute", name.GetView(), "its object has another one of that name");
        }
        if (attribute.GetValueTypeName().IsEmpty()) {
            FailToExpress("attribute", name.GetView(), "it has a type of its own");
        }
        if (!attribute.GetCommentView().empty()) {
            FailToExpress("attribute", name.GetView(), "it has a comment");
        }
    }

    void WriteUserType(const Attribute& attribute) {
        const auto* const user = dynamic_cast<const AttributeUser*>(&attribute);
        const Port::StringBase<char> type =
            user == nullptr ? Port::StringBase<char>() : user->GetUserType();
        if (!type.IsEmpty()) {
            Write(holder_.phrases.setUserType, {attribute.GetNameView(), type.GetView()});
        }
    }

    void WriteOptions(const Attribute& attribute) {
        const std::string generic = With(AttributeOptionPrefixes::Generic, attribute.GetGeneric());
        const std::string synAttr = With(AttributeOptionPrefixes::SynAttr, attribute.GetSynAttr());
        const bool hasGeneric = attribute.GetGenericOption() != Attribute::DEFAULT_GENERIC;
        const bool hasSynAttr = attribute.GetSynAttrOption() != Attribute::DEFAULT_SYNATTR;
        const Phrase& phrase = holder_.phrases.setOptions;
        if (hasGeneric && hasSynAttr) {
            Write(phrase, {attribute.GetNameView(), generic, synAttr});
        } else if (hasGeneric || hasSynAttr) {
            Write(phrase, {attribute.GetNameView(), hasGeneric ? generic : synAttr});
        }
    }

    const Holder& holder_;
    Lines& lines_;
};

} // namespace

void WriteHolder(const Holder& holder, Lines& lines) {
    HolderWriter writer(holder, lines);
    writer.WriteComment();
    for (const Attribute* attribute : holder.attributes.GetAttrIterator()) {
        writer.WriteAttribute(*attribute);
    }
}

} // namespace Orn_Hdl::Script
