// What a port is connected to and what an assignment names: signals, parts of signals, literals,
// and concatenations and aggregates of these.
#pragma once

#include "Readers/NetlistMaker.h"
#include "Readers/Vhdl/Parser.h"

#include <algorithm>
#include <cstdint>
#include <map>
#include <optional>
#include <string>
#include <vector>

namespace Orn_Hdl::Readers::Vhdl {

struct Expression {
    Place place;
    /// From left to right.
    std::vector<Piece> pieces;
    std::uint64_t width = 0;
    /// Whether it is a vector, which may have one bit.
    bool isVector = false;
    /// The constant of a model with the digits of the one bit string literal that the expression
    /// is; empty for any other expression.
    std::string constant;
    /// The indices of the signal, or of the part of one, that the expression is; nothing for any
    /// other expression.
    std::optional<Range> range;

    void Clear(const Place& begin) {
        place = begin;
        pieces.clear();
        width = 0;
        isVector = false;
        constant.clear();
        range.reset();
    }
    /// Whether no signal is part of it.
    bool IsConstant() const noexcept {
        return std::all_of(pieces.begin(), pieces.end(),
                           [](const Piece& piece) { return piece.signal == nullptr; });
    }
    /// The constant of a model that a constant expression is: "1" for one bit that is no vector.
    std::string GetConstant() const;
};

/// What an expression is assigned to or associated with: the directions and indices of aggregates
/// depend on it.
struct Shape {
    /// Nothing for one bit that is no vector.
    std::optional<Range> range;

    std::uint64_t GetWidth() const noexcept { return range ? range->GetWidth() : 1; }
};

class ExpressionReader {
public:
    ExpressionReader(Parser& parser, NetlistMaker& maker, const ModuleHead& entity)
        : parser_(parser), maker_(maker), entity_(entity) {}

    /// The part of a vector that stands in parentheses behind its name.
    struct Selection {
        std::int64_t left = 0;
        std::int64_t right = 0;
        bool isSlice = false;
        bool isDescending = false;
        Place place;
    };

    /// Reads an expression up to what cannot belong to it.
    /// \param shape null when it is not known.
    void Read(Expression& expression, const Shape* shape);
    /// Reads the rest of an expression that begins with a name and a selection behind it, if there
    /// is one.
    void ReadBehind(Expression& expression, const std::string& name, const Selection* selection,
                    const Place& place);
    /// The shape of a signal, a part of one, or an aggregate.
    static Shape GetShape(const Expression& expression);
    /// Reads the parentheses behind a name.
    /// \return nothing when they hold something else than indices.
    std::optional<Selection> ReadSelection();
    /// Refuses what stands in the parentheses behind a name, which is no index.
    [[noreturn]] void RefuseIndex(const std::string& name, const Place& place) const;
    /// The range that is selected of a whole one, which has to have it.
    Range CheckSelection(const Selection& selection, const Range& whole,
                         std::string_view name) const;
    /// Refuses what makes an expression of what was read one that describes behaviour.
    void RefuseOperator() const;

    /// What a name stands for in a range.
    std::optional<std::int64_t> Resolve(std::string_view name) const;
    Parser::Resolve GetResolve() {
        return [this](std::string_view name) { return Resolve(name); };
    }

    /// "constant NAME : TYPE := VALUE;" and "alias NAME : TYPE is SIGNAL;", the token being the
    /// word behind which the name stands.
    void ReadConstant();
    void ReadAlias();
    /// Whether a name is that of a constant or an alias.
    bool IsDeclared(const std::string& name) const { return Find(name) != nullptr; }

private:
    /// A constant or an alias.
    struct Named {
        /// The number that a constant is, if it is one.
        std::optional<std::int64_t> number;
        /// The signal that an alias stands for a part of; null for a constant.
        Signal* signal = nullptr;
        /// The bits of a constant.
        std::string bits;
        /// The indices of what it stands for; nothing for one bit that is no vector.
        std::optional<Range> range;
        /// The indices of the part of the signal that an alias stands for.
        std::optional<Range> part;
    };
    /// Choices and the value of an element of an aggregate.
    struct Element {
        std::int64_t low = 0;
        std::int64_t high = 0;
        bool isOthers = false;
        bool isVector = false;
        std::size_t firstPiece = 0;
        std::size_t endPiece = 0;
        Place place;
    };

    const Named* Find(const std::string& name) const;
    bool ReadConcatenation(const Shape* shape);
    bool ReadRest(bool isVector);
    void Finish(bool isVector);
    bool ReadOperand(const Shape* shape);
    bool ReadParentheses(const Shape* shape);
    bool IsChoice() const;
    void ReadNamedElements(std::size_t first, std::size_t positional, const Shape* shape,
                           const Place& place);
    void ReadChoices(std::vector<Element>& elements);
    void PlaceElements(const std::vector<Element>& elements, std::size_t first,
                       std::size_t positional, const Shape* shape, const Place& place);
    bool ReadName(const Shape* shape);
    bool AddNamed(const std::string& name, const Selection* selection, const Place& place);
    bool AddPart(const std::string& name, Bus& bus, const Selection& first);
    bool AddConstant(const std::string& name, const Named& named, const Selection* selection,
                     const Place& place);
    bool AddAlias(const std::string& name, const Named& named, const Selection* selection,
                  const Place& place);
    void AddSignal(Signal* signal);
    void AddBits(std::string bits, const Place& place);
    void Spend(std::uint64_t cost, const Place& place);

    Parser& parser_;
    NetlistMaker& maker_;
    const ModuleHead& entity_;
    std::map<std::string, Named> named_;
    Expression* expression_ = nullptr;
    std::size_t depth_ = 0;
    /// How much aggregates have made of all expressions.
    std::uint64_t spent_ = 0;
    std::string name_;
};

} // namespace Orn_Hdl::Readers::Vhdl
