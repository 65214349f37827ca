// The orn-hdl tool: reads the command line and runs the command that it names.

#include "CommandsPage.h"
#include "Draw.h"
#include "Gzip.h"
#include "Import.h"
#include "Run.h"
#include "Tool.h"
#include "check/Check.h"
#include "diagnostics/Nearest.h"
#include "diff/Diff.h"
#include "explain/Syntax.h"
#include "proof/Verify.h"
#include "stats/Stats.h"
#include "warnings/WarningsPage.h"

#include "Orn_Hdl/Language.h"
#include "Port/String.h"
#include "Port/Version.h"

#include <CLI/CLI.hpp>

#include <algorithm>
#include <exception>
#include <functional>
#include <new>
#include <optional>
#include <sstream>
#include <string>
#include <utility>
#include <vector>

namespace {

using Tool::Status;

/// Rejects the empty text, which is not a file name.
std::string CheckFileName(const std::string& name) {
    return name.empty() ? "a file name is needed" : "";
}

std::string CheckDigit(const std::string& text) {
    return text == "0" || text == "1" || text == "-" ? "" : "0, 1 or - is needed";
}

const std::map<std::string, Tool::Import::NameLanguages>& GetNameLanguages() {
    using Tool::Import::NameLanguages;
    static const std::map<std::string, NameLanguages> words = {{"verilog", NameLanguages::Verilog},
                                                               {"vhdl", NameLanguages::Vhdl},
                                                               {"both", NameLanguages::Both}};
    return words;
}

std::string CheckNameLanguages(const std::string& text) {
    return GetNameLanguages().count(text) != 0 ? "" : "verilog, vhdl or both is needed";
}

CLI::Option* AddFile(CLI::App& command, const std::string& option, std::string& name,
                     const std::string& help) {
    return command.add_option(option, name, help)
        ->type_name(option == "FILE" ? "" : "FILE")
        ->check(CheckFileName);
}

void AddOutputs(CLI::App& command, Tool::Outputs& outputs) {
    for (const Orn_Hdl::Language language : Orn_Hdl::Languages) {
        const std::string name = Orn_Hdl::GetLanguageName(language);
        Port::String option(("--" + name).c_str());
        option.MakeLower();
        AddFile(command, option.CStr(), outputs.files[language],
                "Write the design as " + name + "; - is standard output");
    }
    command.add_flag("--no-header", outputs.noHeader, "Omit the header from these netlists");
}

void AddWriteRules(CLI::App& command, Tool::WriteRules& rules) {
    CLI::Option* folder =
        command
            .add_option("--output-dir", rules.folder,
                        "Confine WRITE commands to DIR; file names are relative to it")
            ->type_name("DIR")
            ->check(CheckFileName);
    command.add_flag("--no-write", rules.noWrite, "Make every WRITE command fail")
        ->excludes(folder);
}

/// An option that may be repeated, with one value each time.
CLI::Option* AddRepeated(CLI::App& command, const std::string& option,
                         std::vector<std::string>& values, const std::string& help) {
    const auto add = [&values](const std::string& value) { values.push_back(value); };
    return command.add_option_function<std::string>(option, add, help)->trigger_on_parse();
}

/// An option whose value is one of a few words.
template <class Value>
void AddChoice(CLI::App& command, const std::string& option, Value& value,
               const std::vector<std::pair<std::string, Value>>& choices, const std::string& help) {
    std::vector<std::string> words;
    std::string type;
    for (const auto& [word, meaning] : choices) {
        type.append(type.empty() ? "" : "|").append(word);
        words.push_back(word);
    }
    const auto check = [words](const std::string& word) {
        return std::find(words.begin(), words.end(), word) != words.end()
                   ? std::string()
                   : "\"" + word + "\" is none of " + Tool::Explain::JoinChoices(words, "and");
    };
    const auto take = [choices, &value](const std::string& word) {
        for (const auto& [name, meaning] : choices) {
            value = name == word ? meaning : value;
        }
    };
    command.add_option_function<std::string>(option, take, help)->check(check)->type_name(type);
}

void AddFormat(CLI::App& command, const std::string& option, Tool::ReportOptions& report,
               const std::string& help) {
    AddChoice<Tool::ReportFormat>(command, option, report.format,
                                  {{"text", Tool::ReportFormat::Text},
                                   {"json", Tool::ReportFormat::Json},
                                   {"sarif", Tool::ReportFormat::Sarif}},
                                  help);
}

void AddColor(CLI::App& command, Tool::ReportOptions& report) {
    AddChoice<Tool::ColorChoice>(command, "--color", report.color,
                                 {{"auto", Tool::ColorChoice::Auto},
                                  {"always", Tool::ColorChoice::Always},
                                  {"never", Tool::ColorChoice::Never}},
                                 "Colour messages; auto colours for a terminal");
}

/// The options of messages on standard error.
void AddReport(CLI::App& command, Tool::ReportOptions& report) {
    AddFormat(command, "--diagnostics", report, "Print messages as text, JSON or SARIF");
    AddColor(command, report);
}

void AddThreads(CLI::App& command, unsigned& threads) {
    command
        .add_option("--threads", threads,
                    "Use up to N processors; 0, the default, is what the system gives, up to 8")
        ->type_name("N")
        ->envname("ORN_HDL_THREADS")
        ->check(CLI::Range(0, 64));
}

/// Drops the warnings of a list of names with commas between them. \return what is wrong with it.
std::string DropWarnings(const std::string& list, Tool::WarningOptions& warnings) {
    std::istringstream rest(list);
    for (std::string name; std::getline(rest, name, ',');) {
        if (!warnings.Drop(name)) {
            const std::string meant = Tool::GetNearest(name, Tool::GetWarningNames());
            return "there is no warning " + name +
                   (meant.empty() ? "; orn-hdl warnings lists them"
                                  : "; did you mean " + meant + "?");
        }
    }
    return "";
}

void AddDontCares(CLI::App& command, bool& dontCares) {
    command.add_flag("--dont-cares", dontCares, "The digit - of a constant is a don't care");
}

void AddWarnings(CLI::App& command, Tool::WarningOptions& warnings) {
    command
        .add_option_function<std::string>(
            "--no-warn", [&warnings](const std::string& list) { DropWarnings(list, warnings); },
            "Do not print these warnings, or all; orn-hdl warnings lists them")
        ->type_name("NAMES")
        ->check([](const std::string& list) {
            Tool::WarningOptions tried;
            return DropWarnings(list, tried);
        })
        // Of several lists, all count.
        ->join(',');
    command.add_flag("--werror", warnings.areErrors,
                     "Make warnings errors: --verilog and --vhdl then write nothing");
}

/// Adds the words of a list with commas between them. \return what is wrong with the list.
std::string TakeIgnored(const std::string& list, std::vector<std::string>& ignored) {
    const std::vector<std::string>& words = Tool::GetIgnorable();
    std::istringstream rest(list);
    for (std::string word; std::getline(rest, word, ',');) {
        if (std::find(words.begin(), words.end(), word) == words.end()) {
            return "\"" + word + "\" is none of " + Tool::Explain::JoinChoices(words, "and");
        }
        ignored.push_back(word);
    }
    return "";
}

/// An option for the format of a file whose extension does not tell it.
void AddDesignFormat(CLI::App& command, const std::string& option,
                     std::optional<Tool::DesignFormat>& format, const std::string& help) {
    AddChoice<std::optional<Tool::DesignFormat>>(command, option, format,
                                                 {{"commands", Tool::DesignFormat::Commands},
                                                  {"verilog", Tool::DesignFormat::Verilog},
                                                  {"vhdl", Tool::DesignFormat::Vhdl},
                                                  {"json", Tool::DesignFormat::Json}},
                                                 help);
}

/// The command line: its options, and the command to run.
class CommandLine {
public:
    CommandLine() {
        app_.require_subcommand(1);
        app_.set_version_flag(
            "--version", "orn-hdl " + std::string(Port::Version::getValue("version").GetView()),
            "Print the version and exit");
        AddCommand(
            "run", "Replay a command file and write netlists", [this] { return Run(); },
            &CommandLine::AddRun);
        AddCommand(
            "import", "Import a netlist in Verilog, VHDL or JSON",
            [this] { return Tool::ImportDesign(import_); }, &CommandLine::AddImport);
        AddCommand(
            "check", "Tell what tools make of the netlists of a command file",
            [this] { return Tool::CheckFiles(check_); }, &CommandLine::AddCheck);
        AddCommand(
            "diff", "Tell in what two designs differ", [this] { return Tool::PrintDiff(diff_); },
            &CommandLine::AddDiff);
        AddCommand(
            "verify", "Compare a netlist with the design of a command file",
            [this] { return Tool::Verify(verify_); }, &CommandLine::AddVerify);
        AddCommand(
            "draw", "Draw the design of a command file", [this] { return Tool::Draw(draw_); },
            &CommandLine::AddDraw);
        AddCommand(
            "stats", "Count what the design of a command file is made of",
            [this] { return Tool::PrintStats(stats_); }, &CommandLine::AddStats);
        AddCommand(
            "commands", "Print the command language",
            [this] { return markdown_ ? Tool::PrintCommandsPage() : Tool::PrintCommands(words_); },
            &CommandLine::AddCommands);
        AddCommand(
            "warnings", "Print the warnings of run",
            [this] { return markdown_ ? Tool::PrintWarningsPage() : Tool::PrintWarnings(); },
            &CommandLine::AddWarningsPage);
        app_.footer("\"orn-hdl help COMMAND\" prints the help of a command.");
    }

