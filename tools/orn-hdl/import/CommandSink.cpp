#include "import/CommandSink.h"

#include "import/JsonPath.h"

#include "Port/File.h"

namespace Tool::Import {

void AppendWord(std::string& line, std::string_view word) {
    // A line ends at a line feed or NUL, and a carriage return before its end is dropped.
    if (word.find_first_of(std::string_view("\n\r\0", 3)) != std::string_view::npos) {
        throw Error("a text with a line end or a NUL cannot be written to a command file");
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
            "a text that ends in a backslash and needs quotes cannot be written to a command file");
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

void CommandSink::WriteTypedValue(const std::string& phrase, const std::string& owner,
                                  const TypedValue& value) {
    const std::string type = "-TYPE=" + value.type;
    WriteLine(phrase, owner, type, value.name, value.value);
}

void CommandSink::WriteAttribute(std::string_view object, const std::string& owner,
                                 const TypedValue& value, std::string_view option) {
    const std::string kind(object);
    WriteTypedValue("ADD " + kind + " ATTRIBUTE", owner, value);
    WriteLine("SET " + kind + " ATTRIBUTE OPTION", owner, value.name, option);
}

void CommandSink::BeginGroup() {
    out_ << "\n";
}

void CommandSink::SetName(const std::string& name) {
    WriteLine("SET NETLIST NAME", name);
}

void CommandSink::KeepDontCares() {
    out_ << DontCareNote;
}

void CommandSink::SuppressConfiguration() {
    WriteLine("SUPPRESS CONFIGURATION", "TRUE");
}

void CommandSink::NameIeeeAlone() {
    WriteLine("USE DEFAULT LIBRARY", "FALSE");
    WriteLine("ADD LIBRARY", IeeeLibrary);
    WriteLine("ADD USE LIBRARY", IeeePackage);
}

void CommandSink::LeaveUnconfigured(const std::string& component) {
    WriteTypedValue("ADD COMPONENT ATTRIBUTE", component, {LevelName, "String", LevelValue});
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

void CommandSink::LeaveOutInstanceGeneric(const std::string& instance, const TypedValue& generic) {
    // An attribute of the instance hides that of the component, and without an option it is not
    // written.
    WriteTypedValue("ADD INSTANCE ATTRIBUTE", instance, generic);
}

void CommandSink::AddInstanceAttribute(const std::string& instance, const TypedValue& attribute) {
    WriteAttribute("INSTANCE", instance, attribute, "-SYNATTR=ASSIGN");
}

void CommandSink::Connect(const std::string& signal, const std::string& instance,
                          const std::string& pin) {
    WriteLine("CONNECT SIGNAL", signal, instance + "." + pin);
}

void CommandSink::ConnectScalar(std::uint32_t /*number*/, const std::string& signal,
                                const std::string& instance, const std::string& pin) {
    Connect(signal, instance, pin);
}

void CommandSink::AssignPin(const std::string& instance, const std::string& pin,
                            const std::string& value) {
    WriteLine("ASSIGN CONSTANT", instance + "." + pin, value);
}

} // namespace Tool::Import
