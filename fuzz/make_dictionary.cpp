// Prints the fuzzer's dictionary of the command language: its phrases, the words of its arguments,
// and pieces of names. With --check FILE it tells whether FILE is what it would print.

#include "Orn_Hdl/Commands.h"

#include <algorithm>
#include <cstdio>
#include <fstream>
#include <iterator>
#include <set>
#include <string>
#include <string_view>

namespace {

constexpr const char* Pieces[] = {"(7:0)", "[3:0]", "(2)",     ",",
                                  ".",     "\\x0a", "16:H:FF", "2147483647"};

/// The words of the argument descriptions that a user may type as they stand.
void AddLiterals(std::string_view arguments, std::set<std::string>& words) {
    constexpr std::string_view ends = " <>[]|";
    while (!arguments.empty()) {
        const std::size_t length = std::min(arguments.find_first_of(ends), arguments.size());
        if (length > 0) {
            words.emplace(arguments.substr(0, length));
        }
        arguments.remove_prefix(std::min(length + 1, arguments.size()));
    }
}

std::string MakeDictionary() {
    std::set<std::string> words(std::begin(Pieces), std::end(Pieces));
    for (const Orn_Hdl::CommandInfo& command : Orn_Hdl::CommandFactory::GetCatalogue()) {
        words.emplace(command.phrase);
        AddLiterals(command.arguments, words);
    }
    std::string text("# Made by fuzz_make_dictionary.\n");
    for (const std::string& word : words) {
        text.append("\"").append(word).append("\"\n");
    }
    return text;
}

} // namespace

int main(int argc, char** argv) {
    const std::string dictionary = MakeDictionary();
    if (argc != 3 || std::string_view(argv[1]) != "--check") {
        return std::fputs(dictionary.c_str(), stdout) < 0 ? 1 : 0;
    }
    std::ifstream file(argv[2], std::ios::binary);
    const std::string present((std::istreambuf_iterator<char>(file)),
                              std::istreambuf_iterator<char>());
    if (present == dictionary) {
        return 0;
    }
    std::fprintf(stderr, "%s is not what fuzz_make_dictionary prints\n", argv[2]);
    return 1;
}
