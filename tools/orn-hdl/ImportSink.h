// Where an imported design goes: into a model, or into a command file. Both get the same sequence
// of operations, so that the command file, replayed, gives the same netlist.
#pragma once

#include <string>
#include <string_view>

namespace Orn_Hdl {
class Model;
}

namespace Port {
class Stream;
}

namespace Tool::Import {

/// An attribute of a given type, as the command language spells both.
struct TypedValue {
    std::string name;
    std::string type;
    std::string value;
};

class Sink {
public:
    Sink() = default;
    Sink(const Sink&) = delete;
    Sink& operator=(const Sink&) = delete;
    virtual ~Sink() = default;

    /// A new group of operations begins.
    virtual void BeginGroup() = 0;
    virtual void SetName(const std::string& name) = 0;
    virtual void SuppressConfiguration() = 0;
    /// VHDL gets a signal for every open input pin.
    virtual void WireOpenPins() = 0;

    virtual void AddComponent(const std::string& name) = 0;
    virtual void AddPin(const std::string& component, const std::string& pin,
                        const char* direction) = 0;
    virtual void AddComponentGeneric(const std::string& component, const TypedValue& generic) = 0;

    virtual void AddPort(const std::string& name, const char* direction) = 0;
    virtual void AddSignal(const std::string& name) = 0;
    /// The source drives the target.
    virtual void Alias(const std::string& target, const std::string& source) = 0;
    virtual void AssignSignal(const std::string& signal, const std::string& value) = 0;
    virtual void AddSignalAttribute(const std::string& signal, const TypedValue& attribute) = 0;

    virtual void AddInstance(const std::string& name, const std::string& component) = 0;
    virtual void AddInstanceGeneric(const std::string& instance, const TypedValue& generic) = 0;
    virtual void AddInstanceAttribute(const std::string& instance, const TypedValue& attribute) = 0;
    virtual void Connect(const std::string& signal, const std::string& instance,
                         const std::string& pin) = 0;
    virtual void AssignPin(const std::string& instance, const std::string& pin,
                           const std::string& value) = 0;
};

/// Builds the design in a model.
class ModelSink final : public Sink {
public:
    explicit ModelSink(Orn_Hdl::Model& model) noexcept : model_(model) {}

    void BeginGroup() override {}
    void SetName(const std::string& name) override;
    void SuppressConfiguration() override;
    void WireOpenPins() override;
    void AddComponent(const std::string& name) override;
    void AddPin(const std::string& component, const std::string& pin,
                const char* direction) override;
    void AddComponentGeneric(const std::string& component, const TypedValue& generic) override;
    void AddPort(const std::string& name, const char* direction) override;
    void AddSignal(const std::string& name) override;
    void Alias(const std::string& target, const std::string& source) override;
    void AssignSignal(const std::string& signal, const std::string& value) override;
    void AddSignalAttribute(const std::string& signal, const TypedValue& attribute) override;
    void AddInstance(const std::string& name, const std::string& component) override;
    void AddInstanceGeneric(const std::string& instance, const TypedValue& generic) override;
    void AddInstanceAttribute(const std::string& instance, const TypedValue& attribute) override;
    void Connect(const std::string& signal, const std::string& instance,
                 const std::string& pin) override;
    void AssignPin(const std::string& instance, const std::string& pin,
                   const std::string& value) override;

private:
    Orn_Hdl::Model& model_;
};

/// Writes the design as commands.
class CommandSink final : public Sink {
public:
    /// \param out not owned; it must outlive the sink.
    explicit CommandSink(Port::Stream& out) noexcept : out_(out) {}

    void BeginGroup() override;
    void SetName(const std::string& name) override;
    void SuppressConfiguration() override;
    void WireOpenPins() override;
    void AddComponent(const std::string& name) override;
    void AddPin(const std::string& component, const std::string& pin,
                const char* direction) override;
    void AddComponentGeneric(const std::string& component, const TypedValue& generic) override;
    void AddPort(const std::string& name, const char* direction) override;
    void AddSignal(const std::string& name) override;
    void Alias(const std::string& target, const std::string& source) override;
    void AssignSignal(const std::string& signal, const std::string& value) override;
    void AddSignalAttribute(const std::string& signal, const TypedValue& attribute) override;
    void AddInstance(const std::string& name, const std::string& component) override;
    void AddInstanceGeneric(const std::string& instance, const TypedValue& generic) override;
    void AddInstanceAttribute(const std::string& instance, const TypedValue& attribute) override;
    void Connect(const std::string& signal, const std::string& instance,
                 const std::string& pin) override;
    void AssignPin(const std::string& instance, const std::string& pin,
                   const std::string& value) override;

private:
    template <class... Words> void WriteLine(std::string_view phrase, const Words&... words);
    void WriteAttribute(std::string_view object, const std::string& owner, const TypedValue& value,
                        std::string_view option);

    Port::Stream& out_;
    std::string line_;
};

/// Appends a word of a command line, quoted where that is needed.
/// \throws Error when no quoting carries it.
void AppendWord(std::string& line, std::string_view word);

} // namespace Tool::Import
