// Reads the cells of Liberty files.

#include "cells/CellDeclaration.h"

#include "Port/Ascii.h"

#include <algorithm>
#include <charconv>
#include <optional>
#include <unordered_map>
#include <utility>

namespace Tool::Cells {

namespace {

struct LibertyToken {
    enum Kind : std::uint8_t { End, Word, Mark };

    Kind kind = End;
    std::string_view text;
    std::size_t line = 0;

    bool Is(std::string_view mark) const noexcept { return kind == Mark && text == mark; }
};

class LibertyLexer {
public:
    explicit LibertyLexer(std::string_view text) noexcept : text_(text) {}

    LibertyToken Next();

private:
    bool IsAtEnd() const noexcept { return position_ >= text_.size(); }
    void SkipBlanks();
    LibertyToken ReadText();

    std::string_view text_;
    std::size_t position_ = 0;
    std::size_t line_ = 1;
};

bool IsGap(char c) noexcept {
    // A backslash continues a line.
    return c == ' ' || (c >= '\t' && c <= '\r') || c == '\\' || c == '\0';
}

bool IsMark(char c) noexcept {
    return std::string_view("(){}:;,").find(c) != std::string_view::npos;
}

void LibertyLexer::SkipBlanks() {
    for (; !IsAtEnd(); ++position_) {
        const std::string_view rest = text_.substr(position_, 2);
        if (rest == "/*") {
            const std::size_t end = text_.find("*/", position_ + 2);
            if (end == std::string_view::npos) {
                throw Error(line_, "the end of the comment is missing");
            }
            line_ += static_cast<std::size_t>(
                std::count(text_.begin() + static_cast<std::ptrdiff_t>(position_),
                           text_.begin() + static_cast<std::ptrdiff_t>(end), '\n'));
            position_ = end + 1;
        } else if (rest == "//") {
            position_ = std::min(text_.find('\n', position_), text_.size()) - 1;
        } else if (IsGap(text_[position_])) {
            line_ += text_[position_] == '\n' ? 1 : 0;
        } else {
            return;
        }
    }
}

LibertyToken LibertyLexer::Next() {
    SkipBlanks();
    if (IsAtEnd()) {
        return LibertyToken{LibertyToken::End, std::string_view(), line_};
    }
    const std::size_t start = position_;
    if (text_[start] == '"') {
        return ReadText();
    }
    if (IsMark(text_[start])) {
        ++position_;
        return LibertyToken{LibertyToken::Mark, text_.substr(start, 1), line_};
    }
    while (!IsAtEnd() && !IsGap(text_[position_]) && !IsMark(text_[position_]) &&
           text_[position_] != '"') {
        ++position_;
    }
    return LibertyToken{LibertyToken::Word, text_.substr(start, position_ - start), line_};
}

LibertyToken LibertyLexer::ReadText() {
    const std::size_t line = line_;
    const std::size_t start = ++position_;
    while (!IsAtEnd() && text_[position_] != '"') {
        line_ += text_[position_] == '\n' ? 1 : 0;
        position_ +=
            text_[position_] == '\\' && position_ + 1 < text_.size() && text_[position_ + 1] != '\n'
                ? 2
                : 1;
    }
    if (IsAtEnd()) {
        throw Error(line, "the end of the string is missing");
    }
    return LibertyToken{LibertyToken::Word, text_.substr(start, position_++ - start), line};
}

/// A group that is open, such as cell(AND2) { ... }.
struct Group {
    enum Kind : std::uint8_t { Other, Type, Cell, Pin, Bus, Bundle };

    Kind kind = Other;
    std::size_t line = 0;
    /// The ports that the group declares: consecutive ones of the cell.
    std::size_t firstPort = 0;
    /// The type that the group declares.
    std::string_view name;
    std::optional<std::int64_t> from;
    std::optional<std::int64_t> to;
    /// The direction of the group's ports.
    PortDirection direction = PortDirection::Unknown;
};

class LibertyReader {
public:
    explicit LibertyReader(std::string_view text) : lexer_(text) { Step(); }

    std::vector<CellDeclaration> Read();

private:
    using Words = std::vector<std::string_view>;

    void Step() { token_ = lexer_.Next(); }
    [[noreturn]] void Fail(const std::string& text) const { throw Error(token_.line, text); }
    void ReadStatement();
    Words ReadArguments();
    std::string_view ReadValue();
    void OpenGroup(std::string_view kind, const Words& arguments);
    void CloseGroup();
    void AddPorts(const Words& names, bool isPower);
    void SetAttribute(std::string_view name, std::string_view value);
    void SetDirection(std::string_view value);
    void SetBusType(std::string_view type);

