#include "HdlCmd/Script/Phrases.h"

#include "HdlCmd/Executing.h"
#include "Orn_Hdl/Model.h"
#include "Port/Ascii.h"

namespace Orn_Hdl::Script {

namespace {

using Vhdl = HdlOptions::VhdlOption;
using Verilog = HdlOptions::VerilogOption;

bool IsContinuedBy(std::string_view phrase, std::string_view longer) {
    return longer.size() > phrase.size() && longer[phrase.size()] == ' ' &&
           Port::EqualIgnoringCase(longer.substr(0, phrase.size()), phrase);
}

template <auto AddComment, auto AddAttribute, auto SetUserType, auto SetGeneric, auto SetSynAttr>
HolderPhrases MakeHolderPhrases() {
    return {Phrase(Apply<AddComment>), Phrase(Apply<AddAttribute>), Phrase(Apply<SetUserType>),
            Phrase(ApplyOptions<SetGeneric, SetSynAttr>)};
}

} // namespace

Phrase::Phrase(CommandExecution execute) : text(GetPhrase(execute)) {
    for (const RegisteredCommand& command : GetRegisteredCommands()) {
        const std::string_view other = command.entry.info.phrase;
        if (IsContinuedBy(text, other)) {
            continuations.push_back(other.substr(text.size() + 1));
        }
    }
}

const Phrases& Phrases::Get() {
    static const Phrases phrases = {
        .setNetlistName = Phrase(Apply<&Model::SetName>),
        .setSourceFile = Phrase(Apply<&Model::SetSourceFileName>),
        .setApplication = Phrase(SetText<&HdlOptions::application>),
        .setCommand = Phrase(SetText<&HdlOptions::command>),
        .setDevice = Phrase(SetText<&HdlOptions::device>),
        .setPurpose = Phrase(SetText<&HdlOptions::purpose>),
        .setReference = Phrase(SetText<&HdlOptions::reference>),
        .setSynthesis = Phrase(ExecuteSetSynthesis),
        .uppercase = Phrase(ExecuteCase<Verilog::UPPERCASE>),
        .lowercase = Phrase(ExecuteCase<Verilog::LOWERCASE>),
        .addInclude = Phrase(AppendOption<VerilogPart, &Verilog::includePaths>),
        .addLibrary = Phrase(AppendOption<VhdlPart, &Vhdl::libraries>),
        .addUseLibrary = Phrase(AppendOption<VhdlPart, &Vhdl::useClauses>),
        .useDefaultLibrary = Phrase(SetFlag<VhdlPart, &Vhdl::useDefaultLibrary>),
        .flattenBus = Phrase(SetFlag<VhdlPart, &Vhdl::flattenBus>),
        .suppressConfiguration = Phrase(SetFlag<VhdlPart, &Vhdl::suppressConfiguration>),
        .suppressComponent = Phrase(SetFlag<VhdlPart, &Vhdl::suppressComponent>),
        .useAttrType = Phrase(RaiseFlag<VhdlPart, &Vhdl::useAttrType>),
        .setOpenPin = Phrase(SetFlag<VhdlPart, &Vhdl::openPin>),
        .addComponent = Phrase(Apply<&Model::AddComponent>),
        .addPin = Phrase(ExecuteAddPin),
        .addPort = Phrase(ExecuteAddPort),
        .addSignal = Phrase(Apply<&Model::AddSignal>),
        .addInstance = Phrase(Apply<&Model::AddInstance>),
        .connectSignal = Phrase(ExecuteConnection),
        .assignConstant = Phrase(ExecuteConstant),
        .module =
            MakeHolderPhrases<&Model::AddNotes, &Model::AddModuleAttr, &Model::SetModuleUserType,
                              &Model::SetModuleGenericAttrValue, &Model::SetModuleSynAttrValue>(),
        .component =
            MakeHolderPhrases<&Model::AddComponentComment, &Model::AddComponentAttr,
                              &Model::SetComponentUserType, &Model::SetComponentGenericAttrValue,
                              &Model::SetComponentSynAttrValue>(),
        .instance =
            MakeHolderPhrases<&Model::AddInstanceComment, &Model::AddInstanceAttr,
                              &Model::SetInstanceUserType, &Model::SetInstanceGenericAttrValue,
                              &Model::SetInstanceSynAttrValue>(),
        .signal = MakeHolderPhrases<&Model::AddSignalComment, &Model::AddSignalAttr,
                                    &Model::SetSignalUserType, &Model::SetSignalGenericAttrValue,
                                    &Model::SetSignalSynAttrValue>(),
        .componentPin =
            MakeHolderPhrases<&Model::AddComponentPinComment, &Model::AddComponentPinAttr,
                              &Model::SetComponentPinUserType,
                              &Model::SetComponentPinGenericAttrValue,
                              &Model::SetComponentPinSynAttrValue>(),
        .instancePin = MakeHolderPhrases<&Model::AddInstancePinComment, &Model::AddInstancePinAttr,
                                         &Model::SetInstancePinUserType,
                                         &Model::SetInstancePinGenericAttrValue,
                                         &Model::SetInstancePinSynAttrValue>(),
    };
    return phrases;
}

} // namespace Orn_Hdl::Script
