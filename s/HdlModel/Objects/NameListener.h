// Listeners to the renaming of a netlist.
#pragma once

namespace Orn_Hdl {

class NameListener {
public:
    NameListener() = default;
    NameListener(const NameListener&) = delete;
    NameListener& operator=(const NameListener&) = delete;
    /// Called after the netlist has got its new name.
    virtual void NameChanged() noexcept = 0;

protected:
    ~NameListener() = default;
};

} // namespace Orn_Hdl
