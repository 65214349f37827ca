#include "CommandsPage.h"

#include "Orn_Hdl/Commands.h"
#include "Port/Ascii.h"

#include <algorithm>
#include <string_view>

namespace Tool {

namespace {

using Orn_Hdl::CommandInfo;

std::string JoinWords(const std::vector<std::string>& words) {
    std::string phrase;
    for (const std::string& word : words) {
        phrase.append(phrase.empty() ? "" : " ").append(word);
    }
    return phrase;
}

bool IsPhrase(const CommandInfo& command, std::string_view words) {
    return Port::EqualIgnoringCase(command.phrase, words);
}

/// Whether the phrase begins with these whole words and has more words.
bool IsLongerPhrase(const CommandInfo& command, std::string_view words) {
    const std::string_view phrase(command.phrase);
    if (words.empty()) {
        return true;
    }
    return phrase.size() > words.size() && phrase[words.size()] == ' ' &&
           Port::EqualIgnoringCase(phrase.substr(0, words.size()), words);
}

std::string GetSynopsis(const CommandInfo& command) {
    std::string synopsis(command.phrase);
    if (*command.arguments != '\0') {
        synopsis.append(" ").append(command.arguments);
    }
    return synopsis;
}

/// One line a command, the help texts in one column.
std::string FormatTable(const std::vector<CommandInfo>& commands) {
    std::size_t width = 0;
    for (const CommandInfo& command : commands) {
        width = std::max(width, GetSynopsis(command).size());
    }
    std::string table;
    for (const CommandInfo& command : commands) {
        std::string synopsis = GetSynopsis(command);
        synopsis.resize(width, ' ');
        table.append(synopsis).append("  ").append(command.help).append("\n");
    }
    return table;
}

/// One command over several lines.
std::string FormatInFull(const CommandInfo& command) {
    const bool hasArguments = *command.arguments != '\0';
    std::string text("Command:    ");
    text.append(command.phrase);
    text.append("\nArguments:  ").append(hasArguments ? command.arguments : "none");
    return text.append("\n\n").append(command.help).append("\n");
}

/// A text for a cell of a table: "|" is escaped, because it would end the cell even within code.
std::string FormatCell(std::string_view text) {
    std::string cell;
    for (const char c : text) {
        cell.append(c == '|' ? "\\" : "") += c;
    }
    return cell;
}

std::string FormatCode(std::string_view text) {
    return text.empty() ? std::string() : "`" + FormatCell(text) + "`";
}

} // namespace

Status PrintCommands(const std::vector<std::string>& words) {
    const std::string wanted = JoinWords(words);
    std::string text;
    std::vector<CommandInfo> longer;
    for (const CommandInfo& command : Orn_Hdl::CommandFactory::GetCatalogue()) {
        if (IsPhrase(command, wanted)) {
            text += FormatInFull(command);
        } else if (IsLongerPhrase(command, wanted)) {
            longer.push_back(command);
        }
    }
    if (text.empty() && longer.empty()) {
        Complain("no command begins with \"" + wanted + "\"; \"orn-hdl commands\" lists them all");
        return Status::Usage;
    }
    text.append(text.empty() || longer.empty() ? "" : "\n").append(FormatTable(longer));
    return Print(text);
}

Status PrintCommandsPage() {
    std::string text(
        "# The command language\n"
        "\n"
        "One command a line. Arguments are separated by spaces. Quote an argument that\n"
        "contains spaces, with `'...'` or `\"...\"`; a backslash before a quote makes the\n"
        "quote part of the argument. Commands and names are case-insensitive. Empty lines\n"
        "are ignored. A line that begins with `NOOP` does nothing and can hold a comment. A\n"
        "line that fails ends the replay; earlier lines keep their effect.\n"
        "\n"
        "`<argument>` is required, `[argument]` is optional, `...` stands for several words.\n"
        "\n"
        "| Command | Arguments | What it does |\n"
        "| --- | --- | --- |\n");
    for (const CommandInfo& command : Orn_Hdl::CommandFactory::GetCatalogue()) {
        text.append("| ").append(FormatCode(command.phrase));
        text.append(" | ").append(FormatCode(command.arguments));
        text.append(" | ").append(FormatCell(command.help)).append(" |\n");
    }
    return Print(text);
}

} // namespace Tool
