#include "Scripts.h"

#include "Check.h"
#include "CommandScripts.h"
#include "Consistency.h"
#include "MemoryFiles.h"
#include "Orn_Hdl/Orn_Hdl.h"
#include "Port/Ascii.h"
#include "Writes.h"

#include <cstdlib>

namespace Fuzz {

namespace {

using namespace Orn_Hdl;

constexpr std::size_t MostLines = 400;
/// How many lines are run between two checks of the whole netlist.
constexpr std::size_t LinesPerCheck = 16;

constexpr const char* Components[] = {"AND2", "BUF", "and2", "REG", "Wide", "MISSING"};
constexpr const char* Instances[] = {"U1", "U2", "U10", "u1", "R_1", "MISSING"};
constexpr const char* Pins[] = {"I", "O", "IO", "D(3:0)", "D[3:0]", "Q(0:1)", "B(2)", "MISSING"};
constexpr const char* Signals[] = {"A",
                                   "B",
                                   "Y",
                                   "Z",
                                   "n1",
                                   "N1",
                                   "Y_DUMMY",
                                   "D(7:0)",
                                   "D[3:0]",
                                   "D(7:4)",
                                   "D(0:3)",
                                   "D(2)",
                                   "d(7)",
                                   "D(15:0)",
                                   "D(1:1)",
                                   "E(0:7)",
                                   "E(3:1)",
                                   "E(5)",
                                   "F(3:0)",
                                   "F(-1:2)",
                                   "F(+1)",
                                   "A,B",
                                   "A,D(3:0)",
                                   "D(1),D(0)\\E(7:0)",
                                   "D(7:0),D(15:8)",
                                   "n1,n1",
                                   "D_DUMMY(7:0)",
                                   "big(2147483647:0)",
                                   "big(99999999999:-1)",
                                   "open",
                                   "U1_I_CONST_SIGNAL",
                                   "D"};
constexpr const char* Directions[] = {"input", "output", "bidir", "I", "o", "B", "inout"};
constexpr const char* Types[] = {"String", "Integer",   "Float", "Boolean",
                                 "Bit",    "BitVector", "User",  "none"};
constexpr const char* Attributes[] = {"INIT", "Level", "LOC", "BOX_TYPE", "syn_keep", "init"};
constexpr const char* Values[] = {
    "1",    "0",     "8:H:FF",     "4:B:1010",    "16:O:777777", "HALVEX", "true",          "-7",
    "3.25", "1e400", "\"a text\"", "99999999999", "x\"y",        "8:H:",   "9999999999:B:1"};
constexpr const char* Options[] = {"-GENERIC=SYN",    "-GENERIC=NOSYN",       "-GENERIC=NONE",
                                   "-SYNATTR=ASSIGN", "-SYNATTR=ASSIGNNODEC", "-SYNATTR=NONE",
                                   "-GENERIC=x"};
constexpr const char* Tools[] = {"QSN",      "EXEMPLAR",    "SYNPLICITY",
                                 "SYNOPSYS", "VERILOG2001", "PRECISION"};
constexpr const char* Texts[] = {"word", "two words", "\"quoted text\"", "// */ --", "tab\there"};

constexpr const char* Prelude[] = {
    "ADD COMPONENT AND2",        "ADD PIN AND2 I input",   "ADD PIN AND2 O output",
    "ADD PIN AND2 IO bidir",     "ADD COMPONENT REG",      "ADD PIN REG D(3:0) input 4:H:A",
    "ADD PIN REG Q(0:1) output", "ADD PIN REG B(2) input", "ADD PORT A input",
    "ADD PORT D(7:0) output",    "ADD PORT Y output",      "ADD PORT E(0:7) input",
    "ADD INSTANCE AND2 U1",      "ADD INSTANCE AND2 U2",   "ADD INSTANCE REG R_1",
    "CONNECT SIGNAL Y U1.O",     "CONNECT SIGNAL Y U2.I"};

/// Fills in the arguments of a command from their description in the catalogue.
class Filler {
public:
    explicit Filler(Bytes& bytes) : bytes_(bytes) {}

    std::string MakeLine(const CommandInfo& command) {
        std::string line(command.phrase);
        std::string_view rest(command.arguments);
        while (!rest.empty()) {
            const bool isOptional = rest[0] == '[';
            const std::size_t length = LengthOfFirst(rest);
            if (!isOptional || bytes_.Choose(2) == 1) {
                line.append(" ").append(Fill(rest.substr(1, length - 2)));
            }
            rest.remove_prefix(length);
            rest.remove_prefix(rest.empty() ? 0 : 1);
        }
        return line;
    }

private:
    /// The length of the first argument, brackets included, of a description.
    static std::size_t LengthOfFirst(std::string_view arguments) {
        const char closing = arguments[0] == '[' ? ']' : '>';
        const std::size_t end = arguments.find(closing);
        Check(end != std::string_view::npos && (arguments[0] == '[' || arguments[0] == '<'),
              "arguments in the catalogue stand in brackets");
        return end + 1;
    }

    /// One of the alternatives, filled in.
    std::string Fill(std::string_view kinds) {
        constexpr int OneInSo = 16;
        if (bytes_.Choose(OneInSo) == OneInSo - 1) {
            return bytes_.Text(24);
        }
        while (kinds.find('|') != std::string_view::npos && bytes_.Choose(2) == 1) {
            kinds.remove_prefix(kinds.find('|') + 1);
        }
        return FillKind(kinds.substr(0, kinds.find('|')));
    }

