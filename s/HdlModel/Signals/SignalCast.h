// Signals as objects of their classes.
#pragma once

#include "Orn_Hdl/Model/Signals.h"

namespace Orn_Hdl {

/// Whether `T` is the class that a `SignalType` tells, or a base of it.
template <class T> constexpr bool IsClassOf(int signalType) noexcept;

template <> constexpr bool IsClassOf<ScalarSignal>(int signalType) noexcept {
    return signalType == SignalTypeScalar;
}
template <> constexpr bool IsClassOf<Bus>(int signalType) noexcept {
    return signalType == SignalTypeBus;
}
template <> constexpr bool IsClassOf<BusSlice>(int signalType) noexcept {
    return signalType == SignalTypeBusSlice;
}
template <> constexpr bool IsClassOf<BusIndex>(int signalType) noexcept {
    return signalType == SignalTypeBusIndex;
}
template <> constexpr bool IsClassOf<BusPart>(int signalType) noexcept {
    return IsClassOf<BusSlice>(signalType) || IsClassOf<BusIndex>(signalType);
}
template <> constexpr bool IsClassOf<CompoundBus>(int signalType) noexcept {
    return signalType == SignalTypeCompoundBus;
}

/// The signal as a `T`; null when it is null or of another class.
template <class T> T* As(Signal* signal) noexcept {
    return signal != nullptr && IsClassOf<T>(signal->GetSignalType()) ? static_cast<T*>(signal)
                                                                      : nullptr;
}

/// The constant signal as a `T`; null when it is null or of another class.
template <class T> const T* As(const Signal* signal) noexcept {
    return As<T>(const_cast<Signal*>(signal));
}

} // namespace Orn_Hdl
