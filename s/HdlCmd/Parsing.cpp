#include "HdlCmd/Parsing.h"

#include "Orn_Hdl/Model/Pins.h"
#include "Port/Ascii.h"

#include <optional>

namespace Orn_Hdl {

namespace {

using std::string_view;

bool IsDirection(string_view text) {
    return Polarity(std::string(text).c_str()).IsValid();
}

/// "owner.pin", split at the first ".".
struct PinPath {
    string_view owner;
    string_view pin;
    bool isPin = false;

    explicit PinPath(string_view text) : owner(text) {
        const std::size_t dot = text.find('.');
        if (dot != string_view::npos) {
            owner = text.substr(0, dot);
            pin = text.substr(dot + 1);
            isPin = true;
        }
    }
};

/// What follows the prefix of an option such as "-TYPE="; none if the text has another prefix.
std::optional<string_view> GetOptionValue(string_view text, string_view prefix) {
    if (!Port::EqualIgnoringCase(text.substr(0, prefix.size()), prefix)) {
        return std::nullopt;
    }
    return text.substr(prefix.size());
}

bool ParseNameKind(string_view text, string_view signalWord, Arguments& arguments) {
    arguments.Set({});
    if (Port::EqualIgnoringCase(text, NameKindWords::Instance)) {
        arguments.Raise(NameKind::Instance);
    } else if (Port::EqualIgnoringCase(text, signalWord)) {
        arguments.Raise(NameKind::Signal);
    } else if (Port::EqualIgnoringCase(text, NameKindWords::Component)) {
        arguments.Raise(NameKind::Component);
    } else {
        return false;
    }
    return true;
}

/// The names of what has an attribute: none for a module, an object's name, or owner and pin.
struct OwnerNames {
    string_view first;
    string_view second;
    bool isValid = true;

    OwnerNames(const StringArray& tokens, AttributeOwner owner, int position) {
        const string_view text = tokens.GetView(position);
        if (owner == AttributeOwner::Object) {
            first = text;
        } else if (owner == AttributeOwner::Pin) {
            const PinPath path(text);
            first = path.owner;
            second = path.pin;
            isValid = path.isPin;
        }
    }

