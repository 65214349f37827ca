#include "warnings/SlipFinder.h"

#include "warnings/ConstantSlips.h"
#include "warnings/Phrases.h"

#include "Orn_Hdl/Model.h"
#include "Port/Ascii.h"
#include "diagnostics/Words.h"

#include <cstdint>
#include <cstring>
#include <utility>

namespace Tool {

namespace {

using Orn_Hdl::StringArray;
using std::string_view;

/// Whether one of eight characters is a parenthesis or a comma.
bool HasBracketInEight(std::uint64_t characters) noexcept {
    // The codes of "(", ")", "," and "-" differ in two bits. A netlist's names have no "-".
    constexpr std::uint64_t CommonBits = 0xFAFAFAFAFAFAFAFA;
    constexpr std::uint64_t Ones = 0x0101010101010101;
    const std::uint64_t others = (characters & CommonBits) ^ ('(' * Ones);
    // Whether a byte of `others` is 0.
    return ((others - Ones) & ~others & (0x80 * Ones)) != 0;
}

/// The number whose bytes are the first characters of a text that is long enough.
template <class Number> Number Load(const char* text) noexcept {
    Number number = 0;
    std::memcpy(&number, text, sizeof number);
    return number;
}

} // namespace

SlipFinder::SlipFinder(Orn_Hdl::Model& model, const WarningOptions& options, Report report)
    : model_(model), options_(options), report_(std::move(report)),
      signals_(std::as_const(*model.GetNetlist()).GetSignalIterator()) {
    Skip();
}

void SlipFinder::GoToEnd() {
    signals_ = std::as_const(*model_.GetNetlist()).GetSignalIterator();
    while (!signals_.IsAtEnd()) {
        signals_.Next();
    }
}

void SlipFinder::Skip() {
    for (; !signals_.IsAtEnd(); signals_.Next()) {
        TakeNew(*signals_.GetCurrent(), nullptr);
    }
}

bool SlipFinder::IsSuspicious(string_view name) const noexcept {
    using Four = std::uint32_t;
    if (name.size() < sizeof(Four) || name.size() > 2 * sizeof(Four)) {
        return HasBracket(name) || busNames_[GetPlace(name)];
    }
    // Most names have about so many characters: they are looked at all at once.
    const char* const tail = name.data() + name.size() - sizeof(Four);
    const std::uint64_t both = std::uint64_t(Load<Four>(name.data())) << 32U | Load<Four>(tail);
    return HasBracketInEight(both) || busNames_[GetPlace(name)];
}

void SlipFinder::LookAtNewSignals(const StringArray& words) {
    while (const Orn_Hdl::Signal* const signal = signals_.GetCurrent()) {
        signals_.Next();
        if (signal->GetSignalType() != Orn_Hdl::SignalTypeScalar ||
            IsSuspicious(signal->GetNameView())) {
            TakeNew(*signal, &words);
        }
    }
}

bool SlipFinder::IsSingleBit(string_view target) const {
    const std::size_t dot = target.find('.');
    if (dot == string_view::npos) {
        const Orn_Hdl::Signal* const signal = model_.GetSignal(target);
        return signal != nullptr && (signal->GetSignalType() == Orn_Hdl::SignalTypeScalar ||
                                     signal->GetSignalType() == Orn_Hdl::SignalTypeBusIndex);
    }
    const Orn_Hdl::Pin* const pin =
        model_.GetPin(target.substr(dot + 1), model_.GetInstance(target.substr(0, dot)));
    return pin != nullptr && pin->GetPinType() != Orn_Hdl::PinTypeBus;
}

void SlipFinder::ReadConstant(const StringArray& words) {
    constexpr int Target = 2;
    constexpr int Value = 3;
    const string_view value = words.GetView(Value);
    if (value == "0" || value == "1") {
        return;
    }
    const bool dontCares = model_.GetOptions()->dontCares;
    if (const std::optional<WrongDigit> wrong = FindWrongDigit(value, dontCares)) {
        if (options_.Has(Slip::ConstantDigit)) {
            const bool isDash = value.substr(wrong->offset, wrong->length) == "-";
            report_({Slip::ConstantDigit, wrong->message,
                     isDash ? "what helps: --dont-cares, if a digit - is a don't care" : "",
                     Mark::Part(Value, wrong->offset, wrong->length)});
        }
        return;
    }
    const string_view target = words.GetView(Target);
    if (options_.Has(Slip::ScalarConstant) && NeedsSeveralBits(value) && IsSingleBit(target)) {
        report_({Slip::ScalarConstant,
                 Quoted(target) + " has one bit and is tied to " + Quoted(value), "",
                 Mark::Word(Value)});
    }
}

void SlipFinder::ReadFlag(const StringArray& words, int position) {
    const string_view word = words.GetView(position);
    if (options_.Has(Slip::FlagWord) && position > 0 && words.GetSize() > position &&
        !Port::EqualIgnoringCase(word, "true") && !Port::EqualIgnoringCase(word, "false")) {
        report_({Slip::FlagWord, Quoted(word) + " is read as true", "", Mark::Word(position)});
    }
}

void SlipFinder::ReadAttribute(const StringArray& words) {
    if (!options_.Has(Slip::AttributeOption)) {
        return;
    }
    const Phrases::AttributePlaces places = Phrases::FindAttribute(words);
    for (const int place : {places.name, places.value}) {
        if (place > 0 && Phrases::IsAttributeOption(words.GetView(place))) {
            report_({Slip::AttributeOption,
                     Quoted(words.GetView(place)) + " becomes the " +
                         (place == places.name ? "name" : "value") + " of the attribute",
                     "", Mark::Word(place)});
        }
    }
}

void SlipFinder::Read(const StringArray& words) {
    if (Port::EqualIgnoringCase(words.GetView(0), "WRITE")) {
        GoToEnd();
    } else if (Port::EqualIgnoringCase(words.GetView(0), "ASSIGN")) {
        ReadConstant(words);
    } else if (Phrases::IsForAttribute(words)) {
        ReadAttribute(words);
        ReadEffect(words, Phrases::IsIneffectiveForAttribute(words));
    } else {
        ReadFlag(words, Phrases::GetFlagPosition(words));
        ReadSynthesisTool(words);
        ReadEffect(words, Phrases::IsIneffective(words));
    }
}

void SlipFinder::ReadSynthesisTool(const StringArray& words) {
    const string_view word = words.GetView(2);
    if (options_.Has(Slip::SynthesisTool) && Phrases::Begins(words, "SET SYNTHESIS") &&
        !Phrases::IsSynthesisTool(word)) {
        report_({Slip::SynthesisTool, Quoted(word) + " is no synthesis tool and chooses QSN", "",
                 Mark::Word(2)});
    }
}

void SlipFinder::ReadEffect(const StringArray& words, bool isIneffective) {
    if (isIneffective && options_.Has(Slip::NoEffect)) {
        report_({Slip::NoEffect, "this command changes nothing in any output", "",
                 Mark::Words(0, Phrases::CountWords(words) - 1)});
    }
}

} // namespace Tool
