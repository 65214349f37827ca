// The lines of a command file, split on another processor.
#pragma once

#include "Containers/PackedLists.h"
#include "HdlModel/Netlist/Foresight.h"
#include "Orn_Hdl/Containers/StringArray.h"
#include "Port/File.h"
#include "Port/LinesAtHand.h"
#include "Port/OrderedWork.h"
#include "Port/Pool.h"
#include "Port/Prefetch.h"

#include <cstddef>
#include <cstdint>
#include <exception>
#include <string_view>
#include <utility>
#include <vector>

namespace Orn_Hdl {

/// A line of a command file, split into words.
struct SplitLine {
    /// Takes the words of a file's next line, which may have to be read first.
    /// \return false at the end of the file or on a failure.
    bool Take(Port::File& file) {
        std::string_view text;
        return TakeUsual(file) || (file.NextLine(text) && Set(file, text));
    }
    /// Like `Take`, but only from the file's buffer.
    /// \return false if the buffer does not contain the whole line.
    bool TakeAtHand(Port::File& file) {
        std::string_view text;
        return TakeUsual(file) || (Port::LinesAtHand::Next(file, text) && Set(file, text));
    }
    /// Frees the memory of the words if the line was longer than `most` bytes; otherwise the next
    /// line uses it.
    void Release(std::uint64_t most) noexcept {
        if (bytes > most) {
            words = StringArray();
        }
    }

    StringArray words;
    /// How many bytes the line takes in the file.
    std::uint64_t bytes = 0;

private:
    /// Takes the next line if it is a usual one and in the file's buffer, as nearly all are.
    bool TakeUsual(Port::File& file) noexcept {
        bytes = PackedLists::SplitUsualLine(Port::LinesAtHand::GetUnread(file), words);
        Port::LinesAtHand::Skip(file, bytes);
        return bytes != 0;
    }
    /// Takes the words of a file's last line. \return true.
    bool Set(const Port::File& file, std::string_view text) {
        bytes = file.GetLineSize();
        words.Empty();
        words.ParseCommandLine(text.substr(0, text.find('\0')));
        return true;
    }
};

/// Reads a file and splits its lines in a thread of its own, some batches of lines ahead. Nothing
/// but the file is touched there.
class LineBatches {
public:
    struct Settings {
        /// How many threads there are besides the owner's; they take turns.
        unsigned workers = 1;
        /// How many batches there are.
        std::size_t batches = 8;
        /// The most lines of a batch.
        std::size_t lines = 256;
        /// A batch ends with the line that reaches this many bytes.
        std::uint64_t bytes = std::uint64_t(1) << 16;
    };
    /// Begins to read.
    /// \param file not owned. As long as there are batches of it, nobody else may use it.
    LineBatches(Port::File& file, const Settings& settings);

    /// Gives the next line.
    /// \param line receives it and the hashes of its names. Its former words are dropped.
    /// \return false at the end of the file or on a failure.
    /// \throws std::bad_alloc if splitting a line throws it; the next call gives the line behind.
    ///         If there is no memory for `line`, the next call gives this one.
    bool Next(SplitLine& line, Foresight::Hashes& names) {
        while (batch_ == nullptr || given_ == batch_->lines.size()) {
            if (!NextBatch()) {
                return false;
            }
        }
        const Line& next = batch_->lines[given_];
        batch_->words.Copy(given_, line.words);
        // The processor that split it has it in its cache.
        batch_->words.Prefetch(given_ + Lead);
        line.bytes = next.bytes;
        names = next.names;
        ++given_;
        return true;
    }

private:
    struct Line {
        std::uint64_t bytes;
        Foresight::Hashes names;
    };
    struct alignas(Port::CacheLine) Batch {
        std::vector<Line> lines;
        /// Those of all lines.
        PackedLists words;
        /// What reading the line behind the last one has thrown.
        std::exception_ptr failure;
    };

    /// How many lines ahead words are fetched.
    static constexpr std::size_t Lead = 4;

    bool Fill(Batch& batch) noexcept;
    void Read(Batch& batch);
    bool NextBatch();

    const Settings settings_;
    Port::File& file_;
    std::vector<Batch> batches_;
    /// The line that is being split.
    alignas(Port::CacheLine) SplitLine line_;
    /// The batch whose lines are being given; null before the first.
    alignas(Port::CacheLine) Batch* batch_ = nullptr;
    std::size_t given_ = 0;
    /// For the objects that the lines make.
    Port::Pool::Reserve memory_;
    /// Last, since its threads use the others.
    alignas(Port::CacheLine) Port::OrderedWork work_;
};

} // namespace Orn_Hdl
