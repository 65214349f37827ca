// How pins and signals refer to each other. A pin points at one signal or, when it is open, at
// none; a signal lists pins. `Signal::Connect` links both ways, `Pin::Connect` points only, and a
// signal goes on listing a pin that was pointed elsewhere. So a pin and a signal are in one of four
// states:
//
//   state      the pin points   the signal   stored in the pin         stored in the signal
//              at the signal    lists it
//   Apart      no               no           -                         -
//   Unlisted   yes              no           signal_                   Links::unlistedPins
//   Listed     yes              yes          signal_ with ListedFlag   pins_
//   Former     no               yes          details: formerSignals    pins_
//
// An open pin is Apart from or a Former of every signal. In each state but Apart both sides know of
// the other, so either of them can be destroyed first. The operations move a pin and a signal from
// one state to another:
//
//   operation                           Apart      Unlisted   Listed   Former
//   Connect(signal, pin)                Listed     Listed     Listed   Listed
//   PointAt(pin, signal)                Unlisted   Unlisted   Listed   Listed
//   the pin is opened or led elsewhere  Apart      Apart      Former   Former
//   Disconnect(signal, pin)             Apart      Apart      Apart    Apart
//   DisconnectAll(signal)               Apart      Apart      Apart    Apart
//   Leave(pin)                          Apart      Apart      Apart    Apart
#pragma once

#include "Orn_Hdl/Model/Pins.h"
#include "Orn_Hdl/Model/Signals/Signal.h"

#include <vector>

namespace Orn_Hdl {

/// The operations on the links between pins and signals. If allocation fails, nothing changes.
class PinLinks {
public:
    /// Lists a pin in a signal and points it there.
    static void Connect(Signal& signal, Pin& pin);
    /// Points a pin at a signal, or opens it when that is null.
    static void PointAt(Pin& pin, Signal* signal);
    /// Unlinks a pin and a signal.
    static void Disconnect(Signal& signal, Pin& pin) noexcept;
    /// Unlinks a signal from all pins.
    static void DisconnectAll(Signal& signal) noexcept;
    /// Unlinks a pin from all signals, before it is destroyed.
    static void Leave(Pin& pin) noexcept;
    /// Points the pins that point at a signal without being listed at another one.
    static void MoveUnlisted(Signal& from, Signal& to);

    /// Whether a pin of that polarity, or a bidirectional one, points at a signal, listed or not.
    static bool HasPinOf(const Signal& signal, int polarity) noexcept;
    /// Whether the signal at which a pin points lists it; false for an open pin.
    static bool IsListed(const Pin& pin) noexcept;
    /// The pins that point at a signal without being listed.
    static const std::vector<Pin*>& GetUnlisted(const Signal& signal) noexcept;

private:
    enum class State { Apart, Unlisted, Listed, Former };

    static State GetState(const Pin& pin, const Signal& signal) noexcept;
    static bool IsFormer(const Pin& pin, const Signal& signal) noexcept;
    static void PrepareToOpen(Pin& pin);
    static void Open(Pin& pin) noexcept;
    static void Point(Pin& pin, Signal* signal, bool isListed) noexcept;
    static void DropFormer(Pin& pin, const Signal& signal) noexcept;
    static void DropListed(Signal& signal, const Pin& pin) noexcept;
    static void DropUnlisted(Signal& signal, const Pin& pin) noexcept;
};

} // namespace Orn_Hdl
