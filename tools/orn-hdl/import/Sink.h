// The destination of an imported design. A model and a command file receive the same sequence of
// operations, so that replaying the command file gives the same netlist.
#pragma once

#include <cstdint>
#include <string>

namespace Tool::Import {

/// An attribute and its type, as written in the command language.
struct TypedValue {
    std::string name;
    std::string type;
    std::string value;
};

/// The library and use clauses for IEEE alone.
inline constexpr const char* IeeeLibrary = "ieee";
inline constexpr const char* IeeePackage = "ieee.std_logic_1164.ALL";
/// The line of a command file whose netlists need an option.
inline constexpr const char* DontCareNote =
    "NOOP Write netlists with --dont-cares: the digit - of constants says so.\n";
/// The attribute of a component without a configuration.
inline constexpr const char* LevelName = "LEVEL";
inline constexpr const char* LevelValue = "HALVEX";

class Sink {
public:
    Sink() = default;
    Sink(const Sink&) = delete;
    Sink& operator=(const Sink&) = delete;
    virtual ~Sink() = default;

    /// Begins a new group of operations.
    virtual void BeginGroup() = 0;
    virtual void SetName(const std::string& name) = 0;
    /// The digit "-" of constants is a don't care.
    virtual void KeepDontCares() = 0;
    virtual void SuppressConfiguration() = 0;
    /// VHDL names the library IEEE alone.
    virtual void NameIeeeAlone() = 0;
    /// VHDL gets a signal for every open input pin.
    virtual void WireOpenPins() = 0;

    virtual void AddComponent(const std::string& name) = 0;
    virtual void AddPin(const std::string& component, const std::string& pin,
                        const char* direction) = 0;
    /// The component has no configuration of its own.
    virtual void LeaveUnconfigured(const std::string& component) = 0;
    virtual void AddComponentGeneric(const std::string& component, const TypedValue& generic) = 0;

    /// Ports and signals are numbered from 0 on, in the order of `AddPort` and `AddSignal`.
    virtual void AddPort(const std::string& name, const char* direction) = 0;
    virtual void AddSignal(const std::string& name) = 0;
    /// The source drives the target.
    virtual void Alias(const std::string& target, const std::string& source) = 0;
    virtual void AssignSignal(const std::string& signal, const std::string& value) = 0;
    virtual void AddSignalAttribute(const std::string& signal, const TypedValue& attribute) = 0;

    virtual void AddInstance(const std::string& name, const std::string& component) = 0;
    virtual void AddInstanceGeneric(const std::string& instance, const TypedValue& generic) = 0;
    /// A generic of the component does not apply to the instance, which takes the default of its
    /// cell type.
    virtual void LeaveOutInstanceGeneric(const std::string& instance,
                                         const TypedValue& generic) = 0;
    virtual void AddInstanceAttribute(const std::string& instance, const TypedValue& attribute) = 0;
    virtual void Connect(const std::string& signal, const std::string& instance,
                         const std::string& pin) = 0;
    /// Connects a pin of the instance that was added last to a signal of one bit.
    /// \param number that of the signal. \param signal its name.
    virtual void ConnectScalar(std::uint32_t number, const std::string& signal,
                               const std::string& instance, const std::string& pin) = 0;
    virtual void AssignPin(const std::string& instance, const std::string& pin,
                           const std::string& value) = 0;
};

} // namespace Tool::Import
