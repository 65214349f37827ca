/// \file
/// The lower of the two floors: what reading a command file costs when each line is only split
/// into words, and a netlist of a given size when its bytes are only copied. Keeps nothing.
#include "text_io.h"

#include <cstdlib>
#include <exception>
#include <iostream>
#include <stdexcept>
#include <string_view>

namespace {

/// Splits every line and writes its words until `bytes` are written.
/// \return how many words there are, so that no splitting can be left out.
std::size_t SplitAndCopy(const bench::FileText& commands, bench::Output& out, std::size_t bytes) {
    std::size_t wordCount = 0;
    bench::Words words;
    for (const char* at = commands.begin(); at != commands.end();) {
        at = words.Split(at, commands.end());
        for (std::size_t i = 0; i < words.size(); ++i) {
            const std::string_view piece = words[i].substr(0, bytes);
            out << piece;
            bytes -= piece.size();
        }
        wordCount += words.size();
    }
    if (bytes > 0) {
        throw std::runtime_error("the words of the command file have too few bytes");
    }
    return wordCount;
}

} // namespace

int main(int argc, char** argv) {
    if (argc != 4) {
        std::cerr << "usage: orn_bench_floor_split COMMANDS OUTPUT BYTES\n";
        return 2;
    }
    try {
        const bench::FileText commands(argv[1]);
        bench::Output out(argv[2]);
        std::cout << SplitAndCopy(commands, out, std::strtoull(argv[3], nullptr, 10)) << " words\n";
        out.Flush();
    } catch (const std::exception& error) {
        std::cerr << "orn_bench_floor_split: " << error.what() << '\n';
        return 1;
    }
    return 0;
}
