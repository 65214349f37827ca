// Slips among the signals that a line has made.
#include "warnings/SlipFinder.h"

#include "Orn_Hdl/Model.h"
#include "Port/Ascii.h"
#include "diagnostics/Words.h"

#include <algorithm>
#include <utility>

namespace Tool {

namespace {

using Orn_Hdl::StringArray;
using std::string_view;

/// A name as the netlist keeps it.
std::string Normal(string_view name) {
    Port::String text(name);
    Orn_Hdl::Object::NormalizeName(text);
    return std::string(text.GetView());
}

string_view BeforeParenthesis(string_view name) {
    return name.substr(0, name.find('('));
}

std::string ToLower(string_view text) {
    std::string lower(text);
    std::transform(lower.begin(), lower.end(), lower.begin(), &Port::ToLower);
    return lower;
}

/// The word of a line that names a signal: the third, or the fourth of a connection.
int FindName(const StringArray& words, string_view name) {
    constexpr int First = 2;
    constexpr int Second = 3;
    const bool isSecond = Port::EqualIgnoringCase(words.GetView(0), "CONNECT") &&
                          !Port::EqualIgnoringCase(Normal(words.GetView(First)), name) &&
                          Port::EqualIgnoringCase(Normal(words.GetView(Second)), name);
    return isSecond ? Second : First;
}

/// What is meant by a name with other brackets than parentheses; empty if it has none.
std::string GetParenthesisForm(string_view word, string_view name) {
    if (word == name) {
        return "";
    }
    if (name.front() == '(' && name.back() == ')') {
        name = name.substr(1, name.size() - 2);
    }
    return std::string("write ").append(name);
}

Mark MarkName(const StringArray& words, string_view name) {
    return Mark::Word(FindName(words, name));
}

bool IsWrite(const StringArray& words) {
    return Port::EqualIgnoringCase(words.GetView(0), "WRITE");
}

} // namespace

bool SlipFinder::HasBracket(string_view name) noexcept {
    return name.find_first_of("(),") != string_view::npos;
}

void SlipFinder::TakeNew(const Orn_Hdl::Signal& signal, const StringArray* words) {
    if (words != nullptr && IsWrite(*words)) {
        // The signals that a write makes are the writer's affair.
        words = nullptr;
    }
    switch (signal.GetSignalType()) {
    case Orn_Hdl::SignalTypeScalar:
        if (words != nullptr) {
            LookAtScalar(signal, *words);
        }
        break;
    case Orn_Hdl::SignalTypeBus: {
        const auto& bus = static_cast<const Orn_Hdl::Bus&>(signal);
        if (words != nullptr) {
            LookAtBus(bus, *words);
        }
        NoteBus(bus);
        break;
    }
    case Orn_Hdl::SignalTypeBusSlice:
        LookAtSlice(static_cast<const Orn_Hdl::BusSlice&>(signal), words);
        break;
    default:
        break;
    }
}

void SlipFinder::NoteBus(const Orn_Hdl::Bus& bus) {
    const string_view base = BeforeParenthesis(bus.GetNameView());
    busNames_.set(GetPlace(base));
    if (bus.IsPort()) {
        // A bus that replaces another one comes before the slice that shows it.
        ports_.emplace(ToLower(base), &bus);
    }
}

void SlipFinder::LookAtScalar(const Orn_Hdl::Signal& signal, const StringArray& words) {
    const string_view name = signal.GetNameView();
    if (HasBracket(name)) {
        if (options_.Has(Slip::BracketNet) &&
            !Orn_Hdl::HdlUtilities::IsGeneratedName(std::string(name).c_str())) {
            const int word = FindName(words, name);
            report_({Slip::BracketNet,
                     Quoted(words.GetView(word)) + " becomes a net of the name " + Quoted(name),
                     GetParenthesisForm(words.GetView(word), name), Mark::Word(word)});
        }
        return;
    }
    if (!options_.Has(Slip::ScalarBesideBus)) {
        return;
    }
    if (const Orn_Hdl::Bus* const bus =
            model_.GetNetlist()->GetParentBus(std::string(name).c_str())) {
        report_({Slip::ScalarBesideBus,
                 Quoted(name) + " becomes a net of its own beside the bus " +
                     Quoted(bus->GetNameView()),
                 "the whole bus is " + std::string(bus->GetNameView()), MarkName(words, name)});
    }
}

void SlipFinder::LookAtBus(const Orn_Hdl::Bus& bus, const StringArray& words) {
    if (!options_.Has(Slip::ScalarBesideBus)) {
        return;
    }
    const string_view name = bus.GetNameView();
    const Orn_Hdl::Signal* const scalar =
        model_.GetNetlist()->GetSignal(string_view(BeforeParenthesis(name)));
    if (scalar != nullptr && scalar->GetSignalType() == Orn_Hdl::SignalTypeScalar) {
        report_({Slip::ScalarBesideBus,
                 Quoted(name) + " becomes a bus beside the scalar " + Quoted(scalar->GetNameView()),
                 "", MarkName(words, name)});
    }
}

void SlipFinder::LookAtSlice(const Orn_Hdl::BusSlice& slice, const StringArray* words) {
    const Orn_Hdl::Bus* const bus = slice.GetParentBus();
    if (bus == nullptr || !bus->IsPort()) {
        return;
    }
    const Orn_Hdl::Bus*& known = ports_[ToLower(BeforeParenthesis(bus->GetNameView()))];
    const bool isKnown = std::exchange(known, bus) == bus;
    if (isKnown || words == nullptr || !options_.Has(Slip::PortRange)) {
        return;
    }
    // The slice has the name that the port had.
    const bool isWider = bus->GetWidth() > slice.GetWidth();
    report_({Slip::PortRange,
             Quoted(bus->GetNameView()) + (isWider ? " widens" : " moves the range of") +
                 " the port " + Quoted(slice.GetNameView()),
             "", MarkName(*words, bus->GetNameView())});
}

} // namespace Tool
