// Long lists of a netlist, written by several threads.
#pragma once

#include "Orn_Hdl/Streams.h"

#include <cstddef>
#include <functional>
#include <memory>

namespace Orn_Hdl::Writers {

/// Writes the items of a list to one stream.
class ItemWriter {
public:
    ItemWriter() = default;
    ItemWriter(const ItemWriter&) = delete;
    ItemWriter& operator=(const ItemWriter&) = delete;
    virtual ~ItemWriter() = default;
    /// Goes to an item.
    virtual void GoTo(std::size_t item) = 0;
    /// Writes the present item and goes to the next one.
    virtual void WriteNext() = 0;
};

/// Makes a writer of the items to a stream. Writers of different streams are used at the same time.
using MakeItemWriter = std::function<std::unique_ptr<ItemWriter>(OutStream& out)>;

/// How lists are cut.
struct RangeSizes {
    /// The number of items in a range.
    std::size_t items = 2000;
    /// The number of ranges of the shortest list that is worth a thread.
    std::size_t leastRanges = 4;
    /// The most memory for texts that have not been written yet, in bytes.
    std::size_t memory = std::size_t(16) << 20;
};

/// The sizes that are used; tests make them small.
RangeSizes& GetRangeSizes() noexcept;

/// Writes the items of a list in their order. Of a long list, ranges are formatted by several
/// threads while others are written.
void WriteItems(OutStream& out, std::size_t count, unsigned threads, const MakeItemWriter& make);

} // namespace Orn_Hdl::Writers
