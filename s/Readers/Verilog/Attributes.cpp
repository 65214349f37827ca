#include "Readers/Verilog/Attributes.h"

#include "Readers/Verilog/Characters.h"

#include <algorithm>
#include <memory>

namespace Orn_Hdl::Readers {

namespace {

constexpr const char* Assigned = "ASSIGN";

/// Comments that may hold attributes, or hide text from synthesis.
bool IsDialect(std::string_view text) {
    const std::string_view word = TakeWord(text);
    return word == "synthesis" || word == "synopsys" || word == "exemplar" || word == "pragma";
}

bool IsAny(std::string_view /*text*/) {
    return true;
}

std::string_view WithoutQuotes(std::string_view text) {
    if (text.size() > 1 && text.front() == '"' && text.back() == '"') {
        text.remove_prefix(1);
        text.remove_suffix(1);
    }
    return text;
}

} // namespace

AttributeReader::AttributeReader(Parser& parser, Scanner& scanner, NetlistMaker& maker,
                                 const VerilogSetup& setup)
    : parser_(parser), scanner_(scanner), maker_(maker), setup_(setup) {
    scanner_.SetCommentFilter(setup.keepsComments ? IsAny : IsDialect);
}

void AttributeReader::SkipBehind(std::string_view word, const Place& begin) {
    scanner_.SetCommentFilter(nullptr);
    parser_.SkipToWord(word, begin);
    Drop();
    scanner_.GetComments().clear();
    scanner_.SetCommentFilter(setup_.keepsComments ? IsAny : IsDialect);
    parser_.Next();
}

void AttributeReader::ReadAttributes() {
    while (parser_.Get().kind == TokenKind::AttributesBegin) {
        parser_.Next();
        for (;;) {
            Read read;
            read.place = parser_.Get().place;
            if (!parser_.IsName()) {
                parser_.FailExpected("the name of an attribute");
            }
            read.name = parser_.Get().text;
            parser_.Next();
            read.value = Value{Attribute::Integer, "1", {}};
            if (parser_.Accept('=')) {
                const bool isNegative = parser_.Accept('-');
                const Token& token = parser_.Get();
                try {
                    if (token.kind == TokenKind::String) {
                        read.value = ValueOfString(token.text);
                    } else if (token.kind == TokenKind::Number) {
                        read.value = ValueOf(Number::Read(token.text), isNegative);
                    } else {
                        parser_.FailExpected("a number or a string");
                    }
                } catch (const LiteralProblem& problem) {
                    parser_.Fail(problem.text);
                }
                parser_.Next();
            }
            if (setup_.keepsAttributes) {
                attributes_.push_back(std::move(read));
            }
            if (parser_.Get().kind == TokenKind::AttributesEnd) {
                break;
            }
            parser_.Expect(',');
        }
        parser_.Next();
    }
}

void AttributeReader::BeginStatement() {
    TakeComments(true);
    attributes_.clear();
    targets_.clear();
}

void AttributeReader::EndStatement() {
    TakeComments(false);
    attributes_.clear();
    lines_.clear();
}

void AttributeReader::Drop() {
    attributes_.clear();
    lines_.clear();
    targets_.clear();
}

void AttributeReader::GiveTo(const Target& target) {
    targets_.push_back(target);
    for (const Read& read : attributes_) {
        Set(target, read.name, read.value, read.place);
    }
    for (const std::string& line : lines_) {
        target.object->AddComment(line.c_str());
    }
    lines_.clear();
}

void AttributeReader::GiveNotes() {
    TakeComments(true);
    DropBanner(lines_, '/');
    Netlist& netlist = maker_.GetNetlist();
    GiveTo({&netlist, &netlist});
    attributes_.clear();
    targets_.clear();
}

void AttributeReader::Set(const Target& target, const std::string& name, const Value& value,
                          const Place& place) {
    if (NetlistSink* const sink = maker_.GetSink()) {
        sink->TakeAttribute(maker_.GetOwner(*target.holder), name, value, true, place);
        return;
    }
    const std::string problem = SetAttribute(*target.holder, name, value, nullptr, Assigned);
    if (!problem.empty()) {
        parser_.Fail(place, "the attribute " + Quoted(name) + ": " + problem);
    }
}

/// \param isBefore whether the comments stand in front of a statement.
void AttributeReader::TakeComments(bool isBefore) {
    std::vector<Comment>& comments = scanner_.GetComments();
    if (comments.empty()) {
        return;
    }
    for (const Comment& comment : comments) {
        if (!TakeDialect(comment) && isBefore && setup_.keepsComments) {
            AddLines(comment, lines_);
        }
    }
    comments.clear();
}

/// \return false for a comment that is none of a dialect.
bool AttributeReader::TakeDialect(const Comment& comment) {
    if (!IsDialect(comment.text)) {
        return false;
    }
    // A sink gets what the library has written: the words of other dialects are a user's comment.
    if (TakeSwitch(comment.text, isHidden_, maker_.GetSink() == nullptr)) {
        return true;
    }
    const std::vector<std::string_view> words = FirstWords(comment.text);
    if (comment.isBlock) {
        std::string_view rest = comment.text;
        TakeWord(rest);
        if (words.front() == "synopsys" && words.size() > 1 && words[1] == "attribute") {
            TakeWord(rest);
            TakeSynopsys(rest, comment.place);
            return true;
        }
        if (words.front() == "synthesis") {
            TakeSynplicity(Trim(rest), comment.place);
            return true;
        }
        return false;
    }
    return TakeNamed(comment.text, words, comment.place);
}

/// The forms "synthesis attribute NAME of OBJECT is "VALUE"", "exemplar attribute OBJECT NAME
/// VALUE" and "pragma attribute OBJECT NAME VALUE".
bool AttributeReader::TakeNamed(std::string_view text, const std::vector<std::string_view>& words,
                                const Place& place) {
    constexpr std::size_t FormWords = 4;
    if (words.size() < FormWords || words[1] != "attribute") {
        return false;
    }
    const bool isSentence = words.front() == "synthesis";
    if (isSentence && (words.size() < 6 || words[3] != "of" || words[5] != "is")) {
        return false;
    }
    if (!isSentence && words.front() == "synopsys") {
        return false;
    }
    for (std::size_t i = 0; i < (isSentence ? 6U : FormWords); ++i) {
        TakeWord(text);
    }
    std::string_view object = words[isSentence ? 4 : 2];
    // An escaped name is known without its mark.
    object.remove_prefix(object.front() == '\\' ? 1 : 0);
    const std::string name(words[isSentence ? 2 : 3]);
    const Target target = Find(std::string(object));
    if (target.holder != nullptr && setup_.keepsAttributes) {
        const std::string_view value = isSentence ? WithoutQuotes(Trim(text)) : Trim(text);
        Set(target, name, Value{Attribute::String, std::string(value), {}}, place);
    }
    return true;
}

Target AttributeReader::Find(const std::string& name) const {
    if (Signal* const signal = maker_.FindSignal(name)) {
        return {signal, signal};
    }
    if (Instance* const instance = maker_.FindInstance(name)) {
        return {instance, instance};
    }
    Netlist& netlist = maker_.GetNetlist();
    return netlist.GetNameView() == name ? Target{&netlist, &netlist} : Target();
}

void AttributeReader::SetOnTargets(std::string_view name, std::string_view value,
                                   const Place& place) {
    if (name.empty() || !setup_.keepsAttributes) {
        return;
    }
    for (const Target& target : targets_) {
        Set(target, std::string(name), Value{Attribute::String, std::string(value), {}}, place);
    }
}

/// "A=1, \", line end, "B=2" in one pair of quotes; or words NAME=VALUE.
void AttributeReader::TakeSynplicity(std::string_view text, const Place& place) {
    const auto setOne = [this, &place](std::string_view item) {
        const std::size_t equals = item.find('=');
        const std::string_view value =
            equals == std::string_view::npos ? "1" : WithoutQuotes(Trim(item.substr(equals + 1)));
        SetOnTargets(Trim(item.substr(0, equals)), value, place);
    };
    if (text.size() > 1 && text.front() == '"' && text.back() == '"') {
        text = WithoutQuotes(text);
        constexpr std::string_view Separator = ", \\\n";
        for (;;) {
            const std::size_t end = std::min(text.find(Separator), text.size());
            setOne(text.substr(0, end));
            if (end == text.size()) {
                return;
            }
            text.remove_prefix(end + Separator.size());
            text = text.substr(std::min(text.find_first_not_of(' '), text.size()));
        }
    }
    while (!text.empty()) {
        std::size_t length = 0;
        bool isInString = false;
        for (; length < text.size(); ++length) {
            isInString = isInString != (text[length] == '"');
            if (!isInString && (Characters::IsBlank(text[length]) || text[length] == ',')) {
                break;
            }
        }
        setOne(text.substr(0, length));
        text.remove_prefix(std::min(length + 1, text.size()));
    }
}

/// NAME "VALUE" in each line.
void AttributeReader::TakeSynopsys(std::string_view text, const Place& place) {
    while (!text.empty()) {
        const std::size_t end = std::min(text.find('\n'), text.size());
        std::string_view line = Trim(text.substr(0, end));
        text.remove_prefix(std::min(end + 1, text.size()));
        const std::string_view name = TakeWord(line);
        SetOnTargets(name, WithoutQuotes(Trim(line)), place);
    }
}

} // namespace Orn_Hdl::Readers
