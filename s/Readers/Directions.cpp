#include "Readers/Directions.h"

#include "Orn_Hdl/Model/Netlist.h"
#include "Readers/NetPieces.h"

#include <cstddef>
#include <cstdint>
#include <unordered_map>
#include <utility>

namespace Orn_Hdl::Readers {

namespace {

/// How many connections of pieces to pins are looked at: a short text can ask for any number.
constexpr std::size_t MostConnections = std::size_t(1) << 26;

constexpr std::uint32_t NoPin = UINT32_MAX;

/// The pins of components without directions, and the pieces of nets that they are connected to.
class Inference {
public:
    explicit Inference(Netlist& netlist) : netlist_(netlist), nets_(netlist) {}

    std::vector<UntoldDirections> Run();

private:
    /// A pin of a component; that of each instance has the same direction.
    struct UnknownPin {
        Pin* pin = nullptr;
        int direction = Polarity::Invalid;
        bool isContradictory = false;
    };
    struct Piece {
        /// How many connected pins have no direction yet.
        std::uint32_t open = 0;
        /// Whether something drives it, or reads it, whose direction was known from the beginning.
        bool isDriven = false;
        bool isRead = false;
        /// The same, pins with a new direction included.
        bool hasDriver = false;
        bool hasReader = false;
        /// Whether something bidirectional is connected.
        bool isUnclear = false;
    };
    struct Connection {
        std::uint32_t piece = 0;
        std::uint32_t pin = 0;
    };
    /// Numbers by another number, which stand behind each other.
    struct Lists {
        std::vector<std::size_t> begins;
        std::vector<std::uint32_t> numbers;
    };

    void NumberPins();
    void LookAtSignals();
    bool LookAtInstances();
    bool LookAtPins(const Instance& instance, std::uint32_t first);
    void MarkDriven(const Signal& signal);
    void MarkRead(const Signal& signal);
    void Mark(const Signal& signal, int pinDirection);
    void MakeLists();
    void Solve();
    void CarryOut(std::uint32_t pin);
    void LookAtPiece(std::uint32_t piece);
    void Set(std::uint32_t pin, int direction);
    void FindContradictions();
    void FindContradictionsAt(std::uint32_t piece);
    void SetDirections();
    std::vector<UntoldDirections> GetUntold(bool isGivenUp) const;

    template <class Key, class Number>
    static void Sort(const std::vector<Connection>& connections, std::size_t count, Lists& lists,
                     const Key& key, const Number& number);
    template <class Visit>
    static void ForEach(const Lists& lists, std::uint32_t of, const Visit& visit) {
        for (std::size_t i = lists.begins[of]; i < lists.begins[of + 1]; ++i) {
            visit(lists.numbers[i]);
        }
    }

