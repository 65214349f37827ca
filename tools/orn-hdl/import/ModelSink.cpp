#include "import/ModelSink.h"

#include "Orn_Hdl/Model.h"

#include <string_view>

namespace Tool::Import {

namespace {

constexpr const char* GenericMark = "SYN";
constexpr const char* SynthesisMark = "ASSIGN";

} // namespace

void ModelSink::SetName(const std::string& name) {
    model_.SetName(name.c_str());
}

void ModelSink::KeepDontCares() {
    model_.GetOptions()->dontCares = true;
}

void ModelSink::SuppressConfiguration() {
    model_.GetOptions()->vhdl.suppressConfiguration = true;
}

void ModelSink::NameIeeeAlone() {
    Orn_Hdl::HdlOptions::VhdlOption& vhdl = model_.GetOptions()->vhdl;
    vhdl.useDefaultLibrary = false;
    vhdl.libraries.Add(IeeeLibrary);
    vhdl.useClauses.Add(IeeePackage);
}

void ModelSink::LeaveUnconfigured(const std::string& component) {
    model_.AddComponentAttr(component.c_str(), LevelName, LevelValue, "String");
}

void ModelSink::WireOpenPins() {
    model_.GetOptions()->vhdl.openPin = false;
}

void ModelSink::AddComponent(const std::string& name) {
    model_.AddComponent(name.c_str());
}

void ModelSink::AddPin(const std::string& component, const std::string& pin,
                       const char* direction) {
    model_.AddPin(pin.c_str(), Orn_Hdl::Polarity(direction), component.c_str(), "");
}

void ModelSink::AddComponentGeneric(const std::string& component, const TypedValue& generic) {
    model_.AddComponentAttr(component.c_str(), generic.name.c_str(), generic.value.c_str(),
                            generic.type.c_str());
    model_.SetComponentGenericAttrValue(component.c_str(), generic.name.c_str(), GenericMark);
}

void ModelSink::AddPort(const std::string& name, const char* direction) {
    AddSignal(name);
    signals_.back()->SetPortPolarity(Orn_Hdl::Polarity(direction));
}

void ModelSink::AddSignal(const std::string& name) {
    model_.AddSignal(name.c_str());
    signals_.push_back(model_.GetNetlist()->GetSignal(std::string_view(name)));
}

void ModelSink::Alias(const std::string& target, const std::string& source) {
    model_.ConnectSignals(target.c_str(), source.c_str());
}

void ModelSink::AssignSignal(const std::string& signal, const std::string& value) {
    model_.AssignConstantToSignal(signal.c_str(), value.c_str());
}

void ModelSink::AddSignalAttribute(const std::string& signal, const TypedValue& attribute) {
    model_.AddSignalAttr(signal.c_str(), attribute.name.c_str(), attribute.value.c_str(),
                         attribute.type.c_str());
    model_.SetSignalSynAttrValue(signal.c_str(), attribute.name.c_str(), SynthesisMark);
}

void ModelSink::AddInstance(const std::string& name, const std::string& component) {
    model_.AddInstance(name.c_str(), component.c_str());
    instance_ = model_.GetNetlist()->GetInstance(std::string_view(name));
}

void ModelSink::AddInstanceGeneric(const std::string& instance, const TypedValue& generic) {
    model_.AddInstanceAttr(instance.c_str(), generic.name.c_str(), generic.value.c_str(),
                           generic.type.c_str());
    model_.SetInstanceGenericAttrValue(instance.c_str(), generic.name.c_str(), GenericMark);
}

void ModelSink::LeaveOutInstanceGeneric(const std::string& instance, const TypedValue& generic) {
    // An attribute of the instance hides that of the component, and without an option it is not
    // written.
    model_.AddInstanceAttr(instance.c_str(), generic.name.c_str(), generic.value.c_str(),
                           generic.type.c_str());
}

void ModelSink::AddInstanceAttribute(const std::string& instance, const TypedValue& attribute) {
    model_.AddInstanceAttr(instance.c_str(), attribute.name.c_str(), attribute.value.c_str(),
                           attribute.type.c_str());
    model_.SetInstanceSynAttrValue(instance.c_str(), attribute.name.c_str(), SynthesisMark);
}

void ModelSink::Connect(const std::string& signal, const std::string& instance,
                        const std::string& pin) {
    model_.ConnectSignalToPin(signal.c_str(), instance.c_str(), pin.c_str());
}

void ModelSink::ConnectScalar(std::uint32_t number, const std::string& /*signal*/,
                              const std::string& /*instance*/, const std::string& pin) {
    signals_[number]->Connect(instance_->GetPin(std::string_view(pin)));
}

void ModelSink::AssignPin(const std::string& instance, const std::string& pin,
                          const std::string& value) {
    model_.AssignConstantToPin(instance.c_str(), pin.c_str(), value.c_str());
}

} // namespace Tool::Import
