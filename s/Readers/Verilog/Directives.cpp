// The compiler directives, which the scanner carries out (IEEE 1364-2005, clause 19).
#include "Port/File.h"
#include "Readers/Verilog/Characters.h"
#include "Readers/Verilog/Scanner.h"
#include "Readers/Verilog/Source.h"

#include <algorithm>
#include <utility>

namespace Orn_Hdl::Readers {

namespace {

/// Limits, so that files and macros that name themselves come to an end.
constexpr std::size_t MostNestedSources = 64;
constexpr std::size_t MostOpenedFiles = 10'000;
/// How many characters macros may be replaced by, each use counted as some more: so many at once,
/// and for each character of the file.
constexpr std::uint64_t FreeExpansion = std::uint64_t(1) << 24;
constexpr std::uint64_t ExpansionPerCharacter = 64;
constexpr std::uint64_t CostOfUse = 64;

bool IsOneOf(std::string_view word, std::initializer_list<std::string_view> words) {
    return std::find(words.begin(), words.end(), word) != words.end();
}

std::string_view WithoutEndBlanks(std::string_view text) {
    while (!text.empty() && Characters::IsBlank(text.back())) {
        text.remove_suffix(1);
    }
    return text;
}

std::string Join(const std::string& folder, const std::string& name) {
    return folder.empty() || folder.back() == '/' ? folder + name : folder + "/" + name;
}

bool CanBeRead(const std::string& fileName) {
    Port::File file;
    return file.open(fileName.c_str(), Port::File::Read, true);
}

} // namespace

void Scanner::PushFile(const std::string& fileName, const Place& place) {
    if (sources_.size() >= MostNestedSources || ++openedFiles_ > MostOpenedFiles) {
        Fail(place, "too many files include each other");
    }
    auto source = std::make_unique<Source>();
    if (!source->text.Open(fileName)) {
        const std::string reason = Port::ErrorText(source->text.GetError()).CStr();
        Fail(place, "cannot open " + Quoted(fileName) + ": " + reason);
    }
    source->file = files_.Add(fileName);
    source->place = place;
    sources_.push_back(std::move(source));
    source_ = sources_.back().get();
    input_ = &source_->text;
}

void Scanner::PushMacro(const Macro& macro, const Place& place) {
    if (!source_->isMacro) {
        granted_ = FreeExpansion + ExpansionPerCharacter * input_->GetOffset(input_->current);
    }
    expanded_ += CostOfUse + macro.text.size();
    if (sources_.size() >= MostNestedSources || expanded_ > granted_) {
        Fail(place, "macros use each other too often");
    }
    auto source = std::make_unique<Source>();
    source->text.Take(macro.text);
    source->file = source_->file;
    source->isMacro = true;
    source->place = place;
    sources_.push_back(std::move(source));
    source_ = sources_.back().get();
    input_ = &source_->text;
}

/// Goes back to the source around the innermost one. \return false if there is none.
bool Scanner::Pop() {
    if (const int error = input_->GetError()) {
        Fail(Place{source_->file, 0, 0},
             std::string("cannot be read: ") + Port::ErrorText(error).CStr());
    }
    if (sources_.size() <= 1) {
        return false;
    }
    sources_.pop_back();
    source_ = sources_.back().get();
    input_ = &source_->text;
    return true;
}

void Scanner::ReadDirective() {
    const Place place = GetPlace();
    ++input_->current;
    if (IsAtEnd() || !Characters::BeginsName(*input_->current)) {
        Fail(place, "no directive follows the accent");
    }
    const std::string name(TakeWhile(Characters::IsInName));
    if (!CarryOut(name, place)) {
        UseMacro(name, place);
    }
}

/// \return false for a name that is no directive's.
bool Scanner::CarryOut(std::string_view directive, const Place& place) {
    if (directive == "define") {
        ReadDefine(place);
    } else if (directive == "undef") {
        macros_.erase(ReadDirectiveWord());
    } else if (directive == "ifdef" || directive == "ifndef") {
        const bool isDefined = macros_.find(ReadDirectiveWord()) != macros_.end();
        BeginCondition(isDefined == (directive == "ifdef"), place);
    } else if (directive == "else" || directive == "elsif") {
        ReadElse(directive == "elsif", place);
    } else if (directive == "endif") {
        EndCondition(place);
    } else if (directive == "include") {
        ReadInclude(place);
    } else if (directive == "default_nettype") {
        ReadNetType(place);
    } else if (directive == "resetall") {
        hasImplicitNets_ = true;
    } else if (directive == "unconnected_drive") {
        Fail(place, "`unconnected_drive: a model leaves open pins open");
    } else if (IsOneOf(directive, {"timescale", "line", "pragma", "begin_keywords"})) {
        SkipRestOfLine();
    } else {
        return IsOneOf(directive,
                       {"celldefine", "endcelldefine", "nounconnected_drive", "end_keywords"});
    }
    return true;
}

/// The name behind a directive, in the same line; empty if there is none.
std::string Scanner::ReadDirectiveWord() {
    SkipInLine();
    if (!IsAtEnd() && *input_->current == '\\') {
        ++input_->current;
        return std::string(TakeWhile([](char c) { return c > ' '; }));
    }
    return std::string(TakeWhile(Characters::IsInName));
}

void Scanner::ReadDefine(const Place& place) {
    std::string name = ReadDirectiveWord();
    if (name.empty()) {
        Fail(place, "`define without a name");
    }
    Macro macro;
    macro.hasArguments = !IsAtEnd() && *input_->current == '(';
    macro.text = ReadMacroText();
    macros_.insert_or_assign(std::move(name), std::move(macro));
}

/// The rest of the line, and of the following ones where a backslash ends them, without comments.
std::string Scanner::ReadMacroText() {
    std::string text;
    bool isInString = false;
    while (!IsAtEnd() && *input_->current != '\n') {
        const char c = *input_->current;
        const char second = c == '\\' || c == '/' ? PeekSecond() : '\0';
        if (!isInString && c == '/' && second == '/') {
            SkipLineComment();
            break;
        }
        if (!isInString && c == '/' && second == '*') {
            SkipBlockComment();
            text += ' ';
            continue;
        }
        if (c == '\\' && (second == '\n' || second == '\r')) {
            input_->current += second == '\r' ? 2 : 1;
            if (!IsAtEnd() && *input_->current == '\n') {
                EndLine();
            }
            text += '\n';
            continue;
        }
        isInString = isInString != (c == '"');
        text += c;
        ++input_->current;
    }
    return std::string(WithoutEndBlanks(text));
}

void Scanner::UseMacro(const std::string& name, const Place& place) {
    const auto found = macros_.find(name);
    if (found == macros_.end()) {
        Fail(place, "the macro " + Quoted("`" + name) + " is not defined");
    }
    if (found->second.hasArguments) {
        Fail(place, "the macro " + Quoted("`" + name) +
                        " has arguments: have them replaced first, by iverilog -E for example");
    }
    PushMacro(found->second, place);
}

void Scanner::ReadInclude(const Place& place) {
    const std::string name = ReadIncludeName(place);
    if (setup_.includes == VerilogReader::Includes::Keep) {
        if (isInModule_) {
            Fail(place, "an `include inside of a module cannot be kept");
        }
        keptIncludes_.push_back(name);
        return;
    }
    PushFile(FindIncluded(name), place);
}

std::string Scanner::ReadIncludeName(const Place& place) {
    SkipInLine();
    if (IsAtEnd() || (*input_->current != '"' && *input_->current != '<')) {
        Fail(place, "`include without the name of a file");
    }
    const char last = *input_->current == '<' ? '>' : '"';
    ++input_->current;
    std::string name(TakeWhile([last](char c) { return c != last && c != '\n' && c != '\0'; }));
    if (IsAtEnd() || *input_->current != last) {
        Fail(place, "`include without the name of a file");
    }
    ++input_->current;
    return name;
}

/// The file in the folder of the one that includes it, else in the first folder that has it.
std::string Scanner::FindIncluded(const std::string& name) const {
    const std::string& including = files_.GetName(source_->file);
    const std::size_t slash = including.rfind('/');
    if (name.empty() || name.front() == '/' || slash == std::string::npos) {
        if (CanBeRead(name)) {
            return name;
        }
    } else if (std::string besides = including.substr(0, slash + 1) + name; CanBeRead(besides)) {
        return besides;
    }
    for (const std::string& folder : setup_.includeFolders) {
        if (std::string inside = Join(folder, name); CanBeRead(inside)) {
            return inside;
        }
    }
    return name;
}

void Scanner::ReadNetType(const Place& place) {
    const std::string type = ReadDirectiveWord();
    if (!IsOneOf(type, {"wire", "tri", "none"})) {
        Fail(place, "`default_nettype " + type + ": a model has wires alone");
    }
    hasImplicitNets_ = type != "none";
}

void Scanner::BeginCondition(bool isTrue, const Place& place) {
    conditions_.push_back(Condition{place, isTrue, false});
    if (!isTrue) {
        SkipInactive();
    }
}

/// Reached at the end of text that was read, so what follows is not.
void Scanner::ReadElse(bool hasName, const Place& place) {
    if (conditions_.empty() || conditions_.back().hasElse) {
        Fail(place, "no `ifdef is open to which this directive could belong");
    }
    if (hasName) {
        ReadDirectiveWord();
    }
    conditions_.back().hasElse = !hasName;
    SkipInactive();
}

void Scanner::EndCondition(const Place& place) {
    if (conditions_.empty()) {
        Fail(place, "no `ifdef is open to which this directive could belong");
    }
    conditions_.pop_back();
}

/// Skips text up to the `else, `elsif or `endif behind which text is to be read.
void Scanner::SkipInactive() {
    std::size_t depth = 0;
    while (SkipToDirective()) {
        const Place place = GetPlace();
        ++input_->current;
        const std::string name(TakeWhile(Characters::IsInName));
        Condition& condition = conditions_.back();
        if (name == "ifdef" || name == "ifndef") {
            ++depth;
        } else if (name == "endif" && depth > 0) {
            --depth;
        } else if (name == "endif") {
            conditions_.pop_back();
            return;
        } else if (depth == 0 && (name == "else" || name == "elsif")) {
            if (condition.hasElse) {
                Fail(place, "no `ifdef is open to which this directive could belong");
            }
            condition.hasElse = name == "else";
            const bool isTrue =
                condition.hasElse || macros_.find(ReadDirectiveWord()) != macros_.end();
            if (isTrue && !condition.wasTrue) {
                condition.wasTrue = true;
                return;
            }
        }
    }
}

/// \return false at the end of the innermost source.
bool Scanner::SkipToDirective() {
    while (!IsAtEnd()) {
        const char c = *input_->current;
        if (c == '`') {
            return true;
        }
        if (c == '\n') {
            EndLine();
        } else if (c == '/' && PeekSecond() == '/') {
            SkipLineComment();
        } else if (c == '/' && PeekSecond() == '*') {
            SkipBlockComment();
        } else if (c == '"' || c == '\\') {
            SkipEscapedOrString();
        } else {
            ++input_->current;
        }
    }
    return false;
}

/// Skips an escaped name, or a string up to its end or that of its line.
void Scanner::SkipEscapedOrString() {
    const bool isString = *input_->current == '"';
    ++input_->current;
    while (!IsAtEnd() && *input_->current != '\n') {
        const char c = *input_->current;
        if (isString ? c == '"' : Characters::IsBlank(c)) {
            ++input_->current;
            return;
        }
        ++input_->current;
        if (isString && c == '\\' && !IsAtEnd() && *input_->current != '\n') {
            ++input_->current;
        }
    }
}

} // namespace Orn_Hdl::Readers
