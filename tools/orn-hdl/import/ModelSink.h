// Builds an imported design in a model.
#pragma once

#include "import/Sink.h"

#include <cstdint>
#include <string>
#include <vector>

namespace Orn_Hdl {
class Instance;
class Model;
class Signal;
} // namespace Orn_Hdl

namespace Tool::Import {

/// Builds the design in a model.
class ModelSink final : public Sink {
public:
    /// \param model not owned; it must outlive the sink.
    explicit ModelSink(Orn_Hdl::Model& model) noexcept : model_(model) {}

    void BeginGroup() override {}
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
    Orn_Hdl::Model& model_;
    /// By number, so that most connections look up no signal.
    std::vector<Orn_Hdl::Signal*> signals_;
    /// The one that was added last.
    Orn_Hdl::Instance* instance_ = nullptr;
};

} // namespace Tool::Import
