// Port maps: what the pins of instances are connected to.
#pragma once

#include "Readers/Vhdl/Expressions.h"

#include <cstddef>
#include <optional>
#include <string>
#include <vector>

namespace Orn_Hdl::Readers::Vhdl {

class PortMapReader {
public:
    PortMapReader(Parser& parser, NetlistMaker& maker, ExpressionReader& expressions)
        : parser_(parser), maker_(maker), expressions_(expressions) {}

    /// Reads "port map (A, B => C)", the token being "port".
    void Read(const ModuleHead& head, Instance& instance);

private:
    using Selection = ExpressionReader::Selection;

    /// What is connected to a part of a port.
    struct Part {
        Range range;
        std::vector<Piece> pieces;
        Place place;
    };

    void ReadAssociation();
    void ReadByName(const std::optional<Selection>& selection, const Place& place);
    void ReadPart(const Selection& selection, const Place& place);
    void ReadByPosition(bool hasName, const std::optional<Selection>& selection,
                        const Place& place);
    void BeginPort(std::size_t port, const Place& place);
    void EndPort();
    void CheckWidth(std::uint64_t width, bool isVector) const;
    void Connect();

    Parser& parser_;
    NetlistMaker& maker_;
    ExpressionReader& expressions_;
    const ModuleHead* head_ = nullptr;
    const Instance* instance_ = nullptr;
    std::vector<Pin*> pins_;
    std::vector<bool> isConnected_;
    /// The port that is being connected.
    std::size_t port_ = 0;
    /// Where the next port is looked for first.
    std::size_t next_ = 0;
    bool hasNames_ = false;
    std::vector<Part> parts_;
    Expression value_;
    /// The name that an association begins with.
    std::string name_;
};

} // namespace Orn_Hdl::Readers::Vhdl
