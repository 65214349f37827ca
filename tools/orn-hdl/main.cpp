// The orn-hdl tool: reads the command line and hands over to the command that it names.

#include "CommandsPage.h"
#include "Draw.h"
#include "Import.h"
#include "Run.h"
#include "Tool.h"
#include "check/Check.h"

#include "Orn_Hdl/Language.h"
#include "Port/String.h"
#include "Port/Version.h"

#include <CLI/CLI.hpp>

#include <exception>
#include <functional>
#include <map>
#include <new>
#include <sstream>
#include <string>
#include <vector>

namespace {

using Tool::Status;

/// Refuses the empty text, which is no file's name.
std::string CheckFileName(const std::string& name) {
    return name.empty() ? "a file name is needed" : "";
}

std::string CheckDigit(const std::string& text) {
    return text == "0" || text == "1" ? "" : "0 or 1 is needed";
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
        AddFile(command, option.CStr(), outputs.files[language], "Write the design as " + name);
    }
    command.add_flag("--no-header", outputs.noHeader, "Write these netlists without the header");
}

void AddWriteRules(CLI::App& command, Tool::WriteRules& rules) {
    CLI::Option* folder =
        command
            .add_option("--output-dir", rules.folder,
                        "Let WRITE lines write below this folder only, where their names begin")
            ->type_name("DIR")
            ->check(CheckFileName);
    command.add_flag("--no-write", rules.noWrite, "Let no WRITE line write anything")
        ->excludes(folder);
}

/// The command line: its options, and what to do when they have been read.
class CommandLine {
public:
    CommandLine() {
        app_.require_subcommand(1);
        app_.set_version_flag(
            "--version", "orn-hdl " + std::string(Port::Version::getValue("version").GetView()),
            "Print the version and leave");
        AddRun();
        AddImport();
        AddCheck();
        AddDraw();
        AddCommands();
    }

    Status Execute(int argc, const char* const* argv) {
        if (argc > 1 && *argv[1] != '-' && !HasCommand(argv[1])) {
            Tool::Complain(std::string("there is no command ") + argv[1] + "; --help lists them");
            return Status::Usage;
        }
        try {
            app_.parse(argc, argv);
        } catch (const CLI::ParseError& error) {
            std::ostringstream help;
            std::ostringstream complaint;
            if (app_.exit(error, help, complaint) == 0) {
                return Tool::Print(help.str());
            }
            Tool::Complain(std::string(error.what()) + "; --help tells more");
            return Status::Usage;
        }
        return action_();
    }

private:
    CLI::App& AddCommand(const std::string& name, const std::string& help,
                         std::function<Status()> action) {
        CLI::App& command = *app_.add_subcommand(name, help);
        command.callback([this, action = std::move(action)] { action_ = action; });
        return command;
    }

    bool HasCommand(const std::string& name) {
        const auto isNamed = [&](CLI::App* command) { return command->get_name() == name; };
        return !app_.get_subcommands(isNamed).empty();
    }

    void AddRun() {
        CLI::App& command = AddCommand("run", "Replay a command file and write netlists",
                                       [this] { return Tool::Run(run_); });
        AddFile(command, "FILE", run_.file, "The command file; - is standard input")->required();
        command.add_option("--model", run_.model, "The name of the design")->type_name("NAME");
        AddOutputs(command, run_.outputs);
        AddWriteRules(command, run_.writeRules);
        command.add_flag("--keep-going", run_.keepGoing, "Go on behind a line that failed");
        command.add_flag("--check", run_.check, "Write nothing that has errors for its language");
        command.add_flag("--quiet", run_.quiet, "Show no progress");
    }

    void AddImport() {
        CLI::App& command = AddCommand("import", "Import a JSON netlist written by Yosys",
                                       [this] { return Tool::ImportDesign(import_); });
        AddFile(command, "FILE", import_.file, "The JSON file; - is standard input")->required();
        command.add_option("--top", import_.top, "The module to import")->type_name("NAME");
        AddFile(command, "-o", import_.commandFile, "Write the design as a command file");
        AddOutputs(command, import_.outputs);
        command.add_option("--x-as", import_.unknownAs, "What the values x and z become")
            ->type_name("0|1")
            ->check(CheckDigit);
        command.add_flag("--attributes", import_.attributes,
                         "Take over the attributes of cells and nets");
        AddFile(command, "--name-map", import_.nameMap, "Write a table of the old and new names");
        command.footer("Without an output the file is only checked.");
    }

    void AddCheck() {
        CLI::App& command =
            AddCommand("check", "Tell what tools make of the netlists of a command file",
                       [this] { return Tool::CheckFiles(check_); });
        command.add_option("FILE", check_.files, "The command files; - is standard input")
            ->type_name("")
            ->check(CheckFileName);
        command.add_option("--model", check_.model, "The name of the design")->type_name("NAME");
        command
            .add_option("--target", check_.targets, "Whose rules count, with commas between them")
            ->type_name("TARGETS");
        command.add_option("--fail-on", check_.failOn, "What makes the exit status 1")
            ->check(CLI::IsMember({"error", "warning", "never"}));
        command.add_option("--format", check_.format, "How the findings are printed")
            ->transform(CLI::CheckedTransformer(
                std::map<std::string, Tool::CheckFormat>{{"text", Tool::CheckFormat::Text},
                                                         {"json", Tool::CheckFormat::Json},
                                                         {"sarif", Tool::CheckFormat::Sarif}}))
            ->type_name("text|json|sarif");
        command.add_flag("--list", check_.list, "List the rules");
        command.add_flag("--markdown", check_.markdown, "Print the table of the documentation");
        command.add_option("--explain", check_.explain, "Explain a rule")->type_name("RULE");
    }

    void AddDraw() {
        CLI::App& command = AddCommand("draw", "Draw the design of a command file",
                                       [this] { return Tool::Draw(draw_); });
        AddFile(command, "FILE", draw_.file, "The command file; - is standard input")->required();
        AddFile(command, "-o", draw_.output, "The SVG file to write")->required();
        CLI::Option* around = command
                                  .add_option("--around", draw_.around,
                                              "Draw only what lies around an instance or signal")
                                  ->type_name("NAME");
        command.add_option("--depth", draw_.depth, "How many instances away")
            ->type_name("N")
            ->check(CLI::Range(0, 1000))
            ->needs(around);
    }

    void AddCommands() {
        CLI::App& command = AddCommand("commands", "Print the command language", [this] {
            return markdown_ ? Tool::PrintCommandsPage() : Tool::PrintCommands(words_);
        });
        CLI::Option* words =
            command.add_option("WORDS", words_, "Only commands that begin with these words");
        command.add_flag("--markdown", markdown_, "Print the page of the documentation")
            ->excludes(words);
    }

    CLI::App app_{"Builds designs from text commands and writes them as Verilog and VHDL netlists.",
                  "orn-hdl"};
    std::function<Status()> action_;
    Tool::RunOptions run_;
    Tool::ImportOptions import_;
    Tool::DrawOptions draw_;
    Tool::CheckOptions check_;
    std::vector<std::string> words_;
    bool markdown_ = false;
};

Status Main(int argc, const char* const* argv) {
    try {
        return CommandLine().Execute(argc, argv);
    } catch (const std::bad_alloc&) {
        Tool::Complain("out of memory");
    } catch (const std::exception& error) {
        Tool::Complain(error.what());
    }
    return Status::Failed;
}

} // namespace

int main(int argc, char** argv) {
    return static_cast<int>(Main(argc, argv));
}