    /// Sets the arguments of a command: the names of the owner, then the other texts.
    template <class... Texts>
    void SetBefore(Arguments& arguments, AttributeOwner owner, Texts... texts) const {
        switch (owner) {
        case AttributeOwner::Module:
            arguments.Set({texts...});
            break;
        case AttributeOwner::Object:
            arguments.Set({first, texts...});
            break;
        case AttributeOwner::Pin:
            arguments.Set({first, second, texts...});
            break;
        }
    }
};

/// Where the owner's name stands. The second word of the phrase is the kind of owner, one word or,
/// for a pin, two; `wordsAfter` words of the phrase follow.
constexpr int OwnerPosition(AttributeOwner owner, int wordsAfter) {
    constexpr int KindWord = 1;
    return KindWord + (owner == AttributeOwner::Pin ? 2 : 1) + wordsAfter;
}

/// Where the attribute's name stands: behind the owner's, which a module has not.
constexpr int AttributePosition(AttributeOwner owner, int wordsAfter) {
    return OwnerPosition(owner, wordsAfter) + (owner == AttributeOwner::Module ? 0 : 1);
}

} // namespace

bool ParseNothing(const StringArray& /*tokens*/, Arguments& /*arguments*/) {
    return true;
}

bool ParsePin(const StringArray& tokens, Arguments& arguments) {
    arguments.Set({tokens.GetView(3), tokens.GetView(4), tokens.GetView(2), tokens.GetView(5)});
    return tokens.GetSize() >= 5 && IsDirection(tokens.GetView(4));
}

bool ParsePort(const StringArray& tokens, Arguments& arguments) {
    arguments.Set({tokens.GetView(2), tokens.GetView(3)});
    return tokens.GetSize() >= 4 && IsDirection(tokens.GetView(3));
}

bool ParseSignal(const StringArray& tokens, Arguments& arguments) {
    arguments.Set({tokens.GetView(2)});
    return tokens.GetSize() >= 3 && (tokens.GetSize() == 3 || IsDirection(tokens.GetView(3)));
}

bool ParseConnection(const StringArray& tokens, Arguments& arguments) {
    const PinPath target(tokens.GetView(3));
    arguments.Set({tokens.GetView(2), target.owner, target.pin});
    if (target.isPin) {
        arguments.Raise(TargetFlag::Pin);
    }
    return tokens.GetSize() >= 4;
}

bool ParseConstant(const StringArray& tokens, Arguments& arguments) {
    const PinPath target(tokens.GetView(2));
    if (target.isPin) {
        arguments.Set({target.owner, target.pin, tokens.GetView(3)});
        arguments.Raise(TargetFlag::Pin);
    } else {
        arguments.Set({target.owner, tokens.GetView(3)});
    }
    return tokens.GetSize() >= 4;
}

bool ParseWrite(const StringArray& tokens, Arguments& arguments) {
    const int count = tokens.GetSize();
    const int filePosition = count == 4 || count == 5 ? count - 1 : 2;
    arguments.Set({tokens.GetView(filePosition)});
    for (int i = 2; i < filePosition; ++i) {
        if (Port::EqualIgnoringCase(tokens.GetView(i), "-APPEND")) {
            arguments.Raise(WriteFlag::Append);
        } else if (Port::EqualIgnoringCase(tokens.GetView(i), "-NOHEADER")) {
            arguments.Raise(WriteFlag::WithoutHeader);
        }
    }
    return !tokens.GetView(filePosition).empty();
}

bool ParseUppercase(const StringArray& tokens, Arguments& arguments) {
    return ParseNameKind(tokens.GetView(1), NameKindWords::SignalInUppercase, arguments);
}

bool ParseLowercase(const StringArray& tokens, Arguments& arguments) {
    return ParseNameKind(tokens.GetView(1), NameKindWords::SignalInLowercase, arguments);
}

bool ParseOwnerComment(const StringArray& tokens, Arguments& arguments) {
    arguments.Set({tokens.GetView(3), tokens.JoinFrom(4)});
    return tokens.GetSize() >= 5;
}

bool ParsePinComment(const StringArray& tokens, Arguments& arguments) {
    const PinPath path(tokens.GetView(4));
    arguments.Set({path.owner, path.pin, tokens.JoinFrom(5)});
    return tokens.GetSize() >= 6 && path.isPin;
}

bool ParseFlagAt(const StringArray& tokens, int position, Arguments& arguments) {
    arguments.Set({});
    if (!Port::EqualIgnoringCase(tokens.GetView(position), "false")) {
        arguments.Raise(OptionFlag::On);
    }
    return true;
}

bool ParseAddAttributeOf(const StringArray& tokens, AttributeOwner owner, Arguments& arguments) {
    const OwnerNames names(tokens, owner, OwnerPosition(owner, 1));
    int position = AttributePosition(owner, 1);
    const auto type = GetOptionValue(tokens.GetView(position), AttributeOptionPrefixes::Type);
    if (type) {
        ++position;
    }
    names.SetBefore(arguments, owner, tokens.GetView(position), tokens.GetView(position + 1),
                    type.value_or("String"));
    return tokens.GetSize() > position && names.isValid;
}

bool ParseAttributeTextOf(const StringArray& tokens, AttributeOwner owner, Arguments& arguments) {
    const OwnerNames names(tokens, owner, OwnerPosition(owner, 2));
    const int position = AttributePosition(owner, 2);
    names.SetBefore(arguments, owner, tokens.GetView(position), tokens.GetView(position + 1));
    return tokens.GetSize() > position + 1 && names.isValid;
}

bool ParseAttributeOptionsOf(const StringArray& tokens, AttributeOwner owner,
                             Arguments& arguments) {
    const OwnerNames names(tokens, owner, OwnerPosition(owner, 2));
    const int position = AttributePosition(owner, 2);
    if (tokens.GetSize() <= position + 1 || !names.isValid) {
        return false;
    }
    std::optional<string_view> generic;
    std::optional<string_view> synAttr;
    const int last = tokens.GetSize() - 1;
    for (int i = position + 1; i <= position + 2 && i <= last; ++i) {
        const string_view option = tokens.GetView(i);
        if (const auto value = GetOptionValue(option, AttributeOptionPrefixes::Generic)) {
            generic = value;
        } else if (const auto other = GetOptionValue(option, AttributeOptionPrefixes::SynAttr)) {
            synAttr = other;
        } else {
            return false;
        }
    }
    names.SetBefore(arguments, owner, tokens.GetView(position), generic.value_or(""),
                    synAttr.value_or(""));
    if (generic) {
        arguments.Raise(AttributeOptionFlag::Generic);
    }
    if (synAttr) {
        arguments.Raise(AttributeOptionFlag::SynAttr);
    }
    return true;
}

} // namespace Orn_Hdl
