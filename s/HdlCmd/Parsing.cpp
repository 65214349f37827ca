#include "HdlCmd/Parsing.h"

#include "Orn_Hdl/Model/Pins.h"
#include "Port/Ascii.h"

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

/// Whether a text is an option of the given prefix; `value` receives what follows it.
bool IsOption(string_view text, string_view prefix, string_view& value) {
    if (!Port::EqualIgnoringCase(text.substr(0, prefix.size()), prefix)) {
        return false;
    }
    value = text.substr(prefix.size());
    return true;
}

bool ParseNameKind(string_view text, string_view signalWord, Arguments& arguments) {
    unsigned kind = 0;
    if (Port::EqualIgnoringCase(text, "instance")) {
        kind = InstanceNames;
    } else if (Port::EqualIgnoringCase(text, signalWord)) {
        kind = SignalNames;
    } else if (Port::EqualIgnoringCase(text, "component")) {
        kind = ComponentNames;
    }
    arguments.Set({}, kind);
    return kind != 0;
}

/// The names at the front of an attribute command's arguments: none, an object's, or owner and pin.
struct OwnerNames {
    string_view first;
    string_view second;
    bool isValid = true;

    OwnerNames(const StringArray& tokens, AttributeOwner owner, int position) {
        const string_view text = tokens.GetView(position);
        if (owner == OnObject) {
            first = text;
        } else if (owner == OnPin) {
            const PinPath path(text);
            first = path.owner;
            second = path.pin;
            isValid = path.isPin;
        }
    }

    /// Sets the arguments of a command: the names that there are, then the other texts.
    template <class... Texts>
    void SetBefore(Arguments& arguments, AttributeOwner owner, unsigned flags,
                   Texts... texts) const {
        switch (owner) {
        case OnModule:
            arguments.Set({texts...}, flags);
            break;
        case OnObject:
            arguments.Set({first, texts...}, flags);
            break;
        case OnPin:
            arguments.Set({first, second, texts...}, flags);
            break;
        }
    }
};

/// Where the owner's name stands when the words MODULE, COMPONENT PIN and so on stand at `KindWord`
/// and `wordsAfter` words of the phrase follow them.
constexpr int OwnerPosition(AttributeOwner owner, int wordsAfter) {
    constexpr int KindWord = 1;
    return KindWord + (owner == OnPin ? 2 : 1) + wordsAfter;
}

constexpr int AttributePosition(AttributeOwner owner, int wordsAfter) {
    return OwnerPosition(owner, wordsAfter) + (owner == OnModule ? 0 : 1);
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
    arguments.Set({tokens.GetView(2), target.owner, target.pin},
                  target.isPin ? unsigned(OnAPin) : 0U);
    return tokens.GetSize() >= 4;
}

bool ParseConstant(const StringArray& tokens, Arguments& arguments) {
    const PinPath target(tokens.GetView(2));
    if (target.isPin) {
        arguments.Set({target.owner, target.pin, tokens.GetView(3)}, OnAPin);
    } else {
        arguments.Set({target.owner, tokens.GetView(3)});
    }
    return tokens.GetSize() >= 4;
}

bool ParseWrite(const StringArray& tokens, Arguments& arguments) {
    const int count = tokens.GetSize();
    const int filePosition = count == 4 || count == 5 ? count - 1 : 2;
    unsigned flags = 0;
    for (int i = 2; i < filePosition; ++i) {
        if (Port::EqualIgnoringCase(tokens.GetView(i), "-APPEND")) {
            flags |= AppendToFile;
        } else if (Port::EqualIgnoringCase(tokens.GetView(i), "-NOHEADER")) {
            flags |= WithoutHeader;
        }
    }
    arguments.Set({tokens.GetView(filePosition)}, flags);
    return !tokens.GetView(filePosition).empty();
}

bool ParseUppercase(const StringArray& tokens, Arguments& arguments) {
    // The spelling is the language's own.
    return ParseNameKind(tokens.GetView(1), "siganl", arguments);
}

bool ParseLowercase(const StringArray& tokens, Arguments& arguments) {
    return ParseNameKind(tokens.GetView(1), "signal", arguments);
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
    const bool isOff = Port::EqualIgnoringCase(tokens.GetView(position), "false");
    arguments.Set({}, isOff ? 0U : unsigned(FlagOn));
    return true;
}

bool ParseAddAttributeOf(const StringArray& tokens, AttributeOwner owner, Arguments& arguments) {
    const OwnerNames names(tokens, owner, OwnerPosition(owner, 1));
    int position = AttributePosition(owner, 1);
    string_view type = "String";
    if (IsOption(tokens.GetView(position), "-TYPE=", type)) {
        ++position;
    }
    names.SetBefore(arguments, owner, 0, tokens.GetView(position), tokens.GetView(position + 1),
                    type);
    return tokens.GetSize() > position && names.isValid;
}

bool ParseAttributeTextOf(const StringArray& tokens, AttributeOwner owner, Arguments& arguments) {
    const OwnerNames names(tokens, owner, OwnerPosition(owner, 2));
    const int position = AttributePosition(owner, 2);
    names.SetBefore(arguments, owner, 0, tokens.GetView(position), tokens.GetView(position + 1));
    return tokens.GetSize() > position + 1 && names.isValid;
}

bool ParseAttributeOptionsOf(const StringArray& tokens, AttributeOwner owner,
                             Arguments& arguments) {
    const OwnerNames names(tokens, owner, OwnerPosition(owner, 2));
    const int position = AttributePosition(owner, 2);
    if (tokens.GetSize() <= position + 1 || !names.isValid) {
        return false;
    }
    string_view generic;
    string_view synAttr;
    unsigned flags = 0;
    const int last = tokens.GetSize() - 1;
    for (int i = position + 1; i <= position + 2 && i <= last; ++i) {
        if (IsOption(tokens.GetView(i), "-GENERIC=", generic)) {
            flags |= GenericGiven;
        } else if (IsOption(tokens.GetView(i), "-SYNATTR=", synAttr)) {
            flags |= SynAttrGiven;
        } else {
            return false;
        }
    }
    names.SetBefore(arguments, owner, flags, tokens.GetView(position), generic, synAttr);
    return true;
}

} // namespace Orn_Hdl
