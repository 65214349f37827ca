// Who looks at a netlist while it is read, in the place of a netlist that keeps it.
#pragma once

#include "Readers/Heads.h"
#include "Readers/Place.h"
#include "Readers/Range.h"

#include <cstddef>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace Orn_Hdl {

class Signal;

namespace Readers {

/// What a concatenation consists of: signals and parts of them, leftmost first.
using Members = std::vector<Signal*>;

/// The object to which a parameter or an attribute belongs.
struct Owner {
    enum Kind { Module, Component, Instance, Signal };
    Kind kind = Module;
    /// Null for all but a signal.
    const Orn_Hdl::Signal* signal = nullptr;
    /// The name of a component or an instance in the file.
    std::string_view name;
};

/// Is told what a reader finds, in the order of the file. Nothing is kept but the signals that the
/// sink hands out, which stand for names of the file.
class NetlistSink {
public:
    NetlistSink() = default;
    NetlistSink(const NetlistSink&) = delete;
    NetlistSink& operator=(const NetlistSink&) = delete;
    virtual ~NetlistSink() = default;

    /// The module begins.
    virtual void TakeModule(std::string_view name, const Place& place) = 0;
    /// A port or net is declared.
    /// \param direction a value of `Polarity`, which is invalid for a net inside.
    /// \return a scalar signal, or a bus of that range, which stands for it from then on.
    virtual Signal* Declare(const std::string& name, const std::optional<Range>& range,
                            int direction, const Place& place) = 0;
    /// The signal that stands for a name, which may be that of a part in parentheses; null when
    /// there is none.
    virtual Signal* FindSignal(std::string_view name) = 0;
    /// A component is declared.
    virtual void TakeComponent(const ModuleHead& head, const Place& place) = 0;
    /// A configuration binds instances of a component to the configuration of that component. Comes
    /// before anything else.
    virtual void TakeBinding(const std::vector<std::string>& instances,
                             const std::string& component, const Place& place) = 0;
    /// An instance begins. What comes before the next one can belong to it.
    virtual void BeginInstance(std::string_view name, const ModuleHead& head,
                               const Place& place) = 0;
    /// A port of the present instance is connected. One that is not connected is not mentioned.
    virtual void Connect(const PortHead& port, const Members& members, const Place& place) = 0;
    /// A port of the present instance is connected to a constant.
    virtual void ConnectConstant(const PortHead& port, const Place& place) = 0;
    /// Nets are assigned to others, in Verilog not always to as many.
    virtual void Assign(const Members& target, const Members& source, const Place& place) = 0;
    /// Nets are tied to a constant. \param bits one of "01xz" for each, leftmost first.
    virtual void Tie(const Members& target, const std::string& bits, const Place& place) = 0;
    /// A parameter of the module has a value, or one of the present instance gets one.
    /// \param isHidden whether synthesis does not see it.
    virtual void TakeParameter(const Owner& owner, const std::string& name, const Value& value,
                               bool isHidden, const Place& place) = 0;
    /// An object has an attribute. In VHDL, those of an instance come before it.
    /// \param isDeclared whether there is a declaration of the attribute, or need be none.
    virtual void TakeAttribute(const Owner& owner, const std::string& name, const Value& value,
                               bool isDeclared, const Place& place) = 0;
};

} // namespace Readers
} // namespace Orn_Hdl
