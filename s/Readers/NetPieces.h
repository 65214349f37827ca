// The pieces of which all nets of a netlist consist.
#pragma once

#include "Orn_Hdl/Model/Signals.h"

#include <cstdint>
#include <unordered_map>
#include <vector>

namespace Orn_Hdl {

class Netlist;

namespace Readers {

/// Numbers the pieces of nets. A net of one bit is a piece. A bus is cut wherever one of its slices
/// or bits begins or ends, so that every signal of the netlist consists of whole pieces.
class NetPieces {
public:
    explicit NetPieces(const Netlist& netlist);

    /// How many pieces there are; their numbers are less.
    std::uint32_t GetCount() const noexcept { return count_; }

    /// Calls `visit` with the number of each piece of a signal.
    template <class Visit> void ForEach(const Signal& signal, const Visit& visit) const {
        if (signal.GetSignalType() == SignalTypeCompoundBus) {
            for (const Signal* member :
                 static_cast<const CompoundBus&>(signal).GetBusMemberIterator()) {
                ForEach(*member, visit);
            }
            return;
        }
        const auto found = pieces_.find(&signal);
        if (found != pieces_.end()) {
            for (std::uint32_t i = 0; i < found->second.count; ++i) {
                visit(found->second.first + i);
            }
        }
    }

private:
    struct Pieces {
        std::uint32_t first = 0;
        std::uint32_t count = 0;
    };

    void Cut(const Bus& bus);

    std::unordered_map<const Signal*, Pieces> pieces_;
    std::uint32_t count_ = 0;
    /// Where a bus is cut: how many of its bits stand to the left.
    std::vector<std::int64_t> cuts_;
};

} // namespace Readers
} // namespace Orn_Hdl