    Status Execute(int argc, const char* const* argv) {
        return Execute(std::vector<std::string>(argv + std::min(argc, 1), argv + argc));
    }

private:
    /// Adds a command. Its options are added when it is the one that runs: making all of them would
    /// take longer than a small file.
    void AddCommand(const std::string& name, const std::string& help,
                    std::function<Status()> action, void (CommandLine::*addOptions)(CLI::App&)) {
        CLI::App& command = *app_.add_subcommand(name, help);
        command.preparse_callback(
            [this, &command, addOptions](std::size_t) { (this->*addOptions)(command); });
        command.callback([this, action = std::move(action)] { action_ = action; });
    }

    /// \param words the command line without the name of the program.
    Status Execute(std::vector<std::string> words) {
        if (!words.empty() && words.front() == Help) {
            // "help" and "help run" are other ways to say "--help" and "run --help".
            words.erase(words.begin());
            words.emplace_back("--help");
        }
        if (!words.empty() && words.front().rfind('-', 0) != 0 &&
            FindCommand(words.front()) == nullptr) {
            return ComplainUnknown("there is no command " + words.front(), words.front(),
                                   GetCommandNames());
        }
        try {
            // CLI11 expects the words in reverse order.
            app_.parse(std::vector<std::string>(words.rbegin(), words.rend()));
        } catch (const CLI::ParseError& error) {
            return Report(error, words);
        }
        return action_();
    }

