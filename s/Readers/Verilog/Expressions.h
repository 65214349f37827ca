// What a pin is connected to and what an assignment names: nets, parts of nets, constants, and
// concatenations of these.
#pragma once

#include "Readers/NetlistMaker.h"
#include "Readers/Verilog/Literals.h"
#include "Readers/Verilog/Parser.h"

#include <algorithm>
#include <cstdint>
#include <optional>
#include <string>
#include <vector>

namespace Orn_Hdl::Readers {

struct Expression {
    Place place;
    /// From left to right; empty when the expression is a number alone.
    std::vector<Piece> pieces;
    /// A number that is the whole expression, and takes the width that it gets.
    std::optional<Number> number;
    std::uint64_t width = 0;

    void Clear(const Place& begin) {
        place = begin;
        pieces.clear();
        number.reset();
        width = 0;
    }
    /// Whether no net is part of it.
    bool IsConstant() const noexcept {
        return std::all_of(pieces.begin(), pieces.end(),
                           [](const Piece& piece) { return piece.signal == nullptr; });
    }
};

class ExpressionReader {
public:
    /// \param head the module that is being read.
    ExpressionReader(Parser& parser, Scanner& scanner, NetlistMaker& maker, const ModuleHead& head)
        : parser_(parser), scanner_(scanner), maker_(maker), head_(head) {}

    /// What becomes of a name that is not declared.
    enum class Undeclared { Refuse, Declare };

    /// Reads an expression up to what cannot belong to it.
    void Read(Expression& expression, Undeclared undeclared);
    /// Reads an index or another constant integer.
    std::int64_t ReadIndex();
    /// Reads "[left:right]" if it is there.
    std::optional<Range> ReadRange();

    /// The bits of a constant expression in so many bits, leftmost first.
    std::string GetBits(const Expression& expression, std::uint64_t width);
    /// The constant of a model that a constant expression is in so many bits.
    std::string MakeConstant(const Expression& expression, std::uint64_t width, bool isBare);

private:
    void ReadPrimary();
    void ReadNet();
    void ReadConstantName(const ParameterHead& parameter, const Place& place);
    void ReadNumber(bool isWhole);
    void ReadConcatenation();
    void ReadItems();
    void Repeat(std::size_t first, std::int64_t count, const Place& place);
    void ReadSelection(Bus& bus);
    Signal* GetPart(Bus& bus, std::int64_t left, std::int64_t right, const Place& place);
    int CheckIndex(std::int64_t index, const Place& place) const;
    void Add(Signal* signal);
    void AddBits(const std::string& bits, const Place& place);
    void RefuseOperator();
    std::int64_t ReadConstant(std::string_view what);
    std::optional<std::int64_t> Resolve(std::string_view name) const;

    Parser& parser_;
    Scanner& scanner_;
    NetlistMaker& maker_;
    const ModuleHead& head_;
    Expression* expression_ = nullptr;
    Undeclared undeclared_ = Undeclared::Refuse;
    std::size_t depth_ = 0;
    /// How much repetitions have made of all expressions.
    std::uint64_t repeated_ = 0;
    std::string name_;
};

} // namespace Orn_Hdl::Readers
