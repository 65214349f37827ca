// Who wants to know that a netlist has another name.
#pragma once

namespace Orn_Hdl {

class NameListener {
public:
    NameListener() = default;
    NameListener(const NameListener&) = delete;
    NameListener& operator=(const NameListener&) = delete;
    /// The netlist bears its new name when this is called.
    virtual void NameChanged() noexcept = 0;

protected:
    ~NameListener() = default;
};

} // namespace Orn_Hdl
