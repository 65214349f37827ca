#include "Readers/Vhdl/Expressions.h"

#include "Readers/Limits.h"
#include "Readers/Vhdl/Attributes.h"
#include "Readers/Vhdl/Literals.h"
#include "Readers/Vhdl/Types.h"

#include <cstdlib>
#include <limits>
#include <utility>

namespace Orn_Hdl::Readers::Vhdl {

namespace {

/// How much aggregates may make of one file: a short text can ask for any number of pieces.
constexpr std::uint64_t MostSpent = std::uint64_t(1) << 24;

std::uint64_t WidthOf(const Signal& signal) {
    return static_cast<std::uint64_t>(signal.GetWidth());
}

/// How many places an index stands behind the leftmost one of a range.
std::int64_t PositionOf(std::int64_t index, const Range& range) {
    return std::abs(index - range.left);
}

/// The index that stands so many places behind the leftmost one of a range.
int IndexAt(std::int64_t position, const Range& range) {
    return static_cast<int>(range.IsDescending() ? range.left - position : range.left + position);
}

} // namespace

std::string Expression::GetConstant() const {
    if (!constant.empty()) {
        return constant;
    }
    std::string bits;
    for (const Piece& piece : pieces) {
        bits += piece.bits;
    }
    return MakeConstant(bits, !isVector);
}

void ExpressionReader::Read(Expression& expression, const Shape* shape) {
    expression_ = &expression;
    depth_ = 0;
    expression.Clear(parser_.Get().place);
    Finish(ReadConcatenation(shape));
}

void ExpressionReader::ReadBehind(Expression& expression, const std::string& name,
                                  const Selection* selection, const Place& place) {
    expression_ = &expression;
    depth_ = 0;
    expression.Clear(place);
    Finish(ReadRest(AddNamed(name, selection, place)));
}

void ExpressionReader::Finish(bool isVector) {
    expression_->isVector = isVector;
    if (expression_->pieces.size() != 1) {
        expression_->constant.clear();
        expression_->range.reset();
    }
    RefuseOperator();
}

Shape ExpressionReader::GetShape(const Expression& expression) {
    if (!expression.isVector || expression.range) {
        return Shape{expression.range};
    }
    const std::uint64_t last = std::min(expression.width, MostBits) - 1;
    return Shape{Range{0, static_cast<int>(last)}};
}

void ExpressionReader::RefuseOperator() const {
    constexpr std::string_view Operators = "+-*/=<>";
    const Token& token = parser_.Get();
    const Keyword keyword = parser_.GetKeyword();
    if (keyword == Keyword::Operator || keyword == Keyword::When ||
        (token.kind == TokenKind::Sign &&
         (token.sign == OtherOperator || Operators.find(token.sign) != std::string_view::npos))) {
        parser_.Fail(parser_.Show() + std::string(SynthesiseFirst));
    }
}

/// Reads operands and "&" between them. \return whether they are a vector.
bool ExpressionReader::ReadConcatenation(const Shape* shape) {
    return ReadRest(ReadOperand(shape));
}

/// Reads what follows the first operand of a concatenation.
bool ExpressionReader::ReadRest(bool isVector) {
    while (parser_.Accept('&')) {
        isVector = true;
        ReadOperand(nullptr);
    }
    return isVector;
}

bool ExpressionReader::ReadOperand(const Shape* shape) {
    const Token& token = parser_.Get();
    const Place place = token.place;
    bool isVector = true;
    try {
        switch (token.kind) {
        case TokenKind::Name:
        case TokenKind::ExtendedName:
            RefuseOperator();
            return ReadName(shape);
        case TokenKind::Character:
            AddBits(std::string(1, ReadBit(token.text.front(), maker_.GetUnknowns())), place);
            isVector = false;
            break;
        case TokenKind::String:
            AddBits(ReadBits(token.text, maker_.GetUnknowns()), place);
            break;
        case TokenKind::BitString: {
            BitString literal = BitString::Read(token.text);
            AddBits(std::move(literal.bits), place);
            expression_->constant = std::move(literal.constant);
            break;
        }
        case TokenKind::Number:
            parser_.Fail("a number is no value of a signal");
        default:
            if (parser_.IsSign('(')) {
                return ReadParentheses(shape);
            }
            RefuseOperator();
            parser_.FailExpected("a signal or a literal");
        }
    } catch (const LiteralProblem& problem) {
        parser_.Fail(place, problem.text);
    }
    parser_.Next();
    return isVector;
}

/// Reads an expression in parentheses or an aggregate.
bool ExpressionReader::ReadParentheses(const Shape* shape) {
    const Place place = parser_.Get().place;
    if (depth_ >= DeepestExpression) {
        parser_.Fail("an expression that is nested too deeply");
    }
    ++depth_;
    parser_.Next();
    const std::size_t first = expression_->pieces.size();
    const std::uint64_t width = expression_->width;
    bool isVector = true;
    if (!IsChoice()) {
        isVector = ReadConcatenation(nullptr);
        RefuseOperator();
    }
    if (!isVector || !parser_.IsSign(')')) {
        bool isPlain = true;
        while (parser_.Accept(',')) {
            isPlain = false;
            if (IsChoice()) {
                break;
            }
            ReadConcatenation(nullptr);
            RefuseOperator();
        }
        if (IsChoice()) {
            isPlain = false;
            ReadNamedElements(first, static_cast<std::size_t>(expression_->width - width), shape,
                              place);
        }
        isVector = isVector || !isPlain;
    }
    parser_.Expect(')');
    --depth_;
    return isVector;
}

/// Whether an element of an aggregate begins with its choices here.
bool ExpressionReader::IsChoice() const {
    if (parser_.Get().kind == TokenKind::Number || parser_.GetKeyword() == Keyword::Others) {
        return true;
    }
    return parser_.IsName() && parser_.GetKeyword() == Keyword::None &&
           Resolve(parser_.Get().text).has_value();
}

/// "3 => A, 2 downto 1 => '0', others => B"
/// \param first the first piece of the aggregate.
/// \param positional how many bits in front have no choices.
void ExpressionReader::ReadNamedElements(std::size_t first, std::size_t positional,
                                         const Shape* shape, const Place& place) {
    std::vector<Element> elements;
    do {
        if (!elements.empty() && elements.back().isOthers) {
            parser_.Fail("an element behind \"others\"");
        }
        const std::size_t firstElement = elements.size();
        const std::size_t firstPiece = expression_->pieces.size();
        ReadChoices(elements);
        const bool isVector = ReadConcatenation(nullptr);
        RefuseOperator();
        for (std::size_t i = firstElement; i < elements.size(); ++i) {
            elements[i].firstPiece = firstPiece;
            elements[i].endPiece = expression_->pieces.size();
            elements[i].isVector = isVector;
        }
    } while (parser_.Accept(','));
    PlaceElements(elements, first, positional, shape, place);
}

/// Reads the choices of an element and the arrow behind them.
void ExpressionReader::ReadChoices(std::vector<Element>& elements) {
    constexpr std::size_t MostElements = MostBits;
    do {
        Element element;
        element.place = parser_.Get().place;
        if (parser_.Accept(Keyword::Others)) {
            element.isOthers = true;
        } else {
            const std::optional<std::int64_t> left = parser_.ReadInteger(GetResolve());
            std::optional<std::int64_t> right = left;
            const Keyword keyword = parser_.GetKeyword();
            if (left && (keyword == Keyword::To || keyword == Keyword::Downto)) {
                parser_.Next();
                right = parser_.ReadInteger(GetResolve());
            }
            if (!left || !right) {
                parser_.Fail(element.place, "an index whose value cannot be told");
            }
            element.low = std::min(*left, *right);
            element.high = std::max(*left, *right);
        }
        if (elements.size() >= MostElements) {
            parser_.Fail("an aggregate with too many elements");
        }
        elements.push_back(element);
    } while (parser_.Accept('|'));
    parser_.Expect(Arrow);
}

/// Puts the elements of an aggregate in their places, from left to right.
void ExpressionReader::PlaceElements(const std::vector<Element>& elements, std::size_t first,
                                     std::size_t positional, const Shape* shape,
                                     const Place& place) {
    const bool hasOthers = elements.back().isOthers;
    const bool isShaped = shape != nullptr && shape->range.has_value();
    if (positional > 0 && (elements.size() > 1 || !hasOthers)) {
        parser_.Fail(place, "elements with and without choices in one aggregate");
    }
    if (hasOthers && !isShaped) {
        parser_.Fail(elements.back().place,
                     "\"others\" where nothing says how many bits there are");
    }
    Range whole{0, 0};
    if (hasOthers) {
        whole = *shape->range;
    } else {
        std::int64_t low = elements.front().low;
        std::int64_t high = elements.front().high;
        for (const Element& element : elements) {
            low = std::min(low, element.low);
            high = std::max(high, element.high);
        }
        if (low < 0 || high > LargestIndex) {
            parser_.Fail(place, "an aggregate with an index that no model has");
        }
        whole = Range{static_cast<int>(low), static_cast<int>(high)};
        if (isShaped && shape->range->IsDescending()) {
            std::swap(whole.left, whole.right);
        }
    }
    const std::uint64_t width = whole.GetWidth();
    if (width > MostBits) {
        parser_.Fail(place, "an aggregate of more than " + std::to_string(MostBits) + " bits");
    }
    Spend(width + elements.size(), place);
    constexpr std::size_t None = std::numeric_limits<std::size_t>::max();
    std::vector<std::size_t> owners(static_cast<std::size_t>(width), None);
    const std::size_t none = elements.size();
    for (std::size_t i = 0; i < elements.size(); ++i) {
        const Element& element = elements[i];
        if (element.isOthers) {
            continue;
        }
        if (!whole.Has(element.low) || !whole.Has(element.high)) {
            parser_.Fail(element.place, "an index that is not within the aggregate");
        }
        const std::int64_t begin =
            std::min(PositionOf(element.low, whole), PositionOf(element.high, whole));
        const std::int64_t count = element.high - element.low + 1;
        for (std::int64_t k = 0; k < count; ++k) {
            std::size_t& owner = owners[static_cast<std::size_t>(begin + k)];
            if (owner != None) {
                parser_.Fail(element.place, "an index that another choice has already");
            }
            // The rest of a vector belongs to its first bit.
            owner = element.isVector && k > 0 ? none : i;
        }
    }
    std::vector<Piece>& pieces = expression_->pieces;
    std::vector<Piece> placed(pieces.begin() + static_cast<std::ptrdiff_t>(first),
                              pieces.begin() +
                                  static_cast<std::ptrdiff_t>(elements.front().firstPiece));
    std::uint64_t placedWidth = positional;
    for (std::size_t position = positional; position < owners.size(); ++position) {
        const std::size_t owner = owners[position];
        if (owner == none && none != None) {
            continue;
        }
        if (owner == None && !hasOthers) {
            parser_.Fail(place, "an aggregate without a value for each index");
        }
        const Element& element = owner == None ? elements.back() : elements[owner];
        std::uint64_t elementWidth = 0;
        for (std::size_t i = element.firstPiece; i < element.endPiece; ++i) {
            const Piece& piece = pieces[i];
            elementWidth += piece.signal == nullptr ? piece.bits.size() : WidthOf(*piece.signal);
            if (piece.signal == nullptr && !placed.empty() && placed.back().signal == nullptr) {
                placed.back().bits += piece.bits;
            } else {
                placed.push_back(piece);
            }
        }
        const std::uint64_t wanted =
            element.isVector && !element.isOthers
                ? static_cast<std::uint64_t>(element.high - element.low + 1)
                : 1;
        if (elementWidth != wanted) {
            parser_.Fail(element.place, "an element of " + std::to_string(elementWidth) +
                                            " bits for " + std::to_string(wanted));
        }
        placedWidth += elementWidth;
    }
    if (positional > owners.size()) {
        parser_.Fail(place, "an aggregate of too many bits");
    }
    std::uint64_t former = 0;
    for (std::size_t i = 0; i < first; ++i) {
        former += pieces[i].signal == nullptr ? pieces[i].bits.size() : WidthOf(*pieces[i].signal);
    }
    pieces.resize(first);
    pieces.insert(pieces.end(), placed.begin(), placed.end());
    expression_->width = former + placedWidth;
    expression_->constant.clear();
}

/// Limits what aggregates make of one file.
void ExpressionReader::Spend(std::uint64_t cost, const Place& place) {
    spent_ += cost;
    if (spent_ > MostSpent) {
        parser_.Fail(place, "the aggregates of this architecture are too long in all");
    }
}

const ExpressionReader::Named* ExpressionReader::Find(const std::string& name) const {
    if (named_.empty()) {
        return nullptr;
    }
    const auto found = named_.find(KeyOf(name));
    return found == named_.end() ? nullptr : &found->second;
}

bool ExpressionReader::ReadName(const Shape* shape) {
    const Place place = parser_.Get().place;
    std::string name;
    name.swap(name_);
    parser_.TakeName(name, "name of a signal");
    if (parser_.IsSign('.')) {
        parser_.Fail(place, "a name of another design unit: a model has one level");
    }
    const bool isType = (IsVectorType(name) || IsBitType(name)) &&
                        (parser_.IsSign('(') || parser_.IsSign('\'')) &&
                        maker_.FindSignal(name) == nullptr;
    if (parser_.IsSign('\'')) {
        parser_.Next();
        if (!isType || !parser_.IsSign('(')) {
            parser_.Fail(place, "an attribute of " + Quoted(name) + " as a value");
        }
    }
    if (isType) {
        // A conversion or a qualified expression.
        ReadParentheses(shape);
        return IsVectorType(name);
    }
    std::optional<Selection> selection;
    if (parser_.IsSign('(')) {
        selection = ReadSelection();
        if (!selection) {
            RefuseIndex(name, place);
        }
    }
    const bool isVector = AddNamed(name, selection ? &*selection : nullptr, place);
    name_.swap(name);
    return isVector;
}

void ExpressionReader::RefuseIndex(const std::string& name, const Place& place) const {
    if (maker_.FindSignal(name) != nullptr || IsDeclared(name)) {
        parser_.Fail(place, "an index of " + Quoted(name) + " whose value cannot be told");
    }
    parser_.Fail(place, "the function " + Quoted(name) + std::string(SynthesiseFirst));
}

std::optional<ExpressionReader::Selection> ExpressionReader::ReadSelection() {
    Selection selection;
    selection.place = parser_.Get().place;
    parser_.Next();
    const std::optional<std::int64_t> left = parser_.ReadInteger(GetResolve());
    if (!left) {
        return std::nullopt;
    }
    selection.left = *left;
    selection.right = *left;
    const Keyword keyword = parser_.GetKeyword();
    if (keyword == Keyword::To || keyword == Keyword::Downto) {
        selection.isSlice = true;
        selection.isDescending = keyword == Keyword::Downto;
        parser_.Next();
        const std::optional<std::int64_t> right = parser_.ReadInteger(GetResolve());
        if (!right) {
            parser_.Fail(selection.place, "an index whose value cannot be told");
        }
        selection.right = *right;
    }
    if (!parser_.IsSign(')')) {
        return std::nullopt;
    }
    parser_.Next();
    return selection;
}

Range ExpressionReader::CheckSelection(const Selection& selection, const Range& whole,
                                       std::string_view name) const {
    const std::string text = selection.isSlice
                                 ? "the part " + std::to_string(selection.left) +
                                       (selection.isDescending ? " downto " : " to ") +
                                       std::to_string(selection.right)
                                 : "the bit " + std::to_string(selection.left);
    if (selection.left < 0 || selection.right < 0) {
        parser_.Fail(selection.place, text + " with a negative index, which no name in a model "
                                             "can have");
    }
    if (!whole.Has(selection.left) || !whole.Has(selection.right)) {
        parser_.Fail(selection.place, text + " is not within " + Quoted(name));
    }
    if (selection.isSlice) {
        if (whole.GetWidth() > 1 && selection.isDescending != whole.IsDescending()) {
            parser_.Fail(selection.place, text + " runs against its signal " + Quoted(name));
        }
        if (selection.isDescending ? selection.left < selection.right
                                   : selection.left > selection.right) {
            parser_.Fail(selection.place, text + " has no bits");
        }
    }
    return Range{static_cast<int>(selection.left), static_cast<int>(selection.right)};
}

/// Adds what a name stands for. \return whether it is a vector.
bool ExpressionReader::AddNamed(const std::string& name, const Selection* selection,
                                const Place& place) {
    Signal* const signal = maker_.FindSignal(name);
    if (signal == nullptr) {
        const Named* const named = Find(name);
        if (named == nullptr) {
            if (selection != nullptr) {
                parser_.Fail(place, "the function " + Quoted(name) + std::string(SynthesiseFirst));
            }
            if (entity_.FindParameter(name) != nullptr) {
                parser_.Fail(place, "the generic " + Quoted(name) +
                                        " in the place of a signal: a model's signals do not "
                                        "depend on generics");
            }
            parser_.Fail(place, "the signal " + Quoted(name) + " is not declared");
        }
        return named->signal == nullptr ? AddConstant(name, *named, selection, place)
                                        : AddAlias(name, *named, selection, place);
    }
    const bool isBus = signal->GetSignalType() == SignalTypeBus;
    if (selection == nullptr) {
        AddSignal(signal);
        if (isBus) {
            expression_->range = NetlistMaker::GetRange(static_cast<const Bus&>(*signal));
        }
        return isBus;
    }
    if (!isBus) {
        parser_.Fail(place, Quoted(name) + " is a signal of one bit and has no range");
    }
    return AddPart(name, static_cast<Bus&>(*signal), *selection);
}

/// Adds a part of a bus. \return whether it is a vector.
bool ExpressionReader::AddPart(const std::string& name, Bus& bus, const Selection& first) {
    Range range = NetlistMaker::GetRange(bus);
    std::optional<Selection> selection = first;
    for (;;) {
        range = CheckSelection(*selection, range, name);
        if (!selection->isSlice) {
            AddSignal(maker_.GetBit(bus, range.left));
            return false;
        }
        if (!parser_.IsSign('(')) {
            AddSignal(maker_.GetSlice(bus, range));
            expression_->range = range;
            return true;
        }
        const Place place = parser_.Get().place;
        selection = ReadSelection();
        if (!selection) {
            parser_.Fail(place, "an index whose value cannot be told");
        }
    }
}

bool ExpressionReader::AddConstant(const std::string& name, const Named& named,
                                   const Selection* selection, const Place& place) {
    if (named.bits.empty()) {
        parser_.Fail(place, "the value of " + Quoted(name) + " as bits cannot be told");
    }
    if (selection == nullptr) {
        AddBits(named.bits, place);
        return named.range.has_value();
    }
    if (!named.range) {
        parser_.Fail(place, Quoted(name) + " is a constant of one bit and has no range");
    }
    const Range range = CheckSelection(*selection, *named.range, name);
    const auto begin = static_cast<std::size_t>(PositionOf(range.left, *named.range));
    AddBits(named.bits.substr(begin, static_cast<std::size_t>(range.GetWidth())), place);
    return selection->isSlice;
}

bool ExpressionReader::AddAlias(const std::string& name, const Named& named,
                                const Selection* selection, const Place& place) {
    if (!named.part) {
        if (selection != nullptr) {
            parser_.Fail(place, Quoted(name) + " is a signal of one bit and has no range");
        }
        AddSignal(named.signal);
        return false;
    }
    auto& bus = static_cast<Bus&>(*named.signal);
    if (!named.range) {
        if (selection != nullptr) {
            parser_.Fail(place, Quoted(name) + " is a signal of one bit and has no range");
        }
        AddSignal(maker_.GetBit(bus, named.part->left));
        return false;
    }
    if (selection == nullptr) {
        AddSignal(maker_.GetSlice(bus, *named.part));
        expression_->range = named.range;
        return true;
    }
    const Range range = CheckSelection(*selection, *named.range, name);
    const int left = IndexAt(PositionOf(range.left, *named.range), *named.part);
    const int right = IndexAt(PositionOf(range.right, *named.range), *named.part);
    AddSignal(selection->isSlice ? maker_.GetSlice(bus, Range{left, right})
                                 : maker_.GetBit(bus, left));
    return selection->isSlice;
}

void ExpressionReader::AddSignal(Signal* signal) {
    expression_->width += WidthOf(*signal);
    expression_->pieces.emplace_back();
    expression_->pieces.back().signal = signal;
}

/// Adds constant bits to what is in front of them.
void ExpressionReader::AddBits(std::string bits, const Place& place) {
    expression_->width += bits.size();
    expression_->constant.clear();
    if (expression_->width > MostBits) {
        parser_.Fail(place, "a constant in an expression of more than " + std::to_string(MostBits) +
                                " bits");
    }
    Spend(bits.size() / 64, place);
    if (!bits.empty()) {
        expression_->pieces.emplace_back();
        expression_->pieces.back().bits = std::move(bits);
    }
}

std::optional<std::int64_t> ExpressionReader::Resolve(std::string_view name) const {
    const Named* const named = Find(std::string(name));
    if (named != nullptr && named->number) {
        return named->number;
    }
    if (named == nullptr && entity_.FindParameter(name) != nullptr &&
        maker_.FindSignal(std::string(name)) == nullptr) {
        parser_.Fail("this depends on the generic " + Quoted(name) +
                     ", which a model cannot say: make it a constant");
    }
    return std::nullopt;
}

void ExpressionReader::ReadConstant() {
    std::vector<std::string> names;
    do {
        names.emplace_back();
        const Place place = parser_.Get().place;
        parser_.TakeName(names.back(), "name of a constant");
        if (Find(names.back()) != nullptr || maker_.FindSignal(names.back()) != nullptr) {
            parser_.Fail(place, Quoted(names.back()) + " is declared already");
        }
    } while (parser_.Accept(','));
    parser_.Expect(':');
    const std::string typeName(parser_.Get().text);
    const bool isVector = IsVectorType(typeName);
    Named named;
    if (isVector || IsBitType(typeName)) {
        const SignalType type = ReadSignalType(parser_, GetResolve());
        parser_.Expect(Becomes);
        const Shape shape{type.range};
        Expression value;
        const bool hasShape = type.problem.empty();
        Read(value, hasShape ? &shape : nullptr);
        if (!value.IsConstant()) {
            parser_.Fail(value.place, "a signal in the value of a constant");
        }
        if (value.isVector != isVector || (hasShape && value.width != shape.GetWidth())) {
            parser_.Fail(value.place, std::to_string(value.width) +
                                          " bits as the value of a constant of another type");
        }
        for (const Piece& piece : value.pieces) {
            named.bits += piece.bits;
        }
        named.range = type.range;
        if (isVector && !hasShape && value.width > 0) {
            named.range = Range{0, static_cast<int>(value.width - 1)};
        }
    } else {
        ReadTypeName(parser_, ';', ';');
        parser_.Expect(Becomes);
        named.number = parser_.ReadInteger(GetResolve());
        if (!parser_.IsSign(';')) {
            // What is no number matters only where it is used.
            named.number.reset();
            parser_.SkipTo(';', ';');
        }
    }
    for (const std::string& name : names) {
        named_[KeyOf(name)] = named;
    }
    parser_.Expect(';');
}

void ExpressionReader::ReadAlias() {
    const Place place = parser_.Get().place;
    std::string alias;
    parser_.TakeName(alias, "name of an alias");
    if (Find(alias) != nullptr || maker_.FindSignal(alias) != nullptr) {
        parser_.Fail(place, Quoted(alias) + " is declared already");
    }
    SignalType type;
    const bool hasType = parser_.Accept(':');
    if (hasType) {
        type = ReadSignalType(parser_, GetResolve());
    }
    parser_.Expect(Keyword::Is, "is");
    const Place objectPlace = parser_.Get().place;
    std::string object;
    parser_.TakeName(object, "name of a signal");
    std::optional<Selection> selection;
    if (parser_.IsSign('(')) {
        selection = ReadSelection();
    }
    Signal* const signal = maker_.FindSignal(object);
    if (signal == nullptr || !parser_.IsSign(';')) {
        parser_.Fail(objectPlace, "an alias of something else than a signal or a part of one");
    }
    Named named;
    named.signal = signal;
    if (signal->GetSignalType() == SignalTypeBus) {
        const Range whole = NetlistMaker::GetRange(static_cast<const Bus&>(*signal));
        named.part = selection ? CheckSelection(*selection, whole, object) : whole;
        if (!selection || selection->isSlice) {
            named.range = hasType && type.range ? type.range : named.part;
        }
    } else if (selection) {
        parser_.Fail(objectPlace, Quoted(object) + " is a signal of one bit and has no range");
    }
    const bool isOfType = !hasType || type.range.has_value() == named.range.has_value() ||
                          (named.range && !type.range && !type.problem.empty());
    if (!isOfType || (named.range && named.range->GetWidth() != named.part->GetWidth())) {
        parser_.Fail(objectPlace, "an alias of another type than that of its signal");
    }
    named_[KeyOf(alias)] = std::move(named);
    parser_.Expect(';');
}

} // namespace Orn_Hdl::Readers::Vhdl
