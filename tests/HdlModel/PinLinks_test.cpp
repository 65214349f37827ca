// The states of a pin and a signal, and what each operation makes of each of them.
#include "Orn_Hdl/Model/Pins.h"
#include "Orn_Hdl/Model/Signals.h"

#include <gtest/gtest.h>

#include <iterator>
#include <memory>
#include <vector>

namespace {

using namespace Orn_Hdl;

enum State { Apart, Unlisted, Listed, Former };
constexpr State States[] = {Apart, Unlisted, Listed, Former};

/// A signal, a pin in some state with it, and another signal at which pins may point meanwhile.
struct Pair {
    std::unique_ptr<ScalarSignal> signal = std::make_unique<ScalarSignal>("N");
    std::unique_ptr<ScalarSignal> other = std::make_unique<ScalarSignal>("M");
    std::unique_ptr<ScalarPin> pin = std::make_unique<ScalarPin>("P", Polarity("in"));

    /// \param isWired whether an Apart or Former pin points at the other signal, listed there.
    Pair(State state, bool isWired) {
        if (state == Listed || state == Former) {
            signal->Connect(pin.get());
        } else if (state == Unlisted) {
            pin->Connect(signal.get());
        }
        if (state == Former) {
            pin->Disconnect();
        }
        if (isWired && (state == Apart || state == Former)) {
            other->Connect(pin.get());
        }
    }

    State Get() const {
        int listed = 0;
        for (const Pin* each : signal->GetPinIterator()) {
            listed += each == pin.get() ? 1 : 0;
        }
        EXPECT_LE(listed, 1);
        const bool points = pin->GetSignal() == signal.get();
        return points ? (listed > 0 ? Listed : Unlisted) : (listed > 0 ? Former : Apart);
    }
};

/// Checks what an operation makes of each state; then either side is destroyed first.
template <class Operate>
void Check(const Operate& operate, const State (&expected)[std::size(States)]) {
    for (const State state : States) {
        for (const bool isWired : {false, true}) {
            for (const bool pinFirst : {false, true}) {
                SCOPED_TRACE(testing::Message() << "state " << state << ", wired " << isWired
                                                << ", pin first " << pinFirst);
                Pair pair(state, isWired);
                ASSERT_EQ(pair.Get(), state);
                operate(pair);
                EXPECT_EQ(pair.Get(), expected[state]);
                if (pinFirst) {
                    pair.pin.reset();
                    EXPECT_TRUE(pair.signal->GetPinIterator().IsAtEnd());
                    EXPECT_TRUE(pair.other->GetPinIterator().IsAtEnd());
                } else {
                    const bool pointsHere = pair.pin->GetSignal() == pair.signal.get();
                    Signal* const before = pair.pin->GetSignal();
                    pair.signal.reset();
                    EXPECT_EQ(pair.pin->GetSignal(), pointsHere ? nullptr : before);
                    pair.other.reset();
                    EXPECT_EQ(pair.pin->GetSignal(), nullptr);
                }
            }
        }
    }
}

TEST(PinLinks, NothingIsNothing) {
    Check([](Pair&) {}, {Apart, Unlisted, Listed, Former});
}

TEST(PinLinks, SignalConnect) {
    Check([](Pair& pair) { pair.signal->Connect(pair.pin.get()); },
          {Listed, Listed, Listed, Listed});
}

TEST(PinLinks, PinConnect) {
    Check([](Pair& pair) { pair.pin->Connect(pair.signal.get()); },
          {Unlisted, Unlisted, Listed, Listed});
}

TEST(PinLinks, ThePinIsOpened) {
    Check([](Pair& pair) { pair.pin->Disconnect(); }, {Apart, Apart, Former, Former});
}

TEST(PinLinks, ThePinIsPointedElsewhere) {
    Check([](Pair& pair) { pair.pin->Connect(pair.other.get()); }, {Apart, Apart, Former, Former});
}

TEST(PinLinks, AnotherSignalConnectsThePin) {
    Check([](Pair& pair) { pair.other->Connect(pair.pin.get()); }, {Apart, Apart, Former, Former});
}

TEST(PinLinks, AnotherSignalIsDestroyed) {
    Check([](Pair& pair) { pair.other = std::make_unique<ScalarSignal>("M"); },
          {Apart, Unlisted, Listed, Former});
}

TEST(PinLinks, SignalDisconnect) {
    Check([](Pair& pair) { pair.signal->Disconnect(pair.pin.get()); },
          {Apart, Apart, Apart, Apart});
}

TEST(PinLinks, SignalDisconnectAll) {
    Check([](Pair& pair) { pair.signal->DisconnectAll(); }, {Apart, Apart, Apart, Apart});
}

TEST(PinLinks, DisconnectLeavesAPinThatPointsElsewhereThere) {
    for (const State state : {Apart, Former}) {
        Pair pair(state, true);
        pair.signal->Disconnect(pair.pin.get());
        EXPECT_EQ(pair.pin->GetSignal(), pair.other.get());
        pair.signal->DisconnectAll();
        EXPECT_EQ(pair.pin->GetSignal(), pair.other.get());
        EXPECT_FALSE(pair.other->GetPinIterator().IsAtEnd());
    }
}

TEST(PinLinks, APinMayBeAFormerOneOfManySignals) {
    std::vector<std::unique_ptr<ScalarSignal>> signals;
    auto pin = std::make_unique<ScalarPin>("P", Polarity("in"));
    for (int i = 0; i < 20; ++i) {
        signals.push_back(std::make_unique<ScalarSignal>("N"));
        signals.back()->Connect(pin.get());
    }
    for (std::size_t i = 0; i < signals.size(); i += 2) {
        signals[i].reset();
    }
    EXPECT_EQ(pin->GetSignal(), signals.back().get());
    signals[3]->Connect(pin.get());
    EXPECT_EQ(pin->GetSignal(), signals[3].get());
    pin.reset();
    for (const std::unique_ptr<ScalarSignal>& signal : signals) {
        EXPECT_TRUE(signal == nullptr || signal->GetPinIterator().IsAtEnd());
    }
}

} // namespace
