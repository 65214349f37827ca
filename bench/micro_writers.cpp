/// \file
/// How fast text is written: each writer alone, into a destination that only counts, and through
/// the stream that indents and wraps; and that stream alone.
#include "example.h"

#include <benchmark/benchmark.h>

#include <cstdint>
#include <filesystem>
#include <string>
#include <string_view>
#include <type_traits>
#include <unistd.h>

namespace {

using namespace Orn_Hdl;

constexpr int Gates = 20'000;

/// A netlist that has been written once in both languages: a writer sorts it and makes its dummy
/// signals the first time, and finds both done from then on.
class WrittenDesign {
public:
    WrittenDesign() : model_(nullptr) {
        model_.SetName("top");
        bench::AddGate(model_, "AND2", 2);
        bench::AddInstances(model_, "AND2", Gates);
        bench::ConnectGates(model_, Gates);
        OutStream nowhere(nullptr);
        Write<VerilogNetlister>(nowhere);
        Write<VhdlNetlister>(nowhere);
    }

    template <class Netlister> void Write(OutStream& out) {
        const HdlOptions& options = *model_.GetOptions();
        if constexpr (std::is_same_v<Netlister, VhdlNetlister>) {
            Netlister(out).WriteNetlist(model_.GetNetlist(), &options);
        } else {
            Netlister(out).WriteNetlist(model_.GetNetlist(), options);
        }
    }

private:
    Model model_;
};

/// Counts bytes and keeps none.
class CountingDst : public StreamDst {
public:
    explicit CountingDst(std::int64_t& bytes) : bytes_(bytes) {}
    void WriteNewLine() override { ++bytes_; }
    void Write(const char* text) override { WriteView(text == nullptr ? "" : text); }
    void Write(int number) override { WriteView(std::to_string(number)); }
    void WriteView(std::string_view text) override {
        bytes_ += static_cast<std::int64_t>(text.size());
    }

private:
    std::int64_t& bytes_;
};

template <class Netlister> void WriterAlone(benchmark::State& state) {
    WrittenDesign design;
    std::int64_t bytes = 0;
    for (auto _ : state) {
        OutStream out(new CountingDst(bytes));
        design.Write<Netlister>(out);
    }
    state.SetBytesProcessed(bytes);
}
BENCHMARK(WriterAlone<VerilogNetlister>)->Unit(benchmark::kMillisecond);
BENCHMARK(WriterAlone<VhdlNetlister>)->Unit(benchmark::kMillisecond);

/// The bytes that `write` leaves in a file.
template <class Write> std::int64_t BytesInAFile(Write write) {
    const std::filesystem::path file =
        std::filesystem::temp_directory_path() / ("orn_bench_micro." + std::to_string(getpid()));
    {
        TextFileOutStream out(file.c_str(), false);
        write(out);
    }
    const auto size = std::filesystem::file_size(file);
    std::filesystem::remove(file);
    return static_cast<std::int64_t>(size);
}

template <class Write> void WriteFiles(benchmark::State& state, Write write) {
    const std::int64_t bytes = BytesInAFile(write);
    for (auto _ : state) {
        TextFileOutStream out("/dev/null", false);
        write(out);
    }
    state.SetBytesProcessed(state.iterations() * bytes);
}

template <class Netlister> void WriterToAFile(benchmark::State& state) {
    WrittenDesign design;
    WriteFiles(state, [&design](OutStream& out) { design.Write<Netlister>(out); });
}
BENCHMARK(WriterToAFile<VerilogNetlister>)->Unit(benchmark::kMillisecond);
BENCHMARK(WriterToAFile<VhdlNetlister>)->Unit(benchmark::kMillisecond);

/// Lines that are broken twice and lines that are not broken, in the short pieces in which a writer
/// hands its text over.
void WrappingStream(benchmark::State& state) {
    WriteFiles(state, [](OutStream& out) {
        out.Indent();
        for (int i = 0; i < Gates; ++i) {
            out << "AND2"
                << " "
                << "U" << i << " ("
                << ".O"
                << "("
                << "n" << i << ")"
                << ");" << OutStream::NewLine << "wire [" << i << ":" << 0 << "] ";
            for (int name = 0; name < 25; ++name) {
                out << "signal" << i << ", ";
            }
            out << "last"
                << ";" << OutStream::NewLine;
        }
    });
}
BENCHMARK(WrappingStream)->Unit(benchmark::kMillisecond);

} // namespace
