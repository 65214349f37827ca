// What the commands of the language do with their arguments.
#pragma once

#include "HdlCmd/Arguments.h"
#include "HdlCmd/Parsing.h"
#include "Orn_Hdl/Model.h"

#include <cstddef>
#include <utility>

namespace Orn_Hdl {

namespace CommandDetail {

template <class Result, class... Texts, std::size_t... Indices>
void Call(Model& model, Result (Model::*operation)(Texts...), const Arguments& arguments,
          std::index_sequence<Indices...>) {
    (model.*operation)(arguments.Get(static_cast<int>(Indices))...);
}

template <class Result, class... Texts>
void Call(Model& model, Result (Model::*operation)(Texts...), const Arguments& arguments) {
    Call(model, operation, arguments, std::index_sequence_for<Texts...>());
}

/// As `Call`, with another text in the place of the last one.
template <class Result, class... Texts, std::size_t... Indices>
void CallWithLast(Model& model, Result (Model::*operation)(Texts...), const Arguments& arguments,
                  int last, std::index_sequence<Indices...>) {
    constexpr std::size_t End = sizeof...(Texts) - 1;
    (model.*operation)(arguments.Get(Indices == End ? last : static_cast<int>(Indices))...);
}

template <class Result, class... Texts>
void CallWithLast(Model& model, Result (Model::*operation)(Texts...), const Arguments& arguments,
                  int behind) {
    const int last = static_cast<int>(sizeof...(Texts)) - 1 + behind;
    CallWithLast(model, operation, arguments, last, std::index_sequence_for<Texts...>());
}

} // namespace CommandDetail

/// Calls an operation of the model with the arguments in order.
template <auto Operation> void Apply(Model& model, const Arguments& arguments) {
    CommandDetail::Call(model, Operation, arguments);
}

/// Calls the operations of the attribute options that were given. Behind the names of the object
/// and the attribute stand the generic value, then the synthesis-attribute value.
template <auto SetGeneric, auto SetSynAttr>
void ApplyOptions(Model& model, const Arguments& arguments) {
    if (arguments.HasFlag(GenericGiven)) {
        CommandDetail::CallWithLast(model, SetGeneric, arguments, 0);
    }
    if (arguments.HasFlag(SynAttrGiven)) {
        CommandDetail::CallWithLast(model, SetSynAttr, arguments, 1);
    }
}

/// The parts of the options.
struct CommonPart {
    static HdlOptions& Of(Model& model) { return *model.GetOptions(); }
};
struct VerilogPart {
    static HdlOptions::VerilogOption& Of(Model& model) { return model.GetOptions()->verilog; }
};
struct VhdlPart {
    static HdlOptions::VhdlOption& Of(Model& model) { return model.GetOptions()->vhdl; }
};

template <class Part, auto Field> void AppendOption(Model& model, const Arguments& arguments) {
    (Part::Of(model).*Field).Add(arguments.Get(0));
}

template <class Part, auto Field> void SetFlag(Model& model, const Arguments& arguments) {
    Part::Of(model).*Field = arguments.HasFlag(FlagOn);
}

template <class Part, auto Field> void RaiseFlag(Model& model, const Arguments& /*arguments*/) {
    Part::Of(model).*Field = true;
}

template <auto Field> void SetText(Model& model, const Arguments& arguments) {
    model.GetOptions()->*Field = arguments.Get(0);
}

template <HdlOptions::VerilogOption::CaseType Case>
void ExecuteCase(Model& model, const Arguments& arguments) {
    HdlOptions::VerilogOption& options = VerilogPart::Of(model);
    if (arguments.HasFlag(InstanceNames)) {
        options.instanceCase = Case;
    } else if (arguments.HasFlag(SignalNames)) {
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
