// Attributes that do not exist, and wrong types and options of attributes.
#include "explain/Failure.h"

#include "Orn_Hdl/Attributes.h"
#include "Port/Ascii.h"
#include "diagnostics/Nearest.h"

#include <algorithm>
#include <cstddef>

namespace Tool::Explain {

using Orn_Hdl::Attribute;
using Orn_Hdl::AttributeHolder;
using std::string_view;

namespace {

/// An option word such as -TYPE=VALUE with one of the values that it may have.
struct Option {
    string_view start;
    std::vector<std::string> values;
};

const std::vector<Option>& GetOptions() {
    static const std::vector<Option> options = {
        {"-TYPE=", {"String", "Integer", "Float", "Boolean", "Bit", "BitVector", "User"}},
        {"-GENERIC=", {"NONE", "SYN", "NOSYN"}},
        {"-SYNATTR=", {"NONE", "ASSIGN", "ASSIGNNODEC"}}};
    return options;
}

/// Explains a word that is an option with a wrong value. \return whether it is one.
bool ExplainOption(string_view word, int place, Explanation& explanation) {
    for (const Option& option : GetOptions()) {
        if (!Port::EqualIgnoringCase(word.substr(0, option.start.size()), option.start)) {
            continue;
        }
        const string_view value = word.substr(option.start.size());
        const bool isValid =
            std::any_of(option.values.begin(), option.values.end(), [&](const std::string& valid) {
                return Port::EqualIgnoringCase(valid, value);
            });
        if (!isValid) {
            explanation.mark = Mark::Part(place, option.start.size());
            explanation.Say("the value is " + JoinChoices(option.values, "or"));
            Suggest(GetNearest(value, option.values), explanation);
            return true;
        }
    }
    return false;
}

void ExplainOptions(const Failure& failure, Explanation& explanation) {
    for (int place = failure.phrase->CountWords(); place < failure.words.GetSize(); ++place) {
        if (ExplainOption(failure.GetWord(place), place, explanation)) {
            return;
        }
    }
}

/// The object that a line gives an attribute to; null if there is none.
const AttributeHolder* FindHolder(const Failure& failure) {
    const Orn_Hdl::Netlist& netlist = *failure.model.GetNetlist();
    const Phrase& phrase = *failure.phrase;
    const string_view word = failure.GetWord(phrase.CountWords());
    const std::size_t dot = std::min(word.find('.'), word.size());
    const string_view owner = word.substr(0, dot);
    const string_view pin = word.substr(std::min(dot + 1, word.size()));
    if (phrase.FindArgument("<component>") >= 0) {
        return netlist.GetComponent(word);
    }
    if (phrase.FindArgument("<instance>") >= 0) {
        return netlist.GetInstance(word);
    }
    if (phrase.FindArgument("<signal>") >= 0) {
        return netlist.GetSignal(word);
    }
    if (phrase.FindArgument("<component.pin>") >= 0) {
        const Orn_Hdl::Component* const component = netlist.GetComponent(owner);
        return component == nullptr ? nullptr : component->GetPin(pin);
    }
    if (phrase.FindArgument("<instance.pin>") >= 0) {
        const Orn_Hdl::Instance* const instance = netlist.GetInstance(owner);
        return instance == nullptr ? nullptr : instance->GetPin(pin);
    }
    return &netlist;
}

} // namespace

void ExplainAttribute(string_view name, const Failure& failure, Explanation& explanation) {
    const int place = failure.phrase->FindArgument("<attribute>");
    explanation.mark = Mark::Word(place);
    const AttributeHolder* const holder = FindHolder(failure);
    if (holder == nullptr) {
        return;
    }
    NearestWord nearest(name);
    std::vector<std::string> names;
    for (const Attribute* attribute : holder->GetAttrIterator()) {
        names.push_back(Show(attribute->GetNameView()));
        nearest.Consider(attribute->GetNameView());
    }
    if (!nearest.Get().empty()) {
        Suggest(nearest.Get(), explanation);
        return;
    }
    constexpr std::size_t MostNames = 8;
    const std::string owner = place > failure.phrase->CountWords()
                                  ? Show(failure.GetWord(failure.phrase->CountWords()))
                                  : std::string("the module");
    if (names.empty()) {
        explanation.Say(owner + " has no attributes");
    } else if (names.size() <= MostNames) {
        explanation.Say(owner + " has the attribute" + (names.size() == 1 ? " " : "s ") +
                        JoinChoices(names, "and"));
    }
}

void ExplainAttributeType(const Failure& failure, Explanation& explanation) {
    ExplainOptions(failure, explanation);
    const int place = failure.phrase->FindArgument("<attribute>");
    const AttributeHolder* const holder = FindHolder(failure);
    if (explanation.mark || place < 0 || holder == nullptr) {
        return;
    }
    // Only an attribute of type User can be given the name of a type.
    explanation.mark = Mark::Word(place);
    const std::string name(failure.GetWord(place));
    if (const Attribute* attribute = holder->GetAttr(name.c_str())) {
        explanation.Say(Show(name) + " is of type " +
                        std::string(attribute->GetValueTypeName().GetView()) +
                        "; only an attribute added with -TYPE=User has a type name");
    }
}

void ExplainAttributeOption(const Failure& failure, Explanation& explanation) {
    ExplainOptions(failure, explanation);
}

} // namespace Tool::Explain
