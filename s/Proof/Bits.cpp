#include "Proof/Bits.h"

#include <algorithm>
#include <charconv>

namespace Orn_Hdl::Proving {

namespace {

/// No index is greater, so that widths fit into 64 bits.
constexpr std::int64_t GreatestIndex = std::int64_t(1) << 60;

/// Reads an integer off the front of a text. \return false when there is none.
bool TakeIndex(std::string_view& text, std::int64_t& index) noexcept {
    if (!text.empty() && text.front() == '+') {
        text.remove_prefix(1);
    }
    const bool isNegative = !text.empty() && text.front() == '-';
    const auto result = std::from_chars(text.data(), text.data() + text.size(), index);
    text.remove_prefix(static_cast<std::size_t>(result.ptr - text.data()));
    if (result.ec == std::errc::result_out_of_range) {
        index = isNegative ? -GreatestIndex : GreatestIndex;
        return true;
    }
    index = std::clamp(index, -GreatestIndex, GreatestIndex);
    return result.ec == std::errc();
}

/// Takes so many bits off the left of a run of a bus.
void Advance(Run& run, std::int64_t count) noexcept {
    run.left += run.left < run.right ? count : -count;
}

} // namespace

Run ReadRun(std::string_view name) noexcept {
    Run whole;
    whole.base = name;
    const std::size_t parenthesis = name.find('(');
    if (parenthesis == std::string_view::npos || parenthesis == 0 || name.back() != ')') {
        return whole;
    }
    Run run;
    run.base = name.substr(0, parenthesis);
    run.isScalar = false;
    std::string_view rest = name.substr(parenthesis + 1);
    if (!TakeIndex(rest, run.left)) {
        return whole;
    }
    run.right = run.left;
    if (rest.front() == ':') {
        rest.remove_prefix(1);
        if (!TakeIndex(rest, run.right)) {
            return whole;
        }
    }
    return rest == ")" ? run : whole;
}

void AppendRuns(const Signal& signal, Runs& runs) {
    switch (signal.GetSignalType()) {
    case SignalTypeScalar:
        runs.emplace_back();
        runs.back().base = signal.GetNameView();
        break;
    case SignalTypeCompoundBus:
        for (const Signal* member :
             static_cast<const CompoundBus&>(signal).GetBusMemberIterator()) {
            AppendRuns(*member, runs);
        }
        break;
    default:
        runs.push_back(ReadRun(signal.GetNameView()));
    }
}

std::int64_t GetWidth(const Runs& runs) noexcept {
    std::int64_t width = 0;
    for (const Run& run : runs) {
        width += run.GetWidth();
    }
    return width;
}

std::string TextOf(const Runs& runs) {
    constexpr std::size_t Shown = 8;
    std::string text;
    for (std::size_t i = 0; i < runs.size() && i < Shown; ++i) {
        const Run& run = runs[i];
        text.append(text.empty() ? "" : ", ").append(run.base);
        if (!run.isScalar) {
            text.append("[").append(std::to_string(run.left));
            text.append(run.left == run.right ? "" : ":" + std::to_string(run.right)).append("]");
        }
    }
    return text.append(runs.size() > Shown ? ", ..." : "");
}

void BitQueue::Set(const Signal& signal) {
    runs_.clear();
    first_ = 0;
    AppendRuns(signal, runs_);
}

void BitQueue::Truncate(std::int64_t width) {
    std::size_t kept = 0;
    for (; kept < runs_.size() && width > 0; ++kept) {
        Run& run = runs_[kept];
        const std::int64_t own = run.GetWidth();
        if (own > width) {
            run.right = run.left + (run.left < run.right ? width - 1 : 1 - width);
        }
        width -= own;
    }
    runs_.resize(kept);
}

void BitQueue::Drop(std::int64_t count) noexcept {
    if (count == GetFront().GetWidth()) {
        ++first_;
    } else {
        Advance(runs_[first_], count);
    }
}

bool BitQueue::Take(const Runs& runs) noexcept {
    return std::all_of(runs.begin(), runs.end(), [this](const Run& run) { return TakeOne(run); });
}

bool BitQueue::TakeOne(Run run) noexcept {
    for (;;) {
        if (IsEmpty()) {
            return false;
        }
        const Run front = GetFront();
        const std::int64_t count = std::min(front.GetWidth(), run.GetWidth());
        const bool isSameWay = (front.left < front.right) == (run.left < run.right);
        if (front.base != run.base || front.isScalar != run.isScalar || front.left != run.left ||
            (count > 1 && !isSameWay)) {
            return false;
        }
        Drop(count);
        if (count == run.GetWidth()) {
            return true;
        }
        Advance(run, count);
    }
}

} // namespace Orn_Hdl::Proving
