/// \file
/// The directions of ports and pins, and the component that most designs of the tests need.
#pragma once

#include "Orn_Hdl/Model/Component.h"
#include "Orn_Hdl/Model/Pins.h"

#include <memory>

namespace Support {

inline const Orn_Hdl::Polarity In("in");
inline const Orn_Hdl::Polarity Out("out");
inline const Orn_Hdl::Polarity Bi("bi");

/// A component with an input I, an output O, a bidirectional pin B and an input bus D(3:0).
inline std::unique_ptr<Orn_Hdl::Component> MakeBuffer(const char* name = "BUF") {
    auto component = std::make_unique<Orn_Hdl::Component>(name);
    component->AddPin("I", In, "");
    component->AddPin("O", Out, "");
    component->AddPin("B", Bi, "");
    component->AddPin("D(3:0)", In, "");
    return component;
}

} // namespace Support