    std::string FillKind(std::string_view kind) {
        if (kind == "component") {
            return bytes_.Pick(Components);
        }
        if (kind == "instance") {
            return bytes_.Pick(Instances);
        }
        if (kind == "pin") {
            return bytes_.Pick(Pins);
        }
        if (kind == "component.pin") {
            return FillKind("component").append(".").append(FillKind("pin"));
        }
        if (kind == "instance.pin") {
            return FillKind("instance").append(".").append(FillKind("pin"));
        }
        if (kind == "signal") {
            return bytes_.Pick(Signals);
        }
        if (kind == "direction") {
            return bytes_.Pick(Directions);
        }
        if (kind == "attribute") {
            return bytes_.Pick(Attributes);
        }
        if (kind == "value" || kind == "default") {
            return bytes_.Pick(Values);
        }
        if (kind == "-TYPE=<type>") {
            return std::string("-TYPE=") + bytes_.Pick(Types);
        }
        if (kind == "type") {
            return bytes_.Pick(Types);
        }
        if (kind == "option") {
            return bytes_.Pick(Options);
        }
        if (kind == "tool") {
            return bytes_.Pick(Tools);
        }
        if (kind == "text..." || kind == "text") {
            return bytes_.Pick(Texts);
        }
        // A word of the language itself, or a name that no other argument uses.
        return std::string(kind);
    }

    Bytes& bytes_;
};

/// A script with its first two WRITE commands only: many scripts spend most of their time in them.
Script WithTwoWrites(const Script& script) {
    constexpr std::string_view Verb = "WRITE";
    Script lines;
    int writes = 0;
    for (const std::string& line : script) {
        const bool isWrite =
            Port::EqualIgnoringCase(std::string_view(line).substr(0, Verb.size()), Verb);
        writes += isWrite ? 1 : 0;
        if (!isWrite || writes <= 2) {
            lines.push_back(line);
        }
    }
    return lines;
}

/// When a run checks its netlist.
enum class When { Never, AtTheEnd, EveryFewLines };

/// One engine with one model, and the messages and files that its lines have produced.
class Run {
public:
    explicit Run(When when) : when_(when) {
        engine_.CreateAndAddModel("top", "script");
        engine_.UseModel("top");
        // A command may rename the model.
        model_ = engine_.GetModel("top");
    }

    std::string Do(const Script& script) {
        MemoryFiles files;
        std::size_t lines = 0;
        for (const std::string& line : script) {
            Execute(line);
            if (++lines % LinesPerCheck == 0 && when_ == When::EveryFewLines) {
                CheckAll();
            }
        }
        Check(!files.HasOpenFiles(), "a write command closes its file");
        for (const MemoryFiles::File& file : files.GetFiles()) {
            if (file.isLinked) {
                result_.append(file.name).append("\n").append(file.text);
            }
        }
        if (when_ != When::Never) {
            CheckAll();
        }
        if (when_ == When::EveryFewLines) {
            CheckCommands(*model_);
        }
        return result_;
    }

    std::string Write() {
        Netlist& netlist = *model_->GetNetlist();
        return when_ == When::Never ? WriteThreeTimes(netlist, *model_->GetOptions())
                                    : WriteWithChecks(netlist, *model_->GetOptions());
    }

    void WriteOnce() { WriteOnceWithChecks(*model_->GetNetlist(), *model_->GetOptions()); }

private:
    void Execute(const std::string& line) {
        try {
            engine_.Execute(line.c_str());
        } catch (const Orn_Hdl::Exception& exception) {
            const std::string_view text = exception.getLocalized().GetView();
            Check(!text.empty() && text.back() == '\n', "a message ends in a line end");
            result_ += text;
        }
    }

    void CheckAll() const {
        CheckNetlist(*model_->GetNetlist());
        CheckNames(*model_->GetNetlist());
    }

    When when_;
    Engine engine_;
    Model* model_;
    std::string result_;
};

/// Fixes the time that banners contain.
const int timeIsFixed = setenv("SOURCE_DATE_EPOCH", "1000000000", 1);

} // namespace

Script SplitScript(std::string_view text) {
    Script script;
    while (!text.empty() && script.size() < MostLines) {
        const std::size_t end = text.find('\n');
        script.emplace_back(text.substr(0, end));
        text.remove_prefix(end == std::string_view::npos ? text.size() : end + 1);
    }
    return script;
}

Script MakeScript(Bytes& bytes) {
    Script script;
    if (bytes.Choose(2) == 0) {
        script.assign(std::begin(Prelude), std::end(Prelude));
    }
    const std::vector<CommandInfo>& catalogue = CommandFactory::GetCatalogue();
    Filler filler(bytes);
    while (!bytes.IsAtEnd() && script.size() < MostLines) {
        const int which = bytes.Choose(static_cast<int>(catalogue.size()));
        script.push_back(filler.MakeLine(catalogue[static_cast<std::size_t>(which)]));
    }
    return script;
}

void CheckScript(const Script& script, Checks checks) {
    Check(timeIsFixed == 0, "the time is fixed");
    if (checks == Checks::Few) {
        Run run(When::AtTheEnd);
        run.Do(WithTwoWrites(script));
        run.WriteOnce();
        return;
    }
    // The second engine checks nothing, so a difference also shows that checking changes something.
    Run first(When::EveryFewLines);
    Run second(When::Never);
    Check(first.Do(script) == second.Do(script), "the same script does the same");
    Check(first.Write() == second.Write(), "the same script writes the same");
    // A written model takes further commands and is written again.
    Check(first.Do(script) == second.Do(script), "a written model does the same");
    Check(first.Write() == second.Write(), "a written model writes the same");
}

} // namespace Fuzz
