#include "Writes.h"

#include "Check.h"
#include "Consistency.h"
#include "MemoryFiles.h"
#include "Orn_Hdl/Streams.h"
#include "Orn_Hdl/Writers.h"
#include "Port/Ascii.h"

#include <algorithm>
#include <cstddef>
#include <string_view>

namespace Fuzz {

namespace {

using namespace Orn_Hdl;

enum class Language { Verilog, Vhdl };
constexpr Language Languages[] = {Language::Verilog, Language::Vhdl};
constexpr int Times = 3;

/// The banner holds the file's name, which a memory stream does not have.
HdlOptions WithoutHeader(HdlOptions options) {
    options.writeHeader = false;
    return options;
}

void Write(Netlist& netlist, const HdlOptions& options, Language language, OutStream& out) {
    if (language == Language::Verilog) {
        VerilogNetlister(out).WriteNetlist(&netlist, options);
    } else {
        VhdlNetlister(out).WriteNetlist(&netlist, &options);
    }
}

std::string WriteIntoMemory(Netlist& netlist, const HdlOptions& options, Language language) {
    TextMemOutStream out;
    Write(netlist, options, language, out);
    return std::string(out.GetValue().GetView());
}

std::string WriteIntoFile(Netlist& netlist, const HdlOptions& options, Language language) {
    MemoryFiles files;
    TextFileOutStream out("netlist", TextFileOutStream::Replace);
    Write(netlist, options, language, out);
    out.Close();
    const std::string* const text = files.Find("netlist");
    Check(out.GetError() == 0 && !files.HasOpenFiles() && files.CountNames() == 1 &&
              text != nullptr,
          "a written file is closed, and no other file is left");
    return *text;
}

/// Whether an object has this name, or one that spans lines: declarations are then hard to count.
bool HasConfusingName(const Netlist& netlist, std::string_view keyword) {
    const auto isConfusing = [keyword](const Object* object) {
        const std::string_view name = object->GetNameView();
        return name.find('\n') != std::string_view::npos ||
               Port::EqualIgnoringCase(name.substr(0, name.find(' ')), keyword);
    };
    for (const Signal* signal : netlist.GetSignalIterator()) {
        if (isConfusing(signal)) {
            return true;
        }
    }
    for (const Instance* instance : netlist.GetInstanceIterator()) {
        if (isConfusing(instance)) {
            return true;
        }
    }
    for (const Component* component : netlist.GetComponentIterator()) {
        if (isConfusing(component)) {
            return true;
        }
        for (const Pin* pin : component->GetPinIterator()) {
            if (isConfusing(pin)) {
                return true;
            }
        }
    }
    return isConfusing(&netlist);
}

std::size_t CountLinesThatBegin(std::string_view text, std::string_view beginning) {
    std::size_t count = 0;
    while (!text.empty()) {
        count += text.substr(0, beginning.size()) == beginning ? 1 : 0;
        const std::size_t end = text.find('\n');
        text.remove_prefix(end == std::string_view::npos ? text.size() : end + 1);
    }
    return count;
}

void CheckDeclarations(const Netlist& netlist, Language language, const std::string& text) {
    const std::string keyword = language == Language::Verilog ? "wire" : "signal";
    if (HasConfusingName(netlist, keyword)) {
        return;
    }
    std::size_t expected = 0;
    for (const Signal* signal : netlist.GetSignalIterator()) {
        const std::string_view name = signal->GetNameView();
        const bool isWritable = !name.empty() && (language == Language::Verilog ||
                                                  !Port::EqualIgnoringCase(name, "open"));
        expected += isWritable && signal->IsNeededToDeclared() && !signal->IsPort() ? 1 : 0;
    }
    Check(CountLinesThatBegin(text, keyword + " ") == expected, "every signal is declared once");
}

/// Whether a port bears the name of a signal for an open pin. The first write wires it to the pin,
/// so that the second finds a port that is read inside and makes a dummy signal, which the third
/// sorts in.
bool HasOpenPort(const Netlist& netlist) {
    for (const Signal* signal : netlist.GetSignalIterator()) {
        std::string name(signal->GetNameView());
        std::transform(name.begin(), name.end(), name.begin(), Port::ToUpper);
        if (signal->IsPort() && name.find("_OPENSIGNAL") != std::string::npos) {
            return true;
        }
    }
    return false;
}

bool IsWhite(char c) {
    return c == ' ' || c == '\n';
}

/// The blanks and line ends that a text begins with.
std::string_view LeadingWhite(std::string_view text) {
    std::size_t length = 0;
    while (length < text.size() && IsWhite(text[length])) {
        ++length;
    }
    return text.substr(0, length);
}

/// How many characters, none of them white, two texts both begin with.
std::size_t CountSame(std::string_view a, std::string_view b) {
    const std::size_t most = std::min(a.size(), b.size());
    std::size_t count = 0;
    while (count < most && a[count] == b[count] && !IsWhite(a[count])) {
        ++count;
    }
    return count;
}

std::size_t Count(std::string_view text, char c) {
    return static_cast<std::size_t>(std::count(text.begin(), text.end(), c));
}

} // namespace

void CheckSameButForBreaks(std::string_view file, std::string_view memory) {
    bool atLineStart = true;
    while (!file.empty() || !memory.empty()) {
        const std::string_view whiteFile = LeadingWhite(file);
        const std::string_view whiteMemory = LeadingWhite(memory);
        if (whiteFile.empty() && whiteMemory.empty()) {
            const std::size_t same = CountSame(file, memory);
            Check(same > 0, "a file and memory get the same text");
            file.remove_prefix(same);
            memory.remove_prefix(same);
            atLineStart = false;
            continue;
        }
        // A break and indentation add to the blanks; nothing takes any away.
        const bool mayAdd = atLineStart || whiteFile.find('\n') != std::string_view::npos;
        Check(mayAdd || whiteFile == whiteMemory, "within a line no blanks are added");
        // Blanks at the very end of the text are not compared.
        const bool isLast = whiteMemory.size() == memory.size();
        Check(Count(whiteFile, ' ') >= Count(whiteMemory, ' ') || isLast, "no blank is lost");
        Check(Count(whiteFile, '\n') >= Count(whiteMemory, '\n'), "no line end is lost");
        file.remove_prefix(whiteFile.size());
        memory.remove_prefix(whiteMemory.size());
        atLineStart = false;
    }
}

std::string WriteThreeTimes(Netlist& netlist, const HdlOptions& options) {
    const HdlOptions bare = WithoutHeader(options);
    std::string all;
    for (int time = 0; time < Times; ++time) {
        for (const Language language : Languages) {
            all += WriteIntoMemory(netlist, bare, language);
        }
    }
    return all;
}

void WriteOnceWithChecks(Netlist& netlist, const HdlOptions& options,
                         const std::vector<Signal*>& loose) {
    const HdlOptions bare = WithoutHeader(options);
    for (const Language language : Languages) {
        const std::string text = WriteIntoMemory(netlist, bare, language);
        CheckNetlist(netlist, loose);
        CheckDeclarations(netlist, language, text);
    }
}

std::string WriteWithChecks(Netlist& netlist, const HdlOptions& options,
                            const std::vector<Signal*>& loose) {
    const HdlOptions bare = WithoutHeader(options);
    std::string all;
    std::string former;
    for (int time = 0; time < Times; ++time) {
        std::string both;
        for (const Language language : Languages) {
            const std::string text = WriteIntoMemory(netlist, bare, language);
            CheckNetlist(netlist, loose);
            CheckDeclarations(netlist, language, text);
            both += text;
            if (time == Times - 1) {
                CheckSameButForBreaks(WriteIntoFile(netlist, bare, language), text);
            }
        }
        Check(time < 2 || both == former || HasOpenPort(netlist),
              "the third write says what the second said");
        all += both;
        former = both;
    }
    return all;
}

} // namespace Fuzz
