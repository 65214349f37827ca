#include "Writers/ItemWriter.h"

#include "Port/OrderedWork.h"
#include "Port/Prefetch.h"
#include "Streams/StreamBranch.h"

#include <algorithm>
#include <vector>

namespace Orn_Hdl::Writers {

namespace {

/// A range of items, numbered from 0.
struct Range {
    Range(std::size_t number, std::size_t count)
        : begin(number * GetRangeSizes().items),
          end(std::min(count, begin + GetRangeSizes().items)) {}

    std::size_t begin;
    std::size_t end;
};

void Write(ItemWriter& writer, std::size_t begin, std::size_t end) {
    if (begin < end) {
        writer.GoTo(begin);
    }
    for (; begin < end; ++begin) {
        writer.WriteNext();
    }
}

/// Formats one range at a time.
class alignas(Port::CacheLine) RangeFormatter {
public:
    RangeFormatter(std::unique_ptr<StreamBranch> branch, const MakeItemWriter& make)
        : branch_(std::move(branch)), writer_(make(branch_->GetStream())) {}

    /// Formats the items of a range, up to the first one that goes beyond the limit.
    void Format(const Range& range, std::size_t limit) {
        branch_->Begin(limit);
        end_ = range.begin;
        writer_->GoTo(range.begin);
        while (end_ < range.end) {
            writer_->WriteNext();
            if (!branch_->EndItem()) {
                return;
            }
            ++end_;
        }
    }
    /// Writes what was formatted. \return the first item of the range that was not.
    std::size_t Join(OutStream& out, const Range& range) const {
        return branch_->Join(out) ? end_ : range.begin;
    }

private:
    std::unique_ptr<StreamBranch> branch_;
    std::unique_ptr<ItemWriter> writer_;
    std::size_t end_ = 0;
};

/// \return none if the stream has no branches.
std::vector<RangeFormatter> MakeFormatters(const OutStream& out, std::size_t count,
                                           const MakeItemWriter& make) {
    std::vector<RangeFormatter> formatters;
    while (formatters.size() < count) {
        std::unique_ptr<StreamBranch> branch = StreamBranch::Make(out);
        if (branch == nullptr) {
            break;
        }
        formatters.emplace_back(std::move(branch), make);
    }
    return formatters;
}

} // namespace

RangeSizes& GetRangeSizes() noexcept {
    static RangeSizes sizes;
    return sizes;
}

void WriteItems(OutStream& out, std::size_t count, unsigned threads, const MakeItemWriter& make) {
    const std::unique_ptr<ItemWriter> direct = make(out);
    const RangeSizes& sizes = GetRangeSizes();
    const unsigned workers = threads == 1 || count / sizes.items < sizes.leastRanges
                                 ? 0
                                 : Port::OrderedWork::GetWorkersFor(threads);
    std::vector<RangeFormatter> formatters =
        MakeFormatters(out, workers == 0 ? 0 : 2 * (std::size_t(workers) + 1), make);
    if (formatters.empty()) {
        Write(*direct, 0, count);
        return;
    }
    const std::size_t limit = sizes.memory / formatters.size();
    Port::OrderedWork work({workers, formatters.size()}, [&](std::size_t number) {
        const Range range(number, count);
        if (range.begin >= count) {
            return false;
        }
        formatters[number % formatters.size()].Format(range, limit);
        return true;
    });
    for (std::size_t number = 0; StreamBranch::IsWriting(out) && work.Next(); ++number) {
        const Range range(number, count);
        Write(*direct, formatters[work.GetPlace()].Join(out, range), range.end);
    }
}

} // namespace Orn_Hdl::Writers
