#include "ImportSink.h"

#include "ImportDesign.h"
#include "Orn_Hdl/Model.h"
#include "Port/File.h"

#include <algorithm>

namespace Tool::Import {

namespace {

constexpr const char* GenericMark = "SYN";
constexpr const char* SynthesisMark = "ASSIGN";

} // namespace

void ModelSink::SetName(const std::string& name) {
    model_.SetName(name.c_str());
}

void ModelSink::SuppressConfiguration() {
    model_.GetOptions()->vhdl.suppressConfiguration = true;
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
    model_.AddSignal(name.c_str());
    model_.GetSignal(name.c_str())->SetPortPolarity(Orn_Hdl::Polarity(direction));
}

void ModelSink::AddSignal(const std::string& name) {
    model_.AddSignal(name.c_str());
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
}

void ModelSink::AddInstanceGeneric(const std::string& instance, const TypedValue& generic) {
    model_.AddInstanceAttr(instance.c_str(), generic.name.c_str(), generic.value.c_str(),
                           generic.type.c_str());
    model_.SetInstanceGenericAttrValue(instance.c_str(), generic.name.c_str(), GenericMark);
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

void ModelSink::AssignPin(const std::string& instance, const std::string& pin,
                          const std::string& value) {
    model_.AssignConstantToPin(instance.c_str(), pin.c_str(), value.c_str());
}

void AppendWord(std::string& line, std::string_view word) {
    // A line ends at a line feed or NUL, and loses a carriage return before its end.
    if (word.find_first_of(std::string_view("\n\r\0", 3)) != std::string_view::npos) {
        throw Error("a text with a line end or a NUL cannot stand in a command file");
    }
    const bool plain = !word.empty() && word.find(' ') == std::string_view::npos &&
                       word.front() != '"' && word.front() != '\'';
    if (plain) {
        line.append(word);
        return;
    }
    // A backslash before the closing quote would keep the quote open.
    if (!word.empty() && word.back() == '\\') {
        throw Error(
            "a text that ends in a backslash and needs quotes cannot stand in a command file");
    }
    line += '"';
    for (const char c : word) {
        line.append(c == '"' ? "\\" : "") += c;
    }
    line += '"';
}

template <class... Words>
void CommandSink::WriteLine(std::string_view phrase, const Words&... words) {
    line_ = phrase;
    ((line_ += ' ', AppendWord(line_, words)), ...);
    line_ += '\n';
    out_ << line_;
}

void CommandSink::WriteAttribute(std::string_view object, const std::string& owner,
                                 const TypedValue& value, std::string_view option) {
    const std::string kind(object);
    const std::string type = "-TYPE=" + value.type;
    WriteLine("ADD " + kind + " ATTRIBUTE", owner, type, value.name, value.value);
    WriteLine("SET " + kind + " ATTRIBUTE OPTION", owner, value.name, option);
}

void CommandSink::BeginGroup() {
    out_ << "\n";
}

void CommandSink::SetName(const std::string& name) {
    WriteLine("SET NETLIST NAME", name);
}

void CommandSink::SuppressConfiguration() {
    WriteLine("SUPPRESS CONFIGURATION", "TRUE");
}

void CommandSink::WireOpenPins() {
    WriteLine("SET OPEN PIN", "FALSE");
}

void CommandSink::AddComponent(const std::string& name) {
    WriteLine("ADD COMPONENT", name);
}

void CommandSink::AddPin(const std::string& component, const std::string& pin,
                         const char* direction) {
    WriteLine("ADD PIN", component, pin, direction);
}

void CommandSink::AddComponentGeneric(const std::string& component, const TypedValue& generic) {
    WriteAttribute("COMPONENT", component, generic, "-GENERIC=SYN");
}

void CommandSink::AddPort(const std::string& name, const char* direction) {
    WriteLine("ADD PORT", name, direction);
}

void CommandSink::AddSignal(const std::string& name) {
    WriteLine("ADD SIGNAL", name);
}

void CommandSink::Alias(const std::string& target, const std::string& source) {
    WriteLine("CONNECT SIGNAL", target, source);
}

void CommandSink::AssignSignal(const std::string& signal, const std::string& value) {
    WriteLine("ASSIGN CONSTANT", signal, value);
}

void CommandSink::AddSignalAttribute(const std::string& signal, const TypedValue& attribute) {
    WriteAttribute("SIGNAL", signal, attribute, "-SYNATTR=ASSIGN");
}

void CommandSink::AddInstance(const std::string& name, const std::string& component) {
    WriteLine("ADD INSTANCE", component, name);
}

void CommandSink::AddInstanceGeneric(const std::string& instance, const TypedValue& generic) {
    WriteAttribute("INSTANCE", instance, generic, "-GENERIC=SYN");
}

void CommandSink::AddInstanceAttribute(const std::string& instance, const TypedValue& attribute) {
    WriteAttribute("INSTANCE", instance, attribute, "-SYNATTR=ASSIGN");
}

void CommandSink::Connect(const std::string& signal, const std::string& instance,
                          const std::string& pin) {
    WriteLine("CONNECT SIGNAL", signal, instance + "." + pin);
}

void CommandSink::AssignPin(const std::string& instance, const std::string& pin,
                            const std::string& value) {
    WriteLine("ASSIGN CONSTANT", instance + "." + pin, value);
}

} // namespace Tool::Import
