// A design as a graph: boxes, nets, and the part to draw.
#pragma once

#include <cstddef>
#include <cstdint>
#include <string>
#include <unordered_map>
#include <vector>

namespace Orn_Hdl {
class Instance;
class Netlist;
class Signal;
} // namespace Orn_Hdl

namespace Tool {

/// The bus of a slice or bit; any other signal itself.
const Orn_Hdl::Signal& GetWholeSignal(const Orn_Hdl::Signal& signal);

/// Instances are boxes; whole signals are nets, which end at pins of boxes and at ports. Slices,
/// bits and compounds are resolved into parts of nets.
class DesignGraph {
public:
    static constexpr std::size_t NoBox = static_cast<std::size_t>(-1);

    enum class Role { Drives, Reads, Both };

    /// A place where a net ends: a pin of a box, or the net's port.
    struct End {
        /// `NoBox` for the port.
        std::size_t box = NoBox;
        /// The number of the pin in its instance.
        std::size_t pin = 0;
        /// The net or the part of it that ends here.
        const Orn_Hdl::Signal* part = nullptr;
        Role role = Role::Reads;
    };
    /// Another net that drives a net or a part of it.
    struct Source {
        std::size_t net = 0;
        /// The driven part of the net.
        const Orn_Hdl::Signal* part = nullptr;
    };
    struct Constant {
        std::string value;
        /// The driving net or part of it.
        const Orn_Hdl::Signal* part = nullptr;
    };
    struct Net {
        const Orn_Hdl::Signal* signal = nullptr;
        std::vector<End> ends;
        std::vector<Source> sources;
        std::vector<Constant> constants;
        /// The nets that have this one as a source.
        std::vector<std::size_t> aliases;
        bool drawn = true;
    };
    struct Wire {
        /// The number of the pin in its instance.
        std::size_t pin = 0;
        std::size_t net = 0;
        /// The net or the part of it that is connected to the pin.
        const Orn_Hdl::Signal* part = nullptr;
    };
    struct Box {
        const Orn_Hdl::Instance* instance = nullptr;
        /// In the order of the pins.
        std::vector<Wire> wires;
        bool drawn = true;
    };
    /// The ends of one net by their roles.
    struct SortedEnds {
        std::vector<const End*> drivers;
        std::vector<const End*> readers;
        /// Whether boxes that are not drawn drive or read the net.
        bool hasHiddenDriver = false;
        bool hasHiddenReader = false;
    };

    /// \param netlist not owned; it must outlive the graph and not change.
    explicit DesignGraph(const Orn_Hdl::Netlist& netlist);

    const std::vector<Box>& GetBoxes() const noexcept { return boxes_; }
    const std::vector<Net>& GetNets() const noexcept { return nets_; }
    /// The number of boxes that are drawn.
    std::size_t CountDrawnBoxes() const noexcept;

    /// Draws only the surroundings of an instance or signal: the instance, or the instances at the
    /// signal, and the instances within `depth` steps along nets. Nets with very many ends are not
    /// followed.
    /// \return false if there is no instance and no signal of that name.
    bool KeepAround(const std::string& name, int depth);

    /// Whether a net has too many ends to be drawn as lines.
    static bool HasManyEnds(const Net& net) noexcept;
    SortedEnds SortEnds(const Net& net) const;
    /// Whether the lines of a net meet in a point, because no single end drives the whole net.
    static bool NeedsPoint(const Net& net, const SortedEnds& ends);

private:
    /// A part of a net that is a piece of a signal, from bit `start` to before bit `end`, counted
    /// from the signal's left.
    struct Piece {
        const Orn_Hdl::Signal* signal = nullptr;
        std::size_t net = 0;
        std::int64_t start = 0;
        std::int64_t end = 0;
    };

    void AddBox(const Orn_Hdl::Instance& instance);
    void AddPort(const Orn_Hdl::Signal& signal);
    void AddSources(Orn_Hdl::Signal& signal);
    void AddSource(const std::vector<Piece>& to, const std::vector<Piece>& from);
    std::size_t GetOrAddNet(const Orn_Hdl::Signal& signal);
    std::vector<Piece> GetPieces(const Orn_Hdl::Signal& signal);
    void AddPieces(const Orn_Hdl::Signal& signal, std::vector<Piece>& pieces);

    /// Draws a net and its aliases, and appends the boxes that it reaches to `boxes`.
    /// \param always draws a net with very many ends, too.
    void Reach(std::size_t net, bool always, std::vector<std::size_t>& boxes);
    bool IsDrawn(const End& end) const { return end.box == NoBox || boxes_[end.box].drawn; }

    std::vector<Box> boxes_;
    std::vector<Net> nets_;
    std::unordered_map<const Orn_Hdl::Signal*, std::size_t> netIndex_;
    std::unordered_map<const Orn_Hdl::Instance*, std::size_t> boxIndex_;
    const Orn_Hdl::Netlist& netlist_;
};

} // namespace Tool
