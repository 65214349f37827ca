/// \file
/// Small netlists for the micro-benchmarks, made through the library's interface.
#pragma once

#include <Orn_Hdl/Orn_Hdl.h>

#include <string>

namespace bench {

/// "U12" of ("U", 12).
inline std::string Numbered(const char* prefix, int number) {
    return prefix + std::to_string(number);
}

/// Declares a cell with `inputs` input pins, "I0" and so on, and the output pin "O".
inline void AddGate(Orn_Hdl::Model& model, const char* name, int inputs) {
    model.AddComponent(name);
    for (int i = 0; i < inputs; ++i) {
        model.AddPin(Numbered("I", i).c_str(), Orn_Hdl::Polarity(Orn_Hdl::Polarity::Input), name,
                     "");
    }
    model.AddPin("O", Orn_Hdl::Polarity(Orn_Hdl::Polarity::Output), name, "");
}

/// Places `count` instances of a cell, "U0" and so on.
inline void AddInstances(Orn_Hdl::Model& model, const char* component, int count) {
    for (int i = 0; i < count; ++i) {
        model.AddInstance(Numbered("U", i).c_str(), component);
    }
}

/// Wires the pins of `count` instances of a gate of two inputs: instance k drives net k and reads
/// nets k / 2 and k / 3.
inline void ConnectGates(Orn_Hdl::Model& model, int count) {
    for (int i = 0; i < count; ++i) {
        const std::string instance = Numbered("U", i);
        model.ConnectSignalToPin(Numbered("n", i).c_str(), instance.c_str(), "O");
        model.ConnectSignalToPin(Numbered("n", i / 2).c_str(), instance.c_str(), "I0");
        model.ConnectSignalToPin(Numbered("n", i / 3).c_str(), instance.c_str(), "I1");
    }
}

} // namespace bench
