#include "Readers/Verilog/HeadReader.h"

#include "Readers/Limits.h"
#include "Readers/Verilog/Literals.h"

#include <utility>

namespace Orn_Hdl::Readers {

namespace {

int DirectionOf(Keyword keyword) {
    return keyword == Keyword::Input    ? Polarity::Input
           : keyword == Keyword::Output ? Polarity::Output
                                        : Polarity::BiDirectional;
}

} // namespace

void HeadReader::Read() {
    source_ = parser_.Get().place.file;
    parser_.Next();
    while (parser_.Get().kind != TokenKind::End) {
        parser_.SkipAttributes();
        const Place begin = parser_.Get().place;
        const Keyword keyword = parser_.GetKeyword();
        if (keyword == Keyword::Module || keyword == Keyword::Primitive) {
            ReadModule();
        } else if (parser_.IsWord("config")) {
            parser_.SkipBehind("endconfig", begin);
        } else if (!parser_.Accept(';')) {
            parser_.FailExpected("a module");
        }
    }
}

ModuleHead& HeadReader::AddHead(const std::string& name, const Place& place) {
    ModuleHead* const added = heads_.Add(name, place);
    if (added != nullptr) {
        added->source = source_;
        added->canBeTop = !isLibrary_ && place.file == 0;
        return *added;
    }
    const ModuleHead& present = *heads_.Find(name);
    if (!isLibrary_) {
        parser_.Fail(place, "the module " + Quoted(name) + " is declared already, in " +
                                TextOf(scanner_.GetFiles(), present.place));
    }
    ignored_ = ModuleHead();
    return ignored_;
}

void HeadReader::ReadModule() {
    const Place begin = parser_.Get().place;
    const bool isPrimitive = parser_.GetKeyword() == Keyword::Primitive;
    parser_.Next();
    const Place place = parser_.Get().place;
    parser_.TakeName(name_, "the name of a module");
    head_ = &AddHead(name_, place);
    used_.clear();
    lastUsed_.clear();
    if (isPrimitive) {
        head_->isPrimitive = true;
        head_->canBeTop = false;
        parser_.SkipBehind("endprimitive", begin);
        return;
    }
    scanner_.SetInModule(true);
    if (parser_.Accept('#')) {
        ReadParameterPorts();
    }
    if (parser_.Accept('(')) {
        ReadPorts();
    }
    parser_.Expect(';');
    while (parser_.GetKeyword() != Keyword::Endmodule) {
        if (parser_.Get().kind == TokenKind::End) {
            // Who reads the module finds the mistake at its own place.
            heads_.SetUnfinished(*head_, begin);
            return;
        }
        ReadStatement();
    }
    scanner_.SetInModule(false);
    parser_.Next();
}

/// "#(parameter A = 1, B = 2)", the number sign being read.
void HeadReader::ReadParameterPorts() {
    parser_.Expect('(');
    while (!parser_.Accept(')')) {
        if (parser_.Get().kind == TokenKind::End) {
            parser_.FailExpected("\")\"");
        }
        const bool isLocal = parser_.GetKeyword() == Keyword::Localparam;
        if (isLocal || parser_.GetKeyword() == Keyword::Parameter) {
            parser_.Next();
        }
        ReadParameters(isLocal, true);
        if (!parser_.Accept(',') && !parser_.IsSign(')')) {
            parser_.FailExpected("\",\" or \")\"");
        }
    }
}

/// The ports behind the parenthesis, in either style.
void HeadReader::ReadPorts() {
    if (parser_.Accept(')')) {
        return;
    }
    for (;;) {
        parser_.SkipAttributes();
        if (IsDirection(parser_.GetKeyword())) {
            ReadPortDeclaration(true);
        } else if (parser_.IsSign('.')) {
            ReadPortExpression();
        } else if (parser_.IsName()) {
            ReadPortName();
        } else {
            parser_.FailExpected("a port");
        }
        if (parser_.Accept(')')) {
            return;
        }
        parser_.Expect(',');
    }
}

void HeadReader::ReadPortName() {
    const Place place = parser_.Get().place;
    parser_.TakeName(name_, "name of a port");
    if (head_->FindPort(name_) != nullptr) {
        parser_.Fail(place, "the port " + Quoted(name_) + " is declared already");
    }
    PortHead port;
    port.name = name_;
    port.place = place;
    if (!head_->ports.empty() && Polarity::IsValidValue(head_->ports.back().direction)) {
        // One more name of a declaration.
        const PortHead& last = head_->ports.back();
        port.direction = last.direction;
        port.range = last.range;
        port.parameters = last.parameters;
        port.problem = last.problem;
    }
    SkipDefault(port);
    head_->ports.push_back(std::move(port));
}

/// Skips what may follow the name of a port in the head.
void HeadReader::SkipDefault(PortHead& port) {
    if (parser_.IsSign('[')) {
        port.problem = "an array of ports";
    }
    if (parser_.IsSign('[') || parser_.IsSign('=')) {
        parser_.SkipTo(',', ')');
    }
}

/// ".NAME(expression)": what the port is connected to inside has no name in a model.
void HeadReader::ReadPortExpression() {
    parser_.Next();
    ReadPortName();
    head_->ports.back().problem = "a port that is an expression";
    parser_.SkipTo(',', ')');
    if (parser_.IsSign(';')) {
        parser_.FailExpected("\",\" or \")\"");
    }
}

/// Skips the type of a net, and the words that may follow it.
void HeadReader::SkipNetType() {
    for (;;) {
        switch (parser_.GetKeyword()) {
        case Keyword::Wire:
        case Keyword::Supply0:
        case Keyword::Supply1:
        case Keyword::OtherNet:
        case Keyword::Logic:
        case Keyword::Reg:
        case Keyword::Signed:
        case Keyword::Vectored:
        case Keyword::Type:
            parser_.Next();
            break;
        default:
            return;
        }
    }
}

/// "input [7:0] A, B": in the head up to the next port that begins otherwise, in the body up to the
/// semicolon.
void HeadReader::ReadPortDeclaration(bool isInHead) {
    const int direction = DirectionOf(parser_.GetKeyword());
    parser_.Next();
    SkipNetType();
    PortHead model;
    model.direction = direction;
    if (parser_.IsSign('[')) {
        model.range = ReadRange(model);
    }
    for (;;) {
        const Place place = parser_.Get().place;
        parser_.TakeName(name_, "name of a port");
        PortHead* port = head_->FindPort(name_);
        if (isInHead) {
            if (port != nullptr) {
                parser_.Fail(place, "the port " + Quoted(name_) + " is declared already");
            }
            head_->ports.emplace_back();
            port = &head_->ports.back();
            port->name = name_;
        }
        if (port != nullptr) {
            const std::string problem = port->problem;
            port->direction = model.direction;
            port->place = place;
            port->range = model.range;
            port->parameters = model.parameters;
            port->problem = problem.empty() ? model.problem : problem;
            SkipDefault(*port);
        }
        if (isInHead) {
            // What follows the comma may begin another declaration.
            return;
        }
        parser_.SkipTo(',', ',');
        if (!parser_.Accept(',')) {
            return;
        }
    }
}

std::optional<Range> HeadReader::ReadRange(PortHead& port) {
    const Place place = parser_.Get().place;
    const auto resolve = [this, &port](std::string_view name) {
        return Resolve(name, &port.parameters);
    };
    parser_.Next();
    const std::optional<std::int64_t> left = parser_.ReadInteger(resolve);
    std::optional<std::int64_t> right;
    if (left && parser_.Accept(':')) {
        right = parser_.ReadInteger(resolve);
    }
    if (!right || !parser_.IsSign(']')) {
        port.problem = "a range whose value cannot be told";
    } else if (*left < 0 || *right < 0 || *left > LargestIndex || *right > LargestIndex) {
        port.problem = "a range with an index that no model has: from 0 to 2147483647 are possible";
    }
    parser_.SkipTo(']', ']');
    if (!parser_.Accept(']')) {
        parser_.Fail(place, "\"]\" does not follow this");
    }
    if (!port.problem.empty()) {
        return Range();
    }
    if (parser_.IsSign('[')) {
        port.problem = "an array of buses";
        parser_.SkipTo(',', ')');
    }
    return Range{static_cast<int>(*left), static_cast<int>(*right)};
}

std::optional<std::int64_t> HeadReader::Resolve(std::string_view name,
                                                std::vector<std::string>* used) const {
    const ParameterHead* const parameter = head_->FindParameter(name);
    if (parameter == nullptr) {
        return std::nullopt;
    }
    if (used != nullptr) {
        used->emplace_back(name);
    }
    return parameter->number;
}

void HeadReader::ReadParameters(bool isLocal, bool isInHead) {
    SkipNetType();
    if (parser_.IsSign('[')) {
        PortHead unused;
        ReadRange(unused);
    }
    for (;;) {
        ReadParameter(isLocal);
        parser_.SkipTo(',', isInHead ? ')' : ',');
        if (isInHead || !parser_.Accept(',')) {
            return;
        }
    }
}

void HeadReader::ReadParameter(bool isLocal) {
    ParameterHead parameter;
    parameter.isLocal = isLocal;
    parser_.TakeName(parameter.name, "name of a parameter");
    if (parser_.Accept('=')) {
        const TokenKind kind = parser_.Get().kind;
        if (kind == TokenKind::String) {
            parameter.value = ValueOfString(parser_.Get().text);
            parser_.Next();
        } else if (kind == TokenKind::Number || parser_.IsSign('-') || parser_.IsName() ||
                   parser_.IsSign('(')) {
            // A literal keeps its form; of an expression the value is known when it is an integer.
            const bool isNegative = parser_.Accept('-');
            std::optional<Number> number;
            try {
                if (parser_.Get().kind == TokenKind::Number) {
                    number = Number::Read(parser_.Get().text);
                    parameter.value = ValueOf(*number, isNegative);
                }
            } catch (const LiteralProblem&) {
                parameter.value.reset();
                parser_.SkipTo(',', ')');
                head_->parameters.push_back(std::move(parameter));
                return;
            }
            parameter.number = parser_.ReadInteger(
                [this](std::string_view name) { return Resolve(name, nullptr); }, isNegative);
            const bool isWhole = parser_.IsSign(',') || parser_.IsSign(')') || parser_.IsSign(';');
            const bool isLiteral =
                number && (number->kind == Number::Real || (number->size > 0 && !isNegative));
            if (!isWhole) {
                parameter.value.reset();
                parameter.number.reset();
            } else if (parameter.number && !isLiteral) {
                parameter.value = Value{Attribute::Integer, std::to_string(*parameter.number), {}};
            }
        }
    }
    head_->parameters.push_back(std::move(parameter));
}

void HeadReader::ReadStatement() {
    const Keyword keyword = parser_.GetKeyword();
    switch (keyword) {
    case Keyword::Input:
    case Keyword::Output:
    case Keyword::Inout:
        ReadPortDeclaration(false);
        break;
    case Keyword::Parameter:
    case Keyword::Localparam:
        parser_.Next();
        ReadParameters(keyword == Keyword::Localparam, false);
        break;
    case Keyword::Function:
        parser_.SkipBehind("endfunction", parser_.Get().place);
        break;
    case Keyword::Task:
        parser_.SkipBehind("endtask", parser_.Get().place);
        break;
    case Keyword::Specify:
        parser_.SkipBehind("endspecify", parser_.Get().place);
        break;
    case Keyword::Module:
    case Keyword::Primitive:
        parser_.Fail("the module " + Quoted(head_->name) + " has no \"endmodule\" before this");
    case Keyword::None:
        if (parser_.IsName()) {
            ReadUse();
        } else if (parser_.Get().kind == TokenKind::AttributesBegin) {
            parser_.SkipAttributes();
        } else {
            parser_.Next();
        }
        break;
    case Keyword::Behaviour:
    case Keyword::Generate:
    case Keyword::Endgenerate:
    case Keyword::Other:
        // Another statement may follow at once.
        parser_.Next();
        break;
    default:
        scanner_.SkipToSemicolon();
        break;
    }
}

/// Reads what may be an instantiation: a name that another one, or parameters, follow.
void HeadReader::ReadUse() {
    const Place place = parser_.Get().place;
    // Most instances are of the same few modules.
    const bool isKnown = parser_.Get().text == lastUsed_;
    if (!isKnown) {
        name_ = parser_.Get().text;
    }
    parser_.Next();
    if (!parser_.IsName() && !parser_.IsSign('#') && !parser_.IsSign('(')) {
        return;
    }
    if (!isKnown) {
        if (parser_.GetKeyword() == Keyword::None && used_.insert(name_).second) {
            head_->uses.push_back({name_, place});
        }
        lastUsed_ = name_;
    }
    scanner_.SkipToSemicolon();
}

} // namespace Orn_Hdl::Readers