    /// Prints the help or the version that was asked for, or explains what is wrong.
    Status Report(const CLI::ParseError& error, const std::vector<std::string>& words) {
        std::ostringstream help;
        std::ostringstream complaint;
        if (app_.exit(error, help, complaint) == 0) {
            return Tool::Print(help.str());
        }
        if (dynamic_cast<const CLI::ExtrasError*>(&error) != nullptr ||
            dynamic_cast<const CLI::RequiredError*>(&error) != nullptr) {
            const std::vector<std::string> options = GetOptions(words);
            const std::string unknown = FindUnknownOption(words, options);
            if (!unknown.empty()) {
                return ComplainUnknown("unknown option " + unknown, unknown, options);
            }
        }
        Tool::Complain(std::string(error.what()) + "; see --help");
        return Status::Usage;
    }

    /// Prints a message about a word that is none of the candidates, with a suggestion.
    static Status ComplainUnknown(const std::string& complaint, const std::string& word,
                                  const std::vector<std::string>& candidates) {
        const std::string meant = Tool::GetNearest(word, candidates);
        Tool::Complain(complaint +
                       (meant.empty() ? "; see --help" : "; did you mean " + meant + "?"));
        return Status::Usage;
    }

    std::vector<std::string> GetCommandNames() const {
        std::vector<std::string> names = {Help};
        for (const CLI::App* command : app_.get_subcommands([](const CLI::App*) { return true; })) {
            names.push_back(command->get_name());
        }
        return names;
    }

    /// The command of that name, or null.
    const CLI::App* FindCommand(const std::string& name) const {
        const auto isNamed = [&](const CLI::App* command) { return command->get_name() == name; };
        const std::vector<const CLI::App*> found = app_.get_subcommands(isNamed);
        return found.empty() ? nullptr : found.front();
    }

    /// The long options that the command line may have: those of its command, if it names one.
    std::vector<std::string> GetOptions(const std::vector<std::string>& words) const {
        const CLI::App* command = words.empty() ? nullptr : FindCommand(words.front());
        std::vector<std::string> names;
        for (const CLI::Option* option : (command != nullptr ? *command : app_).get_options()) {
            for (const std::string& name : option->get_lnames()) {
                names.push_back("--" + name);
            }
        }
        return names;
    }

