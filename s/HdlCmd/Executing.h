// What the commands of the language do with their arguments.
#pragma once

#include "HdlCmd/Arguments.h"
#include "HdlCmd/Parsing.h"
#include "Orn_Hdl/Model.h"

#include <cstddef>
#include <utility>

namespace Orn_Hdl {

namespace CommandDetail {

/// Calls an operation of the model with one argument for each of its texts.
template <class Result, class... Texts, std::size_t... Indices>
void Call(Model& model, Result (Model::*operation)(Texts...), const Arguments& arguments,
          std::index_sequence<Indices...>) {
    (model.*operation)(arguments.Get(static_cast<int>(Indices))...);
}

template <class Result, class... Texts>
void Call(Model& model, Result (Model::*operation)(Texts...), const Arguments& arguments) {
    Call(model, operation, arguments, std::index_sequence_for<Texts...>());
}

/// Calls an operation with the arguments in order, but with the argument at `last` as the last
/// text.
template <class Result, class... Texts, std::size_t... Indices>
void CallWithLast(Model& model, Result (Model::*operation)(Texts...), const Arguments& arguments,
                  int last, std::index_sequence<Indices...>) {
    constexpr std::size_t End = sizeof...(Texts) - 1;
    (model.*operation)(arguments.Get(Indices == End ? last : static_cast<int>(Indices))...);
}

/// Calls an operation with the arguments in order, but skips `behind` arguments before the last
/// text.
template <class Result, class... Texts>
void CallWithLast(Model& model, Result (Model::*operation)(Texts...), const Arguments& arguments,
                  int behind) {
    const int last = static_cast<int>(sizeof...(Texts)) - 1 + behind;
    CallWithLast(model, operation, arguments, last, std::index_sequence_for<Texts...>());
}

} // namespace CommandDetail

/// Carries out a command that is one operation of the model on the command's arguments in order.
template <auto Operation> void Apply(Model& model, const Arguments& arguments) {
    CommandDetail::Call(model, Operation, arguments);
}

/// Sets the attribute options that were given. The arguments are the names of the object and the
/// attribute, then the generic value and the synthesis-attribute value.
template <auto SetGeneric, auto SetSynAttr>
void ApplyOptions(Model& model, const Arguments& arguments) {
    if (arguments.Has(AttributeOptionFlag::Generic)) {
        CommandDetail::CallWithLast(model, SetGeneric, arguments, 0);
    }
    if (arguments.Has(AttributeOptionFlag::SynAttr)) {
        CommandDetail::CallWithLast(model, SetSynAttr, arguments, 1);
    }
}

/// The output options that hold for both languages.
struct CommonPart {
    static HdlOptions& Of(Model& model) { return *model.GetOptions(); }
};
/// The output options of Verilog.
struct VerilogPart {
    static HdlOptions::VerilogOption& Of(Model& model) { return model.GetOptions()->verilog; }
};
/// The output options of VHDL.
struct VhdlPart {
    static HdlOptions::VhdlOption& Of(Model& model) { return model.GetOptions()->vhdl; }
};

/// Appends the argument to a list among the options.
template <class Part, auto Field> void AppendOption(Model& model, const Arguments& arguments) {
    (Part::Of(model).*Field).Add(arguments.Get(0));
}

/// Sets an option to true or false, as the line says.
template <class Part, auto Field> void SetFlag(Model& model, const Arguments& arguments) {
    Part::Of(model).*Field = arguments.Has(OptionFlag::On);
}

/// Sets an option to true.
template <class Part, auto Field> void RaiseFlag(Model& model, const Arguments& /*arguments*/) {
    Part::Of(model).*Field = true;
}

/// Sets a text among the options to the argument.
template <auto Field> void SetText(Model& model, const Arguments& arguments) {
    model.GetOptions()->*Field = arguments.Get(0);
}

/// Chooses the letter case of one kind of names in Verilog.
template <HdlOptions::VerilogOption::CaseType Case>
void ExecuteCase(Model& model, const Arguments& arguments) {
    HdlOptions::VerilogOption& options = VerilogPart::Of(model);
    if (arguments.Has(NameKind::Instance)) {
        options.instanceCase = Case;
    } else if (arguments.Has(NameKind::Signal)) {
        options.signalCase = Case;
    } else {
        options.componentCase = Case;
    }
}

void ExecuteAddPin(Model& model, const Arguments& arguments);
void ExecuteAddPort(Model& model, const Arguments& arguments);
void ExecuteConnection(Model& model, const Arguments& arguments);
void ExecuteConstant(Model& model, const Arguments& arguments);
void ExecuteSetSynthesis(Model& model, const Arguments& arguments);
void ExecuteWriteVerilog(Model& model, const Arguments& arguments);
void ExecuteWriteVhdl(Model& model, const Arguments& arguments);

} // namespace Orn_Hdl