    Netlist& netlist_;
    const NetPieces nets_;
    std::vector<UnknownPin> pins_;
    /// The number of a component's first pin.
    std::unordered_map<const Component*, std::uint32_t> firstPins_;
    std::vector<Piece> pieces_;
    std::vector<Connection> connections_;
    Lists pinsOfPieces_;
    Lists piecesOfPins_;
    /// Pins with a new direction whose pieces are to be looked at.
    std::vector<std::uint32_t> waiting_;
};

void Inference::NumberPins() {
    for (const Component* component : netlist_.GetComponentIterator()) {
        if (component == nullptr) {
            continue;
        }
        bool isKnown = true;
        for (const Pin* pin : component->GetPinIterator()) {
            isKnown = isKnown && pin->GetPolarity().IsValid();
        }
        if (isKnown) {
            continue;
        }
        firstPins_.emplace(component, static_cast<std::uint32_t>(pins_.size()));
        for (Pin* pin : component->GetPinIterator()) {
            pins_.push_back({pin, pin->GetPolarity().GetValue()});
        }
    }
}

void Inference::MarkDriven(const Signal& signal) {
    nets_.ForEach(signal, [this](std::uint32_t piece) { pieces_[piece].isDriven = true; });
}

void Inference::MarkRead(const Signal& signal) {
    nets_.ForEach(signal, [this](std::uint32_t piece) { pieces_[piece].isRead = true; });
}

void Inference::Mark(const Signal& signal, int pinDirection) {
    if (pinDirection == Polarity::Output) {
        MarkDriven(signal);
    } else if (pinDirection == Polarity::Input) {
        MarkRead(signal);
    } else {
        nets_.ForEach(signal, [this](std::uint32_t piece) { pieces_[piece].isUnclear = true; });
    }
}

void Inference::LookAtSignals() {
    for (const Signal* signal : netlist_.GetSignalIterator()) {
        if (signal == nullptr) {
            continue;
        }
        if (signal->IsPort() && signal->IsNeededToDeclared()) {
            // Inside of the module, an input port drives.
            const int direction = signal->GetPortPolarity().GetValue();
            Mark(*signal, direction == Polarity::Input    ? Polarity::Output
                          : direction == Polarity::Output ? Polarity::Input
                                                          : direction);
        }
        if (!std::string_view(signal->GetConstantValue().GetValue()).empty()) {
            MarkDriven(*signal);
        }
        for (const Signal* source : signal->GetSignalIterator()) {
            MarkDriven(*signal);
            MarkRead(*source);
        }
    }
}

/// \return false if there are too many connections.
bool Inference::LookAtInstances() {
    const Component* last = nullptr;
    std::uint32_t first = NoPin;
    for (const Instance* instance : netlist_.GetInstanceIterator()) {
        if (instance == nullptr) {
            continue;
        }
        if (last == nullptr || instance->GetComponent() != last) {
            last = instance->GetComponent();
            const auto found = firstPins_.find(last);
            first = found == firstPins_.end() ? NoPin : found->second;
        }
        if (!LookAtPins(*instance, first)) {
            return false;
        }
    }
    return true;
}

/// \param first the number of the instance's first pin, or `NoPin`.
bool Inference::LookAtPins(const Instance& instance, std::uint32_t first) {
    std::uint32_t number = first;
    for (const Pin* pin : instance.GetPinIterator()) {
        const Signal* const signal = pin->GetSignal();
        if (signal != nullptr && pin->GetPolarity().IsValid()) {
            Mark(*signal, pin->GetPolarity().GetValue());
        } else if (signal != nullptr) {
            nets_.ForEach(*signal, [this, number](std::uint32_t piece) {
                if (connections_.size() <= MostConnections) {
                    connections_.push_back({piece, number});
                }
            });
        }
        number += first == NoPin ? 0 : 1;
    }
    return connections_.size() <= MostConnections;
}

/// Sorts the connections by a number below `count`.
template <class Key, class Number>
void Inference::Sort(const std::vector<Connection>& connections, std::size_t count, Lists& lists,
                     const Key& key, const Number& number) {
    lists.begins.assign(count + 1, 0);
    lists.numbers.resize(connections.size());
    for (const Connection& connection : connections) {
        ++lists.begins[key(connection)];
    }
    std::size_t sum = 0;
    for (std::size_t& begin : lists.begins) {
        sum += begin;
        begin = sum;
    }
    for (std::size_t i = connections.size(); i-- > 0;) {
        lists.numbers[--lists.begins[key(connections[i])]] = number(connections[i]);
    }
}

void Inference::MakeLists() {
    const auto piece = [](const Connection& connection) { return connection.piece; };
    const auto pin = [](const Connection& connection) { return connection.pin; };
    Sort(connections_, pieces_.size(), pinsOfPieces_, piece, pin);
    Sort(connections_, pins_.size(), piecesOfPins_, pin, piece);
    for (const Connection& connection : connections_) {
        ++pieces_[connection.piece].open;
    }
    for (Piece& each : pieces_) {
        each.hasDriver = each.isDriven;
        each.hasReader = each.isRead;
    }
    connections_ = std::vector<Connection>();
}

void Inference::Set(std::uint32_t pin, int direction) {
    if (pins_[pin].direction == Polarity::Invalid) {
        pins_[pin].direction = direction;
        waiting_.push_back(pin);
    }
}

/// Looks at a piece whose state has changed.
void Inference::LookAtPiece(std::uint32_t number) {
    const Piece& piece = pieces_[number];
    const bool needsDriver = !piece.isUnclear && piece.hasReader && piece.open == 1;
    if (piece.open > 0 && (piece.hasDriver || needsDriver)) {
        const int direction = piece.hasDriver ? Polarity::Input : Polarity::Output;
        ForEach(pinsOfPieces_, number,
                [this, direction](std::uint32_t pin) { Set(pin, direction); });
    }
}

/// Tells the pieces that a pin is connected to its new direction.
void Inference::CarryOut(std::uint32_t pin) {
    ForEach(piecesOfPins_, pin, [this, pin](std::uint32_t number) {
        Piece& piece = pieces_[number];
        const bool hadDriver = piece.hasDriver;
        --piece.open;
        if (pins_[pin].direction == Polarity::Output) {
            piece.hasDriver = true;
        } else {
            piece.hasReader = true;
        }
        // A piece tells its pins once that it has a driver.
        if (!hadDriver) {
            LookAtPiece(number);
        }
    });
}

void Inference::Solve() {
    for (std::uint32_t number = 0; number < pieces_.size(); ++number) {
        LookAtPiece(number);
        while (!waiting_.empty()) {
            const std::uint32_t pin = waiting_.back();
            waiting_.pop_back();
            CarryOut(pin);
        }
    }
}

/// Looks for pins that have a direction for one reason, and another one in this piece.
void Inference::FindContradictionsAt(std::uint32_t number) {
    const Piece& piece = pieces_[number];
    std::size_t inputs = 0;
    std::size_t outputs = 0;
    ForEach(pinsOfPieces_, number, [this, &inputs, &outputs](std::uint32_t pin) {
        inputs += pins_[pin].direction == Polarity::Input ? 1 : 0;
        outputs += pins_[pin].direction == Polarity::Output ? 1 : 0;
    });
    const bool hasSeveral = outputs + (piece.isDriven ? 1 : 0) > 1;
    const bool needsDriver = !piece.isDriven && !piece.isUnclear && outputs == 0 &&
                             piece.open == 0 && inputs + (piece.isRead ? 1 : 0) > 1;
    if (!hasSeveral && !needsDriver) {
        return;
    }
    const int wrong = hasSeveral ? Polarity::Output : Polarity::Input;
    ForEach(pinsOfPieces_, number, [this, wrong](std::uint32_t pin) {
        pins_[pin].isContradictory = pins_[pin].isContradictory || pins_[pin].direction == wrong;
    });
}

void Inference::SetDirections() {
    for (const UnknownPin& unknown : pins_) {
        unknown.pin->SetPolarity(Polarity(unknown.direction));
    }
    for (const Instance* instance : netlist_.GetInstanceIterator()) {
        const auto found =
            instance == nullptr ? firstPins_.end() : firstPins_.find(instance->GetComponent());
        if (found == firstPins_.end()) {
            continue;
        }
        std::uint32_t number = found->second;
        for (Pin* pin : instance->GetPinIterator()) {
            pin->SetPolarity(Polarity(pins_[number++].direction));
        }
    }
}

/// \param isGivenUp whether nothing has been inferred.
std::vector<UntoldDirections> Inference::GetUntold(bool isGivenUp) const {
    std::vector<UntoldDirections> all;
    for (const Component* component : netlist_.GetComponentIterator()) {
        const auto found = firstPins_.find(component);
        if (found == firstPins_.end()) {
            continue;
        }
        UntoldDirections untold;
        untold.component = component;
        std::uint32_t number = found->second;
        for (const Pin* pin : component->GetPinIterator()) {
            const UnknownPin& unknown = pins_[number++];
            if (isGivenUp || unknown.direction == Polarity::Invalid) {
                untold.open.emplace_back(pin->GetNameView());
            } else if (unknown.isContradictory) {
                untold.contradictory.emplace_back(pin->GetNameView());
            }
        }
        if (!untold.open.empty() || !untold.contradictory.empty()) {
            all.push_back(std::move(untold));
        }
    }
    return all;
}

std::vector<UntoldDirections> Inference::Run() {
    NumberPins();
    if (pins_.empty()) {
        return {};
    }
    pieces_.resize(nets_.GetCount());
    LookAtSignals();
    if (!LookAtInstances()) {
        return GetUntold(true);
    }
    MakeLists();
    Solve();
    for (std::uint32_t number = 0; number < pieces_.size(); ++number) {
        FindContradictionsAt(number);
    }
    SetDirections();
    return GetUntold(false);
}

} // namespace

std::vector<UntoldDirections> InferDirections(Netlist& netlist) {
    return Inference(netlist).Run();
}

} // namespace Orn_Hdl::Readers