    /// The first long option on the command line that is none of those given, without its value;
    /// the empty text if there is none.
    static std::string FindUnknownOption(const std::vector<std::string>& words,
                                         const std::vector<std::string>& options) {
        const auto end = std::find(words.begin(), words.end(), "--");
        for (auto word = words.begin(); word != end; ++word) {
            std::string name = word->substr(0, word->find('='));
            if (name.rfind("--", 0) == 0 &&
                std::find(options.begin(), options.end(), name) == options.end()) {
                return name;
            }
        }
        return "";
    }

    Status Run() {
        if (run_.files.size() == 1) {
            run_.file = run_.files.front();
            run_.files.clear();
        }
        return Tool::Run(run_);
    }

    void AddRun(CLI::App& command) {
        command
            .add_option("FILE", run_.files,
                        "The command file; - is standard input. Of several, each is a design")
            ->type_name("")
            ->check(CheckFileName)
            ->required();
        command.add_option("--model", run_.model, "The name of the design")->type_name("NAME");
        AddOutputs(command, run_.outputs);
        AddFile(command, "--output-commands", run_.commandFile,
                "Write the commands of the final design; - is standard output");
        AddWriteRules(command, run_.writeRules);
        CLI::Option* keepGoing =
            command.add_flag("--keep-going", run_.keepGoing, "Continue after an error");
        command
            .add_option("--error-limit", run_.report.errorLimit,
                        "With --keep-going, stop after N errors")
            ->type_name("N")
            ->check(CLI::PositiveNumber)
            ->needs(keepGoing);
        AddReport(command, run_.report);
        AddWarnings(command, run_.warnings);
        CLI::Option* check = command.add_flag("--check", run_.check,
                                              "Write nothing that has errors for its language");
        CLI::Option* legal =
            command.add_flag("--legal", run_.legal, "Write netlists that every tool takes")
                ->excludes(check);
        CLI::Option* verify = command.add_flag(
            "--verify", run_.verify, "Read each netlist back and compare it with the design");
        AddFile(command, "--certificate", run_.certificate,
                "Write what was proven, with the SHA-256 of the files, as JSON")
            ->needs(verify);
        command.add_option("--names", run_.names, "How --legal mends names")
            ->check(CLI::IsMember({"rename", "escape"}))
            ->type_name("rename|escape")
            ->needs(legal);
        AddFile(command, "--name-map", run_.nameMap, "Write a table of old and new names")
            ->needs(legal);
        AddDontCares(command, run_.dontCares);
        AddThreads(command, run_.threads);
        command.add_flag("--quiet", run_.quiet, "Do not show progress");
    }

