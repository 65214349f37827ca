// Writes an imported design as a command file.
#pragma once

#include "import/Sink.h"

#include <string>
#include <string_view>

namespace Port {
class Stream;
}

namespace Tool::Import {

/// Writes the design as commands.
class CommandSink final : public Sink {
public:
    /// \param out not owned; it must outlive the sink.
    explicit CommandSink(Port::Stream& out) noexcept : out_(out) {}

    void BeginGroup() override;
    void SetName(const std::string& name) override;
    void KeepDontCares() override;
    void SuppressConfiguration() override;
    void NameIeeeAlone() override;
    void WireOpenPins() override;
    void AddComponent(const std::string& name) override;
    void AddPin(const std::string& component, const std::string& pin,
                const char* direction) override;
    void LeaveUnconfigured(const std::string& component) override;
    void AddComponentGeneric(const std::string& component, const TypedValue& generic) override;
    void AddPort(const std::string& name, const char* direction) override;
    void AddSignal(const std::string& name) override;
    void Alias(const std::string& target, const std::string& source) override;
    void AssignSignal(const std::string& signal, const std::string& value) override;
    void AddSignalAttribute(const std::string& signal, const TypedValue& attribute) override;
    void AddInstance(const std::string& name, const std::string& component) override;
    void AddInstanceGeneric(const std::string& instance, const TypedValue& generic) override;
    void LeaveOutInstanceGeneric(const std::string& instance, const TypedValue& generic) override;
    void AddInstanceAttribute(const std::string& instance, const TypedValue& attribute) override;
    void Connect(const std::string& signal, const std::string& instance,
                 const std::string& pin) override;
    void ConnectScalar(std::uint32_t number, const std::string& signal, const std::string& instance,
                       const std::string& pin) override;
    void AssignPin(const std::string& instance, const std::string& pin,
                   const std::string& value) override;

private:
    template <class... Words> void WriteLine(std::string_view phrase, const Words&... words);
    void WriteTypedValue(const std::string& phrase, const std::string& owner,
                         const TypedValue& value);
    void WriteAttribute(std::string_view object, const std::string& owner, const TypedValue& value,
                        std::string_view option);

    Port::Stream& out_;
    std::string line_;
};

/// Appends a word to a command line, with quotes if necessary.
/// \throws Error if the word cannot be quoted.
void AppendWord(std::string& line, std::string_view word);

} // namespace Tool::Import
