#include "Readers/Verilog/UndeclaredReader.h"

#include "Readers/Limits.h"
#include "Readers/Verilog/Literals.h"

#include <cstdlib>
#include <utility>

namespace Orn_Hdl::Readers {

namespace {

/// Nothing for a width that no port gets from a connection.
std::optional<std::uint64_t> LimitedWidth(std::uint64_t width) {
    return width > 0 && width <= MostBits ? std::optional<std::uint64_t>(width) : std::nullopt;
}

} // namespace

void UndeclaredReader::Read() {
    SkipToModule();
    for (const PortHead& port : head_.ports) {
        if (port.range) {
            widths_[port.name] = port.range->GetWidth();
        }
    }
    scanner_.SkipToSemicolon();
    while (parser_.GetKeyword() != Keyword::Endmodule && parser_.Get().kind != TokenKind::End) {
        ReadStatement();
    }
}

void UndeclaredReader::SkipToModule() {
    parser_.Next();
    while (parser_.Get().kind != TokenKind::End) {
        if (parser_.GetKeyword() != Keyword::Module) {
            parser_.Next();
            continue;
        }
        parser_.Next();
        if (parser_.IsName() && parser_.Get().text == head_.name) {
            return;
        }
        parser_.SkipBehind("endmodule", parser_.Get().place);
    }
}

void UndeclaredReader::ReadStatement() {
    switch (parser_.GetKeyword()) {
    case Keyword::None:
        if (parser_.IsName()) {
            ReadInstances();
        } else if (parser_.Get().kind == TokenKind::AttributesBegin) {
            parser_.SkipAttributes();
        } else {
            parser_.Next();
        }
        break;
    case Keyword::Wire:
    case Keyword::Logic:
    case Keyword::Supply0:
    case Keyword::Supply1:
        ReadNets();
        break;
    case Keyword::Specify:
        parser_.SkipBehind("endspecify", parser_.Get().place);
        break;
    case Keyword::Generate:
    case Keyword::Endgenerate:
        parser_.Next();
        break;
    default:
        scanner_.SkipToSemicolon();
        break;
    }
}

/// "wire [7:0] A, B = C;"
void UndeclaredReader::ReadNets() {
    while (parser_.GetKeyword() != Keyword::None) {
        parser_.Next();
    }
    if (!parser_.Accept('[')) {
        scanner_.SkipToSemicolon();
        return;
    }
    const std::optional<std::int64_t> left = ReadInteger();
    const std::optional<std::int64_t> right =
        left && parser_.Accept(':') ? ReadInteger() : std::nullopt;
    if (!right || !parser_.Accept(']')) {
        scanner_.SkipToSemicolon();
        return;
    }
    do {
        if (parser_.IsName()) {
            widths_[std::string(parser_.Get().text)] =
                static_cast<std::uint64_t>(std::abs(*left - *right)) + 1;
        }
        parser_.SkipTo(',', ',');
    } while (parser_.Accept(','));
}

std::optional<std::int64_t> UndeclaredReader::ReadInteger() {
    return parser_.ReadInteger([this](std::string_view name) -> std::optional<std::int64_t> {
        const ParameterHead* const parameter = head_.FindParameter(name);
        return parameter == nullptr ? std::nullopt : parameter->number;
    });
}

void UndeclaredReader::ReadInstances() {
    const Place place = parser_.Get().place;
    if (lastHead_ == nullptr || parser_.Get().text != lastHead_->name) {
        name_ = parser_.Get().text;
        lastHead_ = heads_.Find(name_);
    }
    parser_.Next();
    if (lastHead_ == nullptr && (parser_.IsName() || parser_.IsSign('#') || parser_.IsSign('('))) {
        lastHead_ = heads_.Add(name_, place);
        lastHead_->isDeclared = false;
        lastHead_->hasParameters = false;
    }
    if (lastHead_ == nullptr || lastHead_->isDeclared) {
        scanner_.SkipToSemicolon();
        return;
    }
    if (parser_.Accept('#') && parser_.Accept('(')) {
        parser_.SkipTo(')', ')');
        parser_.Accept(')');
    }
    do {
        if (!ReadOneInstance(*lastHead_)) {
            scanner_.SkipToSemicolon();
            return;
        }
    } while (parser_.Accept(','));
}

/// \return false when it is not as it should be.
bool UndeclaredReader::ReadOneInstance(ModuleHead& module) {
    if (!parser_.IsName()) {
        return false;
    }
    parser_.Next();
    if (!parser_.Accept('(')) {
        return false;
    }
    std::size_t port = 0;
    while (!parser_.Accept(')')) {
        parser_.SkipAttributes();
        if (!parser_.IsSign('.')) {
            parser_.Fail("the module " + Quoted(module.name) +
                         " is not declared, and a connection by position does not name its port: a "
                         "library file has to declare it");
        }
        parser_.Next();
        if (!ReadConnection(module, port) || (!parser_.IsSign(',') && !parser_.IsSign(')'))) {
            return false;
        }
        parser_.Accept(',');
    }
    return true;
}

/// The port `name_`, which is added when it is new.
/// \param hint where it is looked for first; becomes where it is.
PortHead& UndeclaredReader::GetPort(ModuleHead& module, std::size_t& hint) {
    if (hint >= module.ports.size() || module.ports[hint].name != name_) {
        const auto [found, isNew] = indices_[&module].try_emplace(name_, module.ports.size());
        hint = found->second;
        if (isNew) {
            module.ports.emplace_back();
            module.ports.back().name = name_;
            module.ports.back().hasWidth = false;
        }
    }
    return module.ports[hint];
}

/// ".PORT(expression)" or ".PORT", the period being read.
/// \param port where the port is looked for first; becomes where the next one may be.
bool UndeclaredReader::ReadConnection(ModuleHead& module, std::size_t& port) {
    if (!parser_.IsName()) {
        return false;
    }
    name_ = parser_.Get().text;
    PortHead& head = GetPort(module, port);
    ++port;
    parser_.Next();
    std::optional<std::uint64_t> width;
    if (parser_.Accept('(')) {
        if (!head.hasWidth && !parser_.IsSign(')')) {
            depth_ = 0;
            width = ReadWidth();
        }
        parser_.SkipTo(')', ')');
        if (!parser_.Accept(')')) {
            return false;
        }
    } else {
        const auto net = widths_.find(name_);
        width = net == widths_.end() ? 1 : LimitedWidth(net->second);
    }
    if (width && !head.hasWidth) {
        head.hasWidth = true;
        if (*width > 1) {
            head.range = Range{static_cast<int>(*width - 1), 0};
        }
    }
    return true;
}

std::optional<std::uint64_t> UndeclaredReader::ReadWidth() {
    if (depth_ >= DeepestExpression) {
        return std::nullopt;
    }
    ++depth_;
    std::optional<std::uint64_t> width;
    if (parser_.IsName()) {
        width = ReadNetWidth();
    } else if (parser_.Get().kind == TokenKind::Number) {
        try {
            width = LimitedWidth(Number::Read(parser_.Get().text).size);
        } catch (const LiteralProblem&) {
            // The next walk tells.
        }
        parser_.Next();
    } else if (parser_.Accept('{')) {
        width = ReadConcatenationWidth();
    } else if (parser_.Accept('(')) {
        width = ReadWidth();
        width = parser_.Accept(')') ? width : std::nullopt;
    }
    --depth_;
    return width;
}

std::optional<std::uint64_t> UndeclaredReader::ReadNetWidth() {
    const auto net = widths_.find(parser_.Get().text);
    const std::uint64_t width = net == widths_.end() ? 1 : net->second;
    const bool isParameter =
        net == widths_.end() && head_.FindParameter(parser_.Get().text) != nullptr;
    parser_.Next();
    if (parser_.Accept('[')) {
        return ReadSelectionWidth();
    }
    return isParameter ? std::nullopt : LimitedWidth(width);
}

/// "3]", "3:0]", "3 -: 2]" or "2 +: 2]"
std::optional<std::uint64_t> UndeclaredReader::ReadSelectionWidth() {
    const std::optional<std::int64_t> left = ReadInteger();
    if (left && parser_.Accept(']')) {
        return 1;
    }
    const bool isCounted = parser_.IsSign(PlusColon) || parser_.IsSign(MinusColon);
    if (!left || (!isCounted && !parser_.IsSign(':'))) {
        return std::nullopt;
    }
    parser_.Next();
    const std::optional<std::int64_t> right = ReadInteger();
    if (!right || !parser_.Accept(']')) {
        return std::nullopt;
    }
    return LimitedWidth(
        static_cast<std::uint64_t>(isCounted ? *right : std::abs(*left - *right) + 1));
}

/// "a, b}" or "2{a}}", the first brace being read.
std::optional<std::uint64_t> UndeclaredReader::ReadConcatenationWidth() {
    std::uint64_t sum = 0;
    std::int64_t count = 1;
    bool isFirst = true;
    do {
        std::optional<std::uint64_t> width;
        if (isFirst && parser_.Get().kind == TokenKind::Number) {
            Number number;
            try {
                number = Number::Read(parser_.Get().text);
            } catch (const LiteralProblem&) {
                return std::nullopt;
            }
            parser_.Next();
            if (parser_.Accept('{')) {
                count = number.GetValue().value_or(0);
                width = ReadConcatenationWidth();
            } else {
                width = LimitedWidth(number.size);
            }
        } else {
            width = ReadWidth();
        }
        isFirst = false;
        if (!width) {
            return std::nullopt;
        }
        sum += *width;
    } while (sum <= MostBits && parser_.Accept(','));
    if (count < 1 || count > static_cast<std::int64_t>(MostBits) || sum > MostBits ||
        !parser_.Accept('}')) {
        return std::nullopt;
    }
    return LimitedWidth(sum * static_cast<std::uint64_t>(count));
}

} // namespace Orn_Hdl::Readers