    void AddImport(CLI::App& command) {
        AddFile(command, "FILE", import_.file, "The netlist; - is standard input")->required();
        AddChoice<std::optional<Tool::ImportFormat>>(
            command, "--from", import_.format,
            {{"verilog", Tool::ImportFormat::Verilog},
             {"vhdl", Tool::ImportFormat::Vhdl},
             {"json", Tool::ImportFormat::Json}},
            "What the netlist is written in; the default is what its extension says");
        CLI::Option* top =
            command.add_option("--top", import_.top, "The module to import")->type_name("NAME");
        AddRepeated(command, "--module", import_.modules,
                    "Of a JSON netlist, import this module alone; may be repeated")
            ->type_name("NAME")
            ->excludes(top);
        AddFile(command, "-o", import_.commandFile,
                "Write the design as a command file; DIR/ gets one file a module");
        AddOutputs(command, import_.outputs);
        command
            .add_option(
                "--output-dir", import_.outputs.folder,
                "Write one file a module into DIR, and a list of them in place of each file")
            ->type_name("DIR")
            ->check(CheckFileName);
        AddRepeated(command, "-l,--library,--cells", import_.libraries,
                    "Read cell types: Verilog, VHDL, Liberty or JSON; may be repeated")
            ->type_name("FILE")
            ->check(CheckFileName);
        AddRepeated(command, "-I", import_.includeFolders,
                    "Look for files that Verilog includes; may be repeated")
            ->type_name("DIR")
            ->check(CheckFileName);
        AddRepeated(command, "-D", import_.macros, "Define a macro for Verilog; may be repeated")
            ->type_name("NAME[=TEXT]");
        const auto setNames = [this](const std::string& word) {
            import_.names = GetNameLanguages().at(word);
        };
        command
            .add_option_function<std::string>("--names", setNames,
                                              "Make names legal in these languages")
            ->type_name("verilog|vhdl|both")
            ->check(CheckNameLanguages);
        AddChoice<bool>(command, "--configuration", import_.vhdl.configuration,
                        {{"none", false}, {"work", true}},
                        "Configurations in VHDL: none, or one a module, for those in WORK");
        command.add_flag("--no-kestra", import_.vhdl.ieeeAlone,
                         "Leave the library KESTRA out of VHDL");
        command.add_flag("--keep-ports", import_.keepPorts, "Fail if a port has to be renamed");
        command
            .add_option("--x-as", import_.unknownAs,
                        "Replace the values x and z by 0, 1 or a don't care")
            ->type_name("0|1|-")
            ->check(CheckDigit);
        command.add_flag("--attributes", import_.attributes,
                         "Import the attributes of cells and nets");
        command.add_flag("--comments", import_.comments, "Import the comments of objects");
        command.add_flag("--legal", import_.legal, "Write netlists that every tool takes");
        CLI::Option* verify = command.add_flag(
            "--verify", import_.verify, "Read each netlist back and compare it with the design");
        AddFile(command, "--certificate", import_.certificate,
                "Write what was proven, with the SHA-256 of the files, as JSON")
            ->needs(verify);
        AddFile(command, "--name-map", import_.nameMap, "Write a table of old and new names");
        AddFile(command, "--write-cells", import_.cellModels,
                "Write simulation models in VHDL of the cells of Yosys");
        command.add_flag("--initial-values", import_.initialValues,
                         "Give the registers of these models the first values of their nets");
        AddThreads(command, import_.threads);
        AddReport(command, import_.report);
        command.footer("If no output is given, the file is only checked.");
    }

    void AddCheck(CLI::App& command) {
        command.add_option("FILE", check_.files, "The command files; - is standard input")
            ->type_name("")
            ->check(CheckFileName);
        command.add_option("--model", check_.model, "The name of the design")->type_name("NAME");
        command
            .add_option("--target", check_.targets, "Whose rules count, with commas between them")
            ->type_name("TARGETS");
        AddChoice<std::string>(command, "--fail-on", check_.failOn,
                               {{"error", "error"}, {"warning", "warning"}, {"never", "never"}},
                               "What makes the exit status 1");
        AddFormat(command, "--format,--diagnostics", check_.report, "How the findings are printed");
        AddColor(command, check_.report);
        AddDontCares(command, check_.dontCares);
        AddThreads(command, check_.threads);
        command.add_flag("--list", check_.list, "List the rules");
        command.add_flag("--markdown", check_.markdown, "Print the table of the documentation");
        command.add_option("--explain", check_.explain, "Explain a rule")->type_name("RULE");
    }

    void AddDiff(CLI::App& command) {
        AddFile(command, "A", diff_.a.name, "The first file; - is standard input")
            ->type_name("")
            ->required();
        AddFile(command, "B", diff_.b.name, "The second file; - is standard input")
            ->type_name("")
            ->required();
        const auto addLibrary = [this](const std::string& file) {
            diff_.libraries.push_back(file);
        };
        command
            .add_option_function<std::string>("-l", addLibrary,
                                              "Read the components of netlists; may be repeated")
            ->type_name("FILE")
            ->trigger_on_parse()
            ->check(CheckFileName);
        command
            .add_option_function<std::string>(
                "--ignore", [this](const std::string& list) { TakeIgnored(list, diff_.ignored); },
                "Do not compare names, attributes, comments or order, with commas between them")
            ->type_name("LIST")
            ->check([](const std::string& list) {
                std::vector<std::string> tried;
                return TakeIgnored(list, tried);
            })
            // Of several lists, all count.
            ->join(',');
        AddDesignFormat(command, "--from-a", diff_.a.format, "The format of A");
        AddDesignFormat(command, "--from-b", diff_.b.format, "The format of B");
        AddChoice<Tool::DiffFormat>(
            command, "--format", diff_.format,
            {{"text", Tool::DiffFormat::Text}, {"json", Tool::DiffFormat::Json}},
            "Print the differences as text or JSON");
        command.add_option("--limit", diff_.limit, "Show N differences; 0 shows all")
            ->type_name("N");
        AddReport(command, diff_.report);
        AddThreads(command, diff_.threads);
        command.add_flag("--quiet", diff_.quiet, "Do not show progress");
        command.footer("The exit status is 0 for equal designs, 1 for different ones, 2 for "
                       "trouble.");
    }

