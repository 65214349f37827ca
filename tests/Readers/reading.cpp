// Reads netlists for tests that are written in Python.
//
// "reading back FILE...": replays each command file, whose lines may fail, and writes the design as
// Verilog; reads that into another model and writes it again. Both texts have to be the same but
// for blanks, braces within braces and the order of statements. Prints what differs.
//
// "reading rewrite LIBRARY INPUT OUTPUT": reads a Verilog netlist and writes it as Verilog.
#include "Orn_Hdl/Orn_Hdl.h"

#include <algorithm>
#include <fstream>
#include <iostream>
#include <sstream>
#include <string>
#include <vector>

namespace {

using namespace Orn_Hdl;

constexpr const char* First = "first.v";
constexpr const char* Second = "second.v";

std::string WholeFile(const char* name) {
    std::ifstream file(name, std::ios::binary);
    std::ostringstream text;
    text << file.rdbuf();
    return text.str();
}

/// The statements of a netlist without blanks and line ends, without the braces of concatenations
/// in concatenations, which say nothing, and in sorted order: concatenations with such braces have
/// another place among the assignments.
std::vector<std::string> StatementsOf(const char* fileName) {
    std::vector<std::string> statements(1);
    int depth = 0;
    for (const char c : WholeFile(fileName)) {
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
    VerilogNetlister(stream).WriteNetlist(model.GetNetlist(), *model.GetOptions());
}

/// \return an empty text, or why the netlist that was read is not the one that was written.
std::string ReadBack(const char* commands) {
    CommandFactory factory;
    Model model(&factory);
    Replay(model, commands);
    // Signals that a write makes are sorted by the next one.
    model.GetOptions()->writeHeader = false;
    Write(model, First);
    Write(model, First);
    Model read(&factory);
    *read.GetOptions() = *model.GetOptions();
    read.GetOptions()->verilog.includePaths.Empty();
    VerilogReader reader;
    reader.AddLibrary(*model.GetNetlist());
    reader.SetIncludes(VerilogReader::Includes::Keep);
    reader.KeepComments(true);
    reader.SetNames(VerilogReader::Names::Literal);
    try {
        reader.Read(First, read);
    } catch (const Exception& exception) {
        return exception.what();
    }
    Write(read, Second);
    return StatementsOf(First) == StatementsOf(Second) ? "" : "it is written in another way\n";
}

int ReadBackAll(const std::vector<std::string>& files) {
    int failures = 0;
    for (const std::string& file : files) {
        const std::string problem = ReadBack(file.c_str());
        if (!problem.empty()) {
            ++failures;
            std::cout << file << ": " << problem;
        }
    }
    return failures == 0 ? 0 : 1;
}

int Rewrite(const std::string& library, const std::string& input, const std::string& output) {
    CommandFactory factory;
    Model model(&factory);
    model.GetOptions()->writeHeader = false;
    VerilogReader reader;
    reader.AddLibrary(library.c_str());
    try {
        reader.Read(input.c_str(), model);
    } catch (const Exception& exception) {
        std::cout << exception.what();
        return 1;
    }
    Write(model, output.c_str());
    for (const VerilogReader::Renaming& renaming : reader.GetRenamings()) {
        std::cout << renaming.name << "\t" << renaming.newName << "\n";
    }
    return 0;
}

} // namespace

int main(int count, char** arguments) {
    const std::vector<std::string> words(arguments + 1, arguments + count);
    if (words.size() == 4 && words[0] == "rewrite") {
        return Rewrite(words[1], words[2], words[3]);
    }
    if (!words.empty() && words[0] == "back") {
        return ReadBackAll({words.begin() + 1, words.end()});
    }
    std::cout << "usage: reading back FILE... | reading rewrite LIBRARY INPUT OUTPUT\n";
    return 2;
}
