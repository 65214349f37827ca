// The bits that a signal stands for, as runs of neighbours.
#pragma once

#include "Orn_Hdl/Model/Signals.h"

#include <cstddef>
#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

namespace Orn_Hdl::Proving {

/// Neighbouring bits of a bus, leftmost first, or a scalar signal.
struct Run {
    std::string_view base;
    bool isScalar = true;
    std::int64_t left = 0;
    std::int64_t right = 0;

    std::int64_t GetWidth() const noexcept {
        return (left < right ? right - left : left - right) + 1;
    }
};

using Runs = std::vector<Run>;

/// Reads "D(7:0)" or "D(3)"; any other name is that of a scalar signal. The run refers to the name.
/// Indices of more than 60 bits are cut to 60.
Run ReadRun(std::string_view name) noexcept;
/// Appends the bits of a signal: of a compound, those of its members.
void AppendRuns(const Signal& signal, Runs& runs);
std::int64_t GetWidth(const Runs& runs) noexcept;
/// The runs as they are shown: "D[7:4], N".
std::string TextOf(const Runs& runs);

/// Bits that are taken from the left.
class BitQueue {
public:
    void Set(const Signal& signal);
    /// Keeps so many bits from the left.
    void Truncate(std::int64_t width);
    bool IsEmpty() const noexcept { return first_ == runs_.size(); }
    /// The first run that is left. There has to be one.
    const Run& GetFront() const noexcept { return runs_[first_]; }
    /// Takes so many bits off the first run, which has to be that wide.
    void Drop(std::int64_t count) noexcept;
    /// Takes bits off the front. \return false when the front is not these bits.
    bool Take(const Runs& runs) noexcept;
    const Runs& GetRuns() const noexcept { return runs_; }

private:
    bool TakeOne(Run run) noexcept;

    Runs runs_;
    std::size_t first_ = 0;
};

} // namespace Orn_Hdl::Proving