    void AddVerify(CLI::App& command) {
        command.add_option("NETLIST", verify_.netlist, "The netlist")
            ->type_name("")
            ->check(CheckFileName)
            ->required();
        AddFile(command, "--commands", verify_.commands, "The command file; - is standard input")
            ->required();
        command.add_option("--model", verify_.model, "The name of the design")->type_name("NAME");
        command
            .add_option("--language", verify_.language,
                        "The language of the netlist, if its extension does not tell")
            ->check(CLI::IsMember({"verilog", "vhdl"}))
            ->type_name("verilog|vhdl");
        CLI::Option* legal = command.add_flag("--legal", verify_.legal,
                                              "Compare with the design as run --legal writes it");
        command.add_option("--names", verify_.names, "How --legal mends names")
            ->check(CLI::IsMember({"rename", "escape"}))
            ->type_name("rename|escape")
            ->needs(legal);
        AddFile(command, "--certificate", verify_.certificate,
                "Write what was proven, with the SHA-256 of the files, as JSON");
        AddReport(command, verify_.report);
        AddDontCares(command, verify_.dontCares);
        AddThreads(command, verify_.threads);
        command.add_flag("--quiet", verify_.quiet, "Do not show progress");
        command.footer("WRITE commands in the file do nothing.");
    }

    void AddDraw(CLI::App& command) {
        AddFile(command, "FILE", draw_.file, "The command file; - is standard input")->required();
        AddFile(command, "-o", draw_.output, "The SVG file to write")->required();
        CLI::Option* around = command
                                  .add_option("--around", draw_.around,
                                              "Draw only the surroundings of an instance or signal")
                                  ->type_name("NAME");
        command
            .add_option("--depth", draw_.depth,
                        "Draw instances up to N steps away; the default is 1")
            ->type_name("N")
            ->check(CLI::Range(0, 1000))
            ->needs(around);
        AddReport(command, draw_.report);
    }

    void AddStats(CLI::App& command) {
        AddFile(command, "FILE", stats_.file, "The command file; - is standard input")->required();
        command.add_option("--model", stats_.model, "The name of the design")->type_name("NAME");
        AddChoice<Tool::StatsFormat>(
            command, "--format", stats_.format,
            {{"text", Tool::StatsFormat::Text}, {"json", Tool::StatsFormat::Json}},
            "Print the counts as text or JSON");
        AddReport(command, stats_.report);
        AddThreads(command, stats_.threads);
        command.add_flag("--quiet", stats_.quiet, "Do not show progress");
        command.footer("WRITE commands in the file do nothing.");
    }

    void AddCommands(CLI::App& command) {
        CLI::Option* words =
            command.add_option("WORDS", words_, "Print only commands that begin with these words");
        command.add_flag("--markdown", markdown_, "Print the page for the documentation")
            ->excludes(words);
    }

    void AddWarningsPage(CLI::App& command) {
        command.add_flag("--markdown", markdown_, "Print the table of the documentation");
    }

    static constexpr const char* Help = "help";

    CLI::App app_{"Builds designs from text commands and writes them as Verilog and VHDL netlists.",
                  "orn-hdl"};
    std::function<Status()> action_;
    Tool::RunOptions run_;
    Tool::ImportOptions import_;
    Tool::DrawOptions draw_;
    Tool::CheckOptions check_;
    Tool::DiffOptions diff_;
    Tool::StatsOptions stats_;
    Tool::VerifyOptions verify_;
    std::vector<std::string> words_;
    bool markdown_ = false;
};

Status Main(int argc, const char* const* argv) {
    try {
        return CommandLine().Execute(argc, argv);
    } catch (const std::bad_alloc&) {
        Tool::Complain("out of memory");
    } catch (const Tool::GzipError& error) {
        Tool::Complain(error.what());
        return Status::File;
    } catch (const std::exception& error) {
        Tool::Complain(error.what());
    }
    return Status::Failed;
}

} // namespace

int main(int argc, char** argv) {
    return static_cast<int>(Main(argc, argv));
}
