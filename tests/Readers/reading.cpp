// Reads netlists for tests that are written in Python.
//
// "reading back FILE...": replays each command file, whose lines may fail, and writes the design in
// both languages; reads each text into another model and writes it again. Both texts have to be the
// same but for blanks, braces within braces, the base of binary literals and the order of
// statements. Prints what differs.
//
// "reading rewrite LIBRARY INPUT OUTPUT": reads a netlist and writes it, as VHDL when the file's
// name ends in ".vhd" and as Verilog otherwise.
#include "Orn_Hdl/Orn_Hdl.h"

#include <algorithm>
#include <fstream>
#include <iostream>
#include <sstream>
#include <string>
#include <string_view>
#include <type_traits>
#include <utility>
#include <vector>

namespace {

using namespace Orn_Hdl;

bool IsVhdl(const std::string& fileName) {
    return fileName.size() > 4 && fileName.substr(fileName.size() - 4) == ".vhd";
}

std::string WholeFile(const char* name) {
    std::ifstream file(name, std::ios::binary);
    std::ostringstream text;
    text << file.rdbuf();
    return text.str();
}

/// The statements of a netlist without blanks and line ends, without the braces of concatenations
/// in concatenations, the "b" of binary literals and the case of "open", which say nothing, and in
/// sorted order: concatenations with such braces have another place among the assignments.
std::vector<std::string> StatementsOf(const char* fileName) {
    std::vector<std::string> statements(1);
    int depth = 0;
    std::string text = WholeFile(fileName);
    for (const auto& [from, to] : {std::pair(" b\"", " \""), std::pair("=>OPEN", "=>open"),
                                   std::pair("\nbegin\n", "\nbegin;\n")}) {
        const std::string_view pattern = from;
        for (std::size_t at = text.find(pattern); at != std::string::npos;
             at = text.find(pattern, at + 1)) {
            text.replace(at, pattern.size(), to);
        }
    }
    for (const char c : text) {
        depth -= c == '}' ? 1 : 0;
        if (c == ';') {
            statements.emplace_back();
        } else if (c != ' ' && c != '\n' && ((c != '{' && c != '}') || depth == 0)) {
            statements.back() += c;
        }
        depth += c == '{' ? 1 : 0;
    }
    std::sort(statements.begin(), statements.end());
    return statements;
}

void Replay(Model& model, const char* commands) {
    std::ifstream file(commands, std::ios::binary);
    for (std::string line; std::getline(file, line);) {
        try {
            model.ExecuteLine(line);
        } catch (const Exception&) {
            // The design is what the other lines make.
        }
    }
}

void Write(Model& model, const char* fileName) {
    TextFileOutStream stream(fileName, TextFileOutStream::Overwrite);
    if (IsVhdl(fileName)) {
        VhdlNetlister(stream).WriteNetlist(model.GetNetlist(), model.GetOptions());
    } else {
        VerilogNetlister(stream).WriteNetlist(model.GetNetlist(), *model.GetOptions());
    }
}

template <class Reader> void Prepare(Reader& reader, const Netlist& netlist) {
    reader.AddLibrary(netlist);
    reader.KeepComments(true);
    reader.SetNames(ReaderNames::Literal);
}

/// Writes a design, reads it and writes that.
/// \return an empty text, or why the netlist that was read is not the one that was written.
template <class Reader>
std::string ReadBack(const char* commands, const char* first, const char* second) {
    CommandFactory factory;
    Model model(&factory);
    Replay(model, commands);
    // Signals that a write makes are sorted by the next one.
    model.GetOptions()->writeHeader = false;
    Write(model, first);
    Write(model, first);
    Model read(&factory);
    *read.GetOptions() = *model.GetOptions();
    read.GetOptions()->verilog.includePaths.Empty();
    Reader reader;
    Prepare(reader, *model.GetNetlist());
    if constexpr (std::is_same_v<Reader, VerilogReader>) {
        reader.SetIncludes(VerilogReader::Includes::Keep);
    }
    try {
        reader.Read(first, read);
    } catch (const Exception& exception) {
        return exception.what();
    }
    Write(read, second);
    return StatementsOf(first) == StatementsOf(second) ? "" : "it is written in another way\n";
}

int ReadBackAll(const std::vector<std::string>& files) {
    int failures = 0;
    for (const std::string& file : files) {
        for (const std::string& problem :
             {ReadBack<VerilogReader>(file.c_str(), "first.v", "second.v"),
              ReadBack<VhdlReader>(file.c_str(), "first.vhd", "second.vhd")}) {
            if (!problem.empty()) {
                ++failures;
                std::cout << file << ": " << problem;
            }
        }
    }
    return failures == 0 ? 0 : 1;
}

template <class Reader>
int Rewrite(const std::string& library, const std::string& input, const std::string& output) {
    CommandFactory factory;
    Model model(&factory);
    model.GetOptions()->writeHeader = false;
    Reader reader;
    reader.AddLibrary(library.c_str());
    try {
        reader.Read(input.c_str(), model);
    } catch (const Exception& exception) {
        std::cout << exception.what();
        return 1;
    }
    Write(model, output.c_str());
    for (const ReaderRenaming& renaming : reader.GetRenamings()) {
        std::cout << renaming.name << "\t" << renaming.newName << "\n";
    }
    return 0;
}

} // namespace

int main(int count, char** arguments) {
    const std::vector<std::string> words(arguments + 1, arguments + count);
    if (words.size() == 4 && words[0] == "rewrite") {
        return IsVhdl(words[2]) ? Rewrite<VhdlReader>(words[1], words[2], words[3])
                                : Rewrite<VerilogReader>(words[1], words[2], words[3]);
    }
    if (!words.empty() && words[0] == "back") {
        return ReadBackAll({words.begin() + 1, words.end()});
    }
    std::cout << "usage: reading back FILE... | reading rewrite LIBRARY INPUT OUTPUT\n";
    return 2;
}
