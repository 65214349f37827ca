#include "Proof/Assignments.h"

#include "Port/Ascii.h"
#include "Proof/Meaning.h"

#include <algorithm>

namespace Orn_Hdl::Proving {

namespace {

void SetRuns(const Readers::Members& members, Runs& runs) {
    runs.clear();
    for (const Signal* member : members) {
        AppendRuns(*member, runs);
    }
}

} // namespace

Assignments::Assignments(const Netlist& design, Language language, bool dontCares,
                         Findings& findings)
    : design_(design), language_(language), dontCares_(dontCares), findings_(findings),
      signals_(design.GetSignalIterator()), aliases_(nullptr) {
    Advance();
}

bool Assignments::IsNothing(const Signal& signal) const noexcept {
    return Proving::IsNothing(signal.GetNameView(), language_);
}

/// A net of the name "open" is one bit of Verilog that nobody drives. A bus may be its alias.
bool Assignments::IsOpenInVerilog(const Signal& signal) const noexcept {
    return language_ == Language::Verilog && Port::EqualIgnoringCase(signal.GetNameView(), "open");
}

/// Passes over the bits that VHDL leaves out, because there is no signal on one side.
void Assignments::SkipNothing() noexcept {
    const auto isNothing = [this](const BitQueue& bits) {
        const Run& front = bits.GetFront();
        return front.isScalar && Proving::IsNothing(front.base, language_);
    };
    if (phase_ == Phase::Constants) {
        while (!targetBits_.IsEmpty() && isNothing(targetBits_)) {
            targetBits_.Drop(1);
            ++tied_;
        }
        return;
    }
    while (!targetBits_.IsEmpty() && !sourceBits_.IsEmpty() &&
           (isNothing(targetBits_) || isNothing(sourceBits_))) {
        targetBits_.Drop(1);
        sourceBits_.Drop(1);
    }
}

/// Goes to the next constant or alias.
void Assignments::Advance() {
    if (phase_ == Phase::Constants && !FindConstant()) {
        phase_ = Phase::Aliases;
        signals_ = design_.GetSignalIterator();
    }
    if (phase_ == Phase::Aliases && !FindAlias()) {
        phase_ = Phase::Done;
    }
}

bool Assignments::FindConstant() {
    for (; !signals_.IsAtEnd(); signals_.Next()) {
        const Signal& signal = *signals_.GetCurrent();
        if (!signal.GetConstantValue().GetValue().IsEmpty() && !IsNothing(signal)) {
            target_ = &signal;
            source_ = nullptr;
            targetBits_.Set(signal);
            constant_ = BitsOfConstant(signal, dontCares_, language_).value_or("");
            tied_ = 0;
            SkipNothing();
            if (targetBits_.IsEmpty()) {
                continue;
            }
            signals_.Next();
            return true;
        }
    }
    return false;
}

/// Takes the bits of an alias and of its signal. \return false when there are none to assign.
bool Assignments::SetAlias() {
    targetBits_.Set(*target_);
    sourceBits_.Set(*source_);
    if (!IsOpenInVerilog(*source_)) {
        const std::int64_t width =
            std::min(GetWidth(targetBits_.GetRuns()), GetWidth(sourceBits_.GetRuns()));
        targetBits_.Truncate(width);
        sourceBits_.Truncate(width);
        SkipNothing();
    }
    return !targetBits_.IsEmpty();
}

bool Assignments::FindAlias() {
    for (;;) {
        while (!aliases_.IsAtEnd()) {
            source_ = aliases_.GetCurrent();
            aliases_.Next();
            if (!IsNothing(*source_) && SetAlias()) {
                return true;
            }
        }
        for (;; signals_.Next()) {
            if (signals_.IsAtEnd()) {
                return false;
            }
            const Signal& signal = *signals_.GetCurrent();
            aliases_ = signal.GetSignalIterator();
            if (!aliases_.IsAtEnd() && !IsNothing(signal)) {
                target_ = &signal;
                signals_.Next();
                break;
            }
        }
    }
}

std::string Assignments::Describe() const {
    if (phase_ == Phase::Done) {
        return "no further assignment";
    }
    const std::string target(target_->GetNameView());
    return phase_ == Phase::Aliases
               ? target + " = " + std::string(source_->GetNameView())
               : target + " = " +
                     (constant_.empty() ? "a constant whose bits its digits do not tell"
                                        : constant_);
}

void Assignments::Report(const std::string& found, const Readers::Place& place) {
    isOff_ = true;
    Cause cause;
    if (phase_ == Phase::Constants) {
        cause = {Kind::Constant, std::string(target_->GetNameView()), ""};
    } else if (phase_ == Phase::Aliases) {
        cause = {Kind::Alias, std::string(target_->GetNameView()),
                 std::string(source_->GetNameView())};
    }
    findings_.Add("the netlist has " + found + ", the design " + Describe(), place,
                  std::move(cause));
}

void Assignments::Tie(const Readers::Members& target, const std::string& bits,
                      const Readers::Place& place) {
    if (isOff_) {
        return;
    }
    SetRuns(target, targetRuns_);
    const bool isConstant = phase_ == Phase::Constants;
    if (!isConstant || constant_.compare(tied_, bits.size(), bits) != 0 ||
        !targetBits_.Take(targetRuns_)) {
        Report(TextOf(targetRuns_) + " = " + bits, place);
        return;
    }
    tied_ += bits.size();
    SkipNothing();
    if (targetBits_.IsEmpty()) {
        Advance();
    }
}

void Assignments::Assign(const Readers::Members& target, const Readers::Members& source,
                         const Readers::Place& place) {
    if (isOff_) {
        return;
    }
    SetRuns(target, targetRuns_);
    SetRuns(source, sourceRuns_);
    const std::int64_t width = GetWidth(targetRuns_);
    const std::int64_t sourceWidth = GetWidth(sourceRuns_);
    if (width != sourceWidth && (source_ == nullptr || !IsOpenInVerilog(*source_))) {
        Report(std::to_string(sourceWidth) + " bits assigned to " + std::to_string(width), place);
        return;
    }
    if (phase_ != Phase::Aliases || !targetBits_.Take(targetRuns_) ||
        !sourceBits_.Take(sourceRuns_)) {
        Report(TextOf(targetRuns_) + " = " + TextOf(sourceRuns_), place);
        return;
    }
    SkipNothing();
    if (targetBits_.IsEmpty()) {
        Advance();
    }
}

void Assignments::End(const Readers::Place& place) {
    if (!isOff_ && phase_ != Phase::Done) {
        Report("no further assignment", place);
    }
}

} // namespace Orn_Hdl::Proving