    LibertyLexer lexer_;
    LibertyToken token_;
    std::vector<CellDeclaration> cells_;
    std::vector<Group> groups_;
    bool isInCell_ = false;
    std::unordered_map<std::string_view, PortRange> types_;
};

std::vector<CellDeclaration> LibertyReader::Read() {
    while (token_.kind != LibertyToken::End) {
        if (token_.Is("}")) {
            CloseGroup();
        } else if (token_.Is(";")) {
            Step();
        } else {
            ReadStatement();
        }
    }
    if (!groups_.empty()) {
        throw Error(groups_.back().line, "\"}\" is missing for this group");
    }
    return std::move(cells_);
}

void LibertyReader::ReadStatement() {
    if (token_.kind != LibertyToken::Word) {
        Fail("the name of a group or an attribute is expected");
    }
    const std::string_view name = token_.text;
    Step();
    if (token_.Is(":")) {
        Step();
        SetAttribute(name, ReadValue());
    } else if (token_.Is("(")) {
        const Words arguments = ReadArguments();
        if (token_.Is("{")) {
            OpenGroup(name, arguments);
            Step();
        } else if (name == "members" && !groups_.empty() && groups_.back().kind == Group::Bundle) {
            AddPorts(arguments, false);
        }
    } else {
        Fail("\":\" or \"(\" is expected");
    }
}

LibertyReader::Words LibertyReader::ReadArguments() {
    Words words;
    Step();
    while (!token_.Is(")")) {
        if (token_.kind == LibertyToken::End || token_.Is("{") || token_.Is("}")) {
            Fail("\")\" is expected");
        }
        if (token_.kind == LibertyToken::Word) {
            words.push_back(token_.text);
        }
        Step();
    }
    Step();
    return words;
}

/// The first word of an attribute's value; goes behind the value.
std::string_view LibertyReader::ReadValue() {
    const std::size_t line = token_.line;
    const std::string_view value =
        token_.kind == LibertyToken::Word ? token_.text : std::string_view();
    // Some files leave out the semicolon at the line's end.
    while (!token_.Is(";") && !token_.Is("}") && token_.kind != LibertyToken::End &&
           token_.line == line) {
        Step();
    }
    return value;
}

void LibertyReader::OpenGroup(std::string_view kind, const Words& arguments) {
    constexpr std::size_t DeepestNesting = 100;
    if (groups_.size() == DeepestNesting) {
        Fail("nested too deeply");
    }
    Group group;
    group.line = token_.line;
    group.name = arguments.empty() ? std::string_view() : arguments.front();
    const Group::Kind outer = groups_.empty() ? Group::Other : groups_.back().kind;
    if (kind == "cell" && !isInCell_) {
        if (group.name.empty()) {
            Fail("the name of a cell is expected");
        }
        group.kind = Group::Cell;
        isInCell_ = true;
        cells_.emplace_back().name = group.name;
    } else if (kind == "type") {
        group.kind = Group::Type;
    } else if (outer == Group::Cell && (kind == "pin" || kind == "pg_pin")) {
        group.kind = Group::Pin;
    } else if (outer == Group::Cell && (kind == "bus" || kind == "bundle")) {
        group.kind = kind == "bus" ? Group::Bus : Group::Bundle;
    }
    if (isInCell_) {
        group.firstPort = cells_.back().ports.size();
    }
    groups_.push_back(group);
    if (group.kind == Group::Pin || group.kind == Group::Bus) {
        AddPorts(arguments, kind == "pg_pin");
    }
}

void LibertyReader::CloseGroup() {
    if (groups_.empty()) {
        Fail("\"}\" without a group");
    }
    const Group& group = groups_.back();
    if (group.kind == Group::Cell) {
        isInCell_ = false;
        std::vector<CellPort>& ports = cells_.back().ports;
        const auto isInternal = [](const CellPort& port) { return port.name.empty(); };
        ports.erase(std::remove_if(ports.begin(), ports.end(), isInternal), ports.end());
    } else if (group.kind == Group::Type && group.from && group.to) {
        types_.insert_or_assign(group.name, PortRange{*group.from, *group.to});
    }
    groups_.pop_back();
    Step();
}

void LibertyReader::AddPorts(const Words& names, bool isPower) {
    for (const std::string_view name : names) {
        CellPort& port = cells_.back().ports.emplace_back();
        port.name = name;
        port.isPower = isPower;
        port.direction = isPower ? PortDirection::InOut : groups_.back().direction;
    }
}

void LibertyReader::SetAttribute(std::string_view name, std::string_view value) {
    if (groups_.empty()) {
        return;
    }
    Group& group = groups_.back();
    if (group.kind == Group::Type && (name == "bit_from" || name == "bit_to")) {
        std::int64_t number = 0;
        const auto [end, error] =
            std::from_chars(value.data(), value.data() + value.size(), number);
        if (error != std::errc() || end != value.data() + value.size()) {
            Fail("a number is expected");
        }
        (name == "bit_from" ? group.from : group.to) = number;
    } else if (group.kind == Group::Pin || group.kind == Group::Bus ||
               group.kind == Group::Bundle) {
        if (name == "direction") {
            SetDirection(value);
        } else if (name == "bus_type" && group.kind == Group::Bus) {
            SetBusType(value);
        }
    }
}

void LibertyReader::SetDirection(std::string_view value) {
    std::vector<CellPort>& ports = cells_.back().ports;
    Group& group = groups_.back();
    if (value == "input") {
        group.direction = PortDirection::Input;
    } else if (value == "output") {
        group.direction = PortDirection::Output;
    } else if (value == "inout") {
        group.direction = PortDirection::InOut;
    } else if (value != "internal") {
        Fail("a direction is input, output, inout or internal");
    }
    for (std::size_t p = group.firstPort; p < ports.size(); ++p) {
        ports[p].direction = group.direction;
        if (value == "internal") {
            // The cell does not show the pin.
            ports[p].name.clear();
        }
    }
}

void LibertyReader::SetBusType(std::string_view type) {
    const auto found = types_.find(type);
    std::vector<CellPort>& ports = cells_.back().ports;
    for (std::size_t p = groups_.back().firstPort; p < ports.size(); ++p) {
        ports[p].width = CellPort::Unknown;
        if (found != types_.end()) {
            SetRange(ports[p], found->second);
        }
    }
}

} // namespace

std::vector<CellDeclaration> ReadLibertyCells(std::string_view text) {
    return LibertyReader(text).Read();
}

} // namespace Tool::Cells
