/// \file
/// Writes the benchmark design, or one of the shapes, in any size to a file.
#include "design.h"
#include "formats.h"
#include "shapes.h"

#include <algorithm>
#include <charconv>
#include <cstdint>
#include <exception>
#include <iostream>
#include <stdexcept>
#include <string>
#include <string_view>

namespace {

struct Options {
    std::string_view format = "commands";
    std::string_view shape;
    std::size_t size = 1'000'000;
    std::uint64_t seed = 1;
    std::string output;
};

void PrintUsage() {
    std::cerr << "usage: orn_bench_generate [--format F | --shape S] [--size N] [--seed S] OUTPUT\n"
                 "The flat benchmark design of N instances as:\n";
    for (const bench::Format& format : bench::GetFormats()) {
        std::cerr << "  --format " << format.name << ": " << format.description << '\n';
    }
    std::cerr << "A command file of:\n";
    for (const bench::Shape& shape : bench::GetShapes()) {
        std::cerr << "  --shape " << shape.name << ": " << shape.description << '\n';
    }
}

template <typename Number> Number ParseNumber(std::string_view text) {
    Number number = 0;
    const auto result = std::from_chars(text.data(), text.data() + text.size(), number);
    if (result.ec != std::errc() || result.ptr != text.data() + text.size()) {
        throw std::invalid_argument("not a number: " + std::string(text));
    }
    return number;
}

Options ParseOptions(int count, char** arguments) {
    Options options;
    for (int i = 1; i < count; ++i) {
        const std::string_view argument = arguments[i];
        if (!argument.starts_with("--")) {
            options.output = argument;
            continue;
        }
        if (++i == count) {
            throw std::invalid_argument("no value: " + std::string(argument));
        }
        const std::string_view value = arguments[i];
        if (argument == "--format") {
            options.format = value;
        } else if (argument == "--shape") {
            options.shape = value;
        } else if (argument == "--size") {
            options.size = ParseNumber<std::size_t>(value);
        } else if (argument == "--seed") {
            options.seed = ParseNumber<std::uint64_t>(value);
        } else {
            throw std::invalid_argument("unknown option: " + std::string(argument));
        }
    }
    if (options.output.empty()) {
        throw std::invalid_argument("no output file");
    }
    if (options.size < bench::Design::MinimumSize) {
        throw std::invalid_argument("the size must be at least " +
                                    std::to_string(bench::Design::MinimumSize));
    }
    return options;
}

/// The entry of that name in a list of formats or shapes.
const auto& Find(const auto& list, std::string_view name) {
    const auto found =
        std::ranges::find_if(list, [name](const auto& entry) { return entry.name == name; });
    if (found == list.end()) {
        throw std::invalid_argument("unknown: " + std::string(name));
    }
    return *found;
}

void Generate(const Options& options) {
    bench::Output out(options.output);
    if (options.shape.empty()) {
        const bench::Design design(options.size, options.seed);
        Find(bench::GetFormats(), options.format).write(out, design);
    } else {
        const bench::Shape& shape = Find(bench::GetShapes(), options.shape);
        if (shape.reader == bench::Reader::Run) {
            out << "SET NETLIST NAME shape\n";
        }
        shape.write(out, options.size);
    }
    out.Flush();
}

} // namespace

int main(int argc, char** argv) {
    try {
        Generate(ParseOptions(argc, argv));
    } catch (const std::invalid_argument& error) {
        std::cerr << "orn_bench_generate: " << error.what() << '\n';
        PrintUsage();
        return 2;
    } catch (const std::exception& error) {
        std::cerr << "orn_bench_generate: " << error.what() << '\n';
        return 1;
    }
    return 0;
}
