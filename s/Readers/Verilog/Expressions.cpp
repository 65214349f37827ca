#include "Readers/Verilog/Expressions.h"
#include "Readers/Limits.h"

#include <utility>

namespace Orn_Hdl::Readers {

namespace {

/// How much repetitions may make of one file: a short text can ask for any number of pieces.
constexpr std::uint64_t MostRepeated = std::uint64_t(1) << 24;

constexpr std::string_view SayWhatToDo = ": synthesise the design first";

std::uint64_t WidthOf(const Signal& signal) {
    return static_cast<std::uint64_t>(signal.GetWidth());
}

} // namespace

void ExpressionReader::Read(Expression& expression, Undeclared undeclared) {
    expression_ = &expression;
    undeclared_ = undeclared;
    depth_ = 0;
    expression.Clear(parser_.Get().place);
    if (parser_.Get().kind == TokenKind::Number) {
        ReadNumber(true);
    } else {
        ReadPrimary();
    }
    RefuseOperator();
}

void ExpressionReader::RefuseOperator() {
    constexpr std::string_view Operators = "+-*/%&|^~?<>!";
    if (parser_.Get().kind == TokenKind::Sign &&
        Operators.find(parser_.Get().sign) != std::string_view::npos) {
        parser_.Fail("the operator " + parser_.Show() + " describes behaviour" +
                     std::string(SayWhatToDo));
    }
}

void ExpressionReader::ReadPrimary() {
    if (depth_ >= DeepestExpression) {
        parser_.Fail("an expression that is nested too deeply");
    }
    ++depth_;
    switch (parser_.Get().kind) {
    case TokenKind::Name:
    case TokenKind::EscapedName:
        ReadNet();
        break;
    case TokenKind::Number:
        ReadNumber(false);
        break;
    case TokenKind::String:
        parser_.Fail("a string is no value of a net");
    case TokenKind::SystemName:
        parser_.Fail("the function " + parser_.Show() + " describes behaviour" +
                     std::string(SayWhatToDo));
    default:
        if (parser_.Accept('{')) {
            ReadConcatenation();
        } else if (parser_.Accept('(')) {
            ReadPrimary();
            RefuseOperator();
            parser_.Expect(')');
        } else {
            RefuseOperator();
            parser_.FailExpected("a net or a constant");
        }
    }
    --depth_;
}

void ExpressionReader::ReadNet() {
    const Place place = parser_.Get().place;
    parser_.TakeName(name_, "name of a net");
    if (parser_.IsSign('.')) {
        parser_.Fail(place, "a name of another level of the design: a model has one level");
    }
    if (parser_.IsSign('(')) {
        parser_.Fail(place, "the function " + Quoted(name_) + " describes behaviour" +
                                std::string(SayWhatToDo));
    }
    Signal* signal = maker_.FindSignal(name_);
    if (signal == nullptr) {
        if (const ParameterHead* const parameter = head_.FindParameter(name_)) {
            ReadConstantName(*parameter, place);
            return;
        }
        if (maker_.FindInstance(name_) != nullptr) {
            parser_.Fail(place, Quoted(name_) + " is an instance and no net");
        }
        if (undeclared_ == Undeclared::Refuse || !scanner_.HasImplicitNets() ||
            parser_.IsSign('[')) {
            parser_.Fail(place, "the net " + Quoted(name_) + " is not declared");
        }
        maker_.SetPlace(place);
        signal = maker_.DeclareSignal(name_, std::nullopt);
    }
    if (!parser_.IsSign('[')) {
        Add(signal);
        return;
    }
    if (signal->GetSignalType() != SignalTypeBus) {
        parser_.Fail(place, Quoted(name_) + " is a net of one bit and has no range");
    }
    ReadSelection(static_cast<Bus&>(*signal));
}

/// A parameter in the place of a net.
void ExpressionReader::ReadConstantName(const ParameterHead& parameter, const Place& place) {
    if (!parameter.isLocal) {
        parser_.Fail(place,
                     "the parameter " + Quoted(parameter.name) +
                         " in the place of a net: a model's nets do not depend on parameters");
    }
    if (!parameter.value || parameter.value->type == Attribute::String ||
        parameter.value->type == Attribute::Float || parser_.IsSign('[')) {
        parser_.Fail(place, "the value of " + Quoted(parameter.name) + " cannot be told");
    }
    if (parameter.value->type == Attribute::Integer) {
        // Two's complement of the 32 bits that an integer has.
        const auto value = static_cast<std::uint32_t>(parameter.number.value_or(0));
        std::string bits;
        for (int bit = 32; bit-- > 0;) {
            bits += (value >> bit & 1U) != 0 ? '1' : '0';
        }
        AddBits(bits, place);
        return;
    }
    const BitVectorValue literal(parameter.value->text.c_str());
    Number number;
    number.base = literal.GetBase();
    number.size = static_cast<std::uint32_t>(literal.GetLength());
    number.digits = std::string_view(literal.GetValue());
    AddBits(number.GetBits(number.size), place);
}

void ExpressionReader::ReadNumber(bool isWhole) {
    const Place place = parser_.Get().place;
    try {
        Number number = Number::Read(parser_.Get().text, maker_.GetUnknowns());
        if (!isWhole) {
            if (number.size == 0 || number.kind != Number::Integer) {
                parser_.Fail("a constant in a concatenation needs a size");
            }
            AddBits(number.GetBits(number.size), place);
        } else {
            expression_->width = number.GetWidth();
            // Refuses what is no value of a net.
            number.GetBits(1);
            expression_->number = std::move(number);
        }
    } catch (const LiteralProblem& problem) {
        parser_.Fail(place, problem.text);
    }
    parser_.Next();
}

/// "{a, b}" or "{2{a}}", the brace being read.
void ExpressionReader::ReadConcatenation() {
    const Place place = parser_.Get().place;
    const std::size_t first = expression_->pieces.size();
    bool isRepetition = false;
    std::int64_t count = 0;
    if (parser_.Get().kind == TokenKind::Number) {
        Number number;
        try {
            number = Number::Read(parser_.Get().text, maker_.GetUnknowns());
            const std::optional<std::int64_t> value = number.GetValue();
            count = value.value_or(0);
            parser_.Next();
            isRepetition = value && parser_.IsSign('{');
            if (!parser_.IsSign('{')) {
                if (number.size == 0 || number.kind != Number::Integer) {
                    parser_.Fail(place, "a constant in a concatenation needs a size");
                }
                AddBits(number.GetBits(number.size), place);
            }
        } catch (const LiteralProblem& problem) {
            parser_.Fail(place, problem.text);
        }
    } else if (parser_.IsName()) {
        name_ = parser_.Get().text;
        if (maker_.FindSignal(name_) == nullptr && head_.FindParameter(name_) != nullptr) {
            count = ReadConstant("the number of repetitions");
            isRepetition = true;
        }
    }
    if (isRepetition) {
        parser_.Expect('{');
        ReadItems();
        Repeat(first, count, place);
        parser_.Expect('}');
        return;
    }
    if (expression_->pieces.size() == first) {
        ReadPrimary();
        RefuseOperator();
    }
    if (parser_.Accept(',')) {
        ReadItems();
    } else {
        parser_.Expect('}');
    }
}

/// Reads the items of a concatenation and the brace behind them.
void ExpressionReader::ReadItems() {
    do {
        ReadPrimary();
        RefuseOperator();
    } while (parser_.Accept(','));
    parser_.Expect('}');
}

/// Repeats the pieces from `first` on, which are there once.
void ExpressionReader::Repeat(std::size_t first, std::int64_t count, const Place& place) {
    std::vector<Piece>& pieces = expression_->pieces;
    const std::size_t once = pieces.size() - first;
    std::uint64_t width = 0;
    std::uint64_t cost = 0;
    for (std::size_t i = first; i < pieces.size(); ++i) {
        width += pieces[i].signal == nullptr ? pieces[i].bits.size() : WidthOf(*pieces[i].signal);
        cost += 1 + pieces[i].bits.size();
    }
    if (count < 1 || static_cast<std::uint64_t>(count) > MostBits ||
        expression_->width + width * static_cast<std::uint64_t>(count - 1) > MostBits) {
        parser_.Fail(place, "a repetition of so many bits: from 1 to " + std::to_string(MostBits) +
                                " can be read");
    }
    repeated_ += cost * static_cast<std::uint64_t>(count);
    if (repeated_ > MostRepeated) {
        parser_.Fail(place, "the repetitions of this module are too long in all");
    }
    expression_->width += width * static_cast<std::uint64_t>(count - 1);
    if (once == 1 && pieces.back().signal == nullptr) {
        std::string& bits = pieces.back().bits;
        const std::size_t length = bits.size();
        bits.reserve(length * static_cast<std::size_t>(count));
        for (std::int64_t i = 1; i < count; ++i) {
            bits.append(bits, 0, length);
        }
        return;
    }
    pieces.reserve(first + once * static_cast<std::size_t>(count));
    for (std::int64_t i = 1; i < count; ++i) {
        for (std::size_t k = 0; k < once; ++k) {
            pieces.push_back(pieces[first + k]);
        }
    }
}

/// "[3]", "[3:0]", "[3 -: 2]" or "[2 +: 2]" behind the name of a bus.
void ExpressionReader::ReadSelection(Bus& bus) {
    const Place place = parser_.Get().place;
    parser_.Next();
    std::int64_t left = ReadConstant("an index");
    std::int64_t right = left;
    const char sign = parser_.Get().kind == TokenKind::Sign ? parser_.Get().sign : '\0';
    const bool isCounted = sign == PlusColon || sign == MinusColon;
    const bool isPart = isCounted || sign == ':';
    if (isPart) {
        parser_.Next();
        right = ReadConstant("an index");
    }
    if (isCounted) {
        // From the lowest index on, or from the highest one down, so many bits.
        const std::int64_t low = sign == PlusColon ? left : left - right + 1;
        const std::int64_t high = low + right - 1;
        const bool isDescending = NetlistMaker::GetRange(bus).IsDescending();
        left = isDescending ? high : low;
        right = isDescending ? low : high;
    }
    if (!parser_.IsSign(']')) {
        RefuseOperator();
    }
    parser_.Expect(']');
    if (parser_.IsSign('[')) {
        parser_.Fail("a part of a part of a net, which a model cannot name");
    }
    if (isPart) {
        Add(GetPart(bus, left, right, place));
        return;
    }
    const int index = CheckIndex(left, place);
    if (!NetlistMaker::GetRange(bus).Has(index)) {
        parser_.Fail(place, "there is no bit " + std::to_string(index) + " in " +
                                Quoted(bus.GetNameView()));
    }
    Add(maker_.GetBit(bus, index));
}

Signal* ExpressionReader::GetPart(Bus& bus, std::int64_t left, std::int64_t right,
                                  const Place& place) {
    const Range range{CheckIndex(left, place), CheckIndex(right, place)};
    const Range whole = NetlistMaker::GetRange(bus);
    if (!whole.Has(range.left) || !whole.Has(range.right)) {
        parser_.Fail(place, "the part " + std::to_string(left) + ":" + std::to_string(right) +
                                " is not within " + Quoted(bus.GetNameView()));
    }
    if (range.left != range.right && range.IsDescending() != whole.IsDescending()) {
        parser_.Fail(place, "the part " + std::to_string(left) + ":" + std::to_string(right) +
                                " runs against its net " + Quoted(bus.GetNameView()));
    }
    return maker_.GetSlice(bus, range);
}

int ExpressionReader::CheckIndex(std::int64_t index, const Place& place) const {
    if (index < 0) {
        parser_.Fail(place, "the negative index " + std::to_string(index) +
                                ", which no name in a model can have");
    }
    if (index > LargestIndex) {
        parser_.Fail(place, "the index " + std::to_string(index) + " is too large");
    }
    return static_cast<int>(index);
}

std::optional<std::int64_t> ExpressionReader::Resolve(std::string_view name) const {
    const ParameterHead* const parameter = head_.FindParameter(name);
    if (parameter == nullptr) {
        return std::nullopt;
    }
    if (!parameter->isLocal) {
        parser_.Fail("this depends on the parameter " + Quoted(name) +
                     ", which a model cannot say: make it a localparam");
    }
    return parameter->number;
}

std::int64_t ExpressionReader::ReadConstant(std::string_view what) {
    const Place place = parser_.Get().place;
    const std::optional<std::int64_t> value =
        parser_.ReadInteger([this](std::string_view name) { return Resolve(name); });
    if (!value) {
        parser_.Fail(place, std::string(what) + " whose value cannot be told");
    }
    return *value;
}

std::int64_t ExpressionReader::ReadIndex() {
    return ReadConstant("an index");
}

std::optional<Range> ExpressionReader::ReadRange() {
    if (!parser_.IsSign('[')) {
        return std::nullopt;
    }
    const Place place = parser_.Get().place;
    parser_.Next();
    const std::int64_t left = ReadIndex();
    parser_.Expect(':');
    const std::int64_t right = ReadIndex();
    parser_.Expect(']');
    return Range{CheckIndex(left, place), CheckIndex(right, place)};
}

void ExpressionReader::Add(Signal* signal) {
    expression_->width += WidthOf(*signal);
    expression_->pieces.emplace_back();
    expression_->pieces.back().signal = signal;
}

/// Adds constant bits to those in front of them.
void ExpressionReader::AddBits(const std::string& bits, const Place& place) {
    expression_->width += bits.size();
    if (expression_->width > MostBits) {
        parser_.Fail(place, "a constant in a concatenation of more than " +
                                std::to_string(MostBits) + " bits");
    }
    expression_->pieces.emplace_back();
    expression_->pieces.back().bits = bits;
}

std::string ExpressionReader::GetBits(const Expression& expression, std::uint64_t width) {
    if (width > MostBits) {
        parser_.Fail(expression.place,
                     "a constant of more than " + std::to_string(MostBits) + " bits");
    }
    const auto count = static_cast<std::uint32_t>(width);
    if (expression.number) {
        try {
            return expression.number->GetBits(count);
        } catch (const LiteralProblem& problem) {
            parser_.Fail(expression.place, problem.text);
        }
    }
    std::string bits;
    for (const Piece& piece : expression.pieces) {
        bits += piece.bits;
    }
    if (bits.size() > count) {
        return bits.substr(bits.size() - count);
    }
    return bits.insert(0, count - bits.size(), '0');
}

std::string ExpressionReader::MakeConstant(const Expression& expression, std::uint64_t width,
                                           bool isBare) {
    if (width > MostBits) {
        parser_.Fail(expression.place,
                     "a constant of more than " + std::to_string(MostBits) + " bits");
    }
    const auto count = static_cast<std::uint32_t>(width);
    try {
        if (expression.number) {
            return Readers::MakeConstant(*expression.number, count, isBare);
        }
        Number number;
        number.base = 2;
        number.size = static_cast<std::uint32_t>(expression.width);
        for (const Piece& piece : expression.pieces) {
            number.digits += piece.bits;
        }
        return Readers::MakeConstant(number, count, isBare);
    } catch (const LiteralProblem& problem) {
        parser_.Fail(expression.place, problem.text);
    }
}

} // namespace Orn_Hdl::Readers
