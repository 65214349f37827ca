// The options of a model by name.
#include "Objects.h"

#include <climits>
#include <map>
#include <string>
#include <variant>

namespace Python {

namespace {

using Orn_Hdl::HdlOptions;
using VerilogOption = HdlOptions::VerilogOption;

/// Where an option lies.
using Place = std::variant<bool*, unsigned*, Port::StringBase<char>*, Orn_Hdl::StringArray*>;

std::map<std::string_view, Place> GetPlaces(HdlOptions& options) {
    return {{"legal", &options.legal},
            {"escape_names", &options.escapeNames},
            {"verify", &options.verify},
            {"dont_cares", &options.dontCares},
            {"threads", &options.threads},
            {"application", &options.application},
            {"command", &options.command},
            {"device", &options.device},
            {"purpose", &options.purpose},
            {"reference", &options.reference},
            {"suppress_configuration", &options.vhdl.suppressConfiguration},
            {"suppress_component", &options.vhdl.suppressComponent},
            {"flatten_bus", &options.vhdl.flattenBus},
            {"use_default_library", &options.vhdl.useDefaultLibrary},
            {"use_attribute_types", &options.vhdl.useAttrType},
            {"open_pins", &options.vhdl.openPin},
            {"libraries", &options.vhdl.libraries},
            {"use_clauses", &options.vhdl.useClauses},
            {"includes", &options.verilog.includePaths}};
}

Place FindPlace(HdlOptions& options, const char* name) {
    const auto places = GetPlaces(options);
    const auto found = places.find(name);
    if (found == places.end()) {
        PyErr_Format(PyExc_AttributeError, "there is no option %s", name);
        throw ErrorIsSet();
    }
    return found->second;
}

Ref MakeTexts(const Orn_Hdl::StringArray& texts) {
    Ref list = MakeList();
    for (int i = 0; i < texts.GetSize(); ++i) {
        Append(list, MakeText(texts.GetView(i)));
    }
    return list;
}

unsigned GetCount(const Arguments& arguments, Py_ssize_t i) {
    const long count = arguments.GetInt(i);
    if (count < 0 || count > INT_MAX) {
        PyErr_SetString(PyExc_ValueError, "a number from 0 is needed");
        throw ErrorIsSet();
    }
    return static_cast<unsigned>(count);
}

Ref GetOption(ModelState& state, Arguments& arguments) {
    const Place place = FindPlace(*state.Get().GetOptions(), arguments.GetText(0));
    if (const auto* const flag = std::get_if<bool*>(&place)) {
        return MakeBool(**flag);
    }
    if (const auto* const number = std::get_if<unsigned*>(&place)) {
        return MakeInt(static_cast<long>(**number));
    }
    if (const auto* const text = std::get_if<Port::StringBase<char>*>(&place)) {
        return MakeText(**text);
    }
    return MakeTexts(*std::get<Orn_Hdl::StringArray*>(place));
}

/// Name, value.
Ref SetOption(ModelState& state, Arguments& arguments) {
    const Place place = FindPlace(*state.Get().GetOptions(), arguments.GetText(0));
    if (const auto* const flag = std::get_if<bool*>(&place)) {
        **flag = arguments.GetBool(1);
    } else if (const auto* const number = std::get_if<unsigned*>(&place)) {
        **number = GetCount(arguments, 1);
    } else if (const auto* const text = std::get_if<Port::StringBase<char>*>(&place)) {
        **text = arguments.GetText(1);
    } else {
        Orn_Hdl::StringArray texts;
        for (const std::string& one : TakeTexts(arguments.Get(1))) {
            texts.Add(one);
        }
        *std::get<Orn_Hdl::StringArray*>(place) = texts;
    }
    return Ref::None();
}

Ref GetSynthesis(ModelState& state, Arguments& /*arguments*/) {
    return MakeInt(state.Get().GetOptions()->verilog.synthesisType);
}

Ref SetSynthesis(ModelState& state, Arguments& arguments) {
    state.Get().GetOptions()->verilog.SetSynthesisType(arguments.GetText(0));
    return Ref::None();
}

VerilogOption::CaseType& LetterCaseOf(VerilogOption& options, Kind kind) {
    if (kind == Kind::Component) {
        return options.componentCase;
    }
    return kind == Kind::Instance ? options.instanceCase : options.signalCase;
}

/// Kind. 0 for as it stands, 1 for upper case, 2 for lower case.
Ref GetLetterCase(ModelState& state, Arguments& arguments) {
    const VerilogOption::CaseType letterCase =
        LetterCaseOf(state.Get().GetOptions()->verilog, GetKind(arguments, 0));
    return MakeInt(letterCase - VerilogOption::DEFSULT);
}

/// Kind, case.
Ref SetLetterCase(ModelState& state, Arguments& arguments) {
    const long letterCase = arguments.GetInt(1);
    if (letterCase < 0 || letterCase > 2) {
        PyErr_SetString(PyExc_ValueError, "no such letter case");
        throw ErrorIsSet();
    }
    LetterCaseOf(state.Get().GetOptions()->verilog, GetKind(arguments, 0)) =
        static_cast<VerilogOption::CaseType>(VerilogOption::DEFSULT + letterCase);
    return Ref::None();
}

} // namespace

const std::vector<PyMethodDef> OptionMethods = {
    Row<GetOption, 1>("option"),          Row<SetOption, 2>("set_option"),
    Row<GetSynthesis, 0>("synthesis"),    Row<SetSynthesis, 1>("set_synthesis"),
    Row<GetLetterCase, 1>("letter_case"), Row<SetLetterCase, 2>("set_letter_case"),
};

} // namespace Python
