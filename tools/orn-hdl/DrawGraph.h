// A design as a graph in the language of Graphviz.
#pragma once

#include <cstddef>
#include <cstdint>
#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

namespace Orn_Hdl {
class Instance;
class Netlist;
class Pin;
class Signal;
} // namespace Orn_Hdl

namespace Tool {

/// The picture of a design or of a part of it. Instances are boxes with their pins, inputs at the
/// left; ports are arrows; buses are thick. A net with one driver runs from it to every reader; any
/// other net has a dot, to which its drivers lead. Of nets with very many ends, such as clocks,
/// only the names are drawn, at the pins.
class Graph {
public:
    /// \param netlist not owned; it must outlive the graph and not change.
    explicit Graph(const Orn_Hdl::Netlist& netlist);

    /// How many instances are drawn.
    std::size_t CountBoxes() const noexcept;
    /// Draws only what lies around an instance or signal: the instance, or the instances at the
    /// signal, and what `depth` steps from instance to instance reach. Steps do not go along nets
    /// with very many ends.
    /// \return false when nothing of that name is wired.
    bool KeepAround(const std::string& name, int depth);
    std::string Write() const;

private:
    enum class Role { Drives, Reads, Both };
    static constexpr std::size_t NoBox = static_cast<std::size_t>(-1);

    /// A place where a net ends: a pin of a box, or a port.
    struct End {
        std::size_t box = NoBox;
        /// What Graphviz calls it.
        std::string point;
        /// What is wired there: the net or a part of it.
        const Orn_Hdl::Signal* part = nullptr;
        Role role = Role::Reads;
    };
    struct Source {
        std::size_t net = 0;
        /// The part of the net that gets it.
        const Orn_Hdl::Signal* part = nullptr;
    };
    struct Constant {
        std::string value;
        const Orn_Hdl::Signal* part = nullptr;
    };
    /// A part of a net, as it stands in a signal; `start` counts bits from the signal's left.
    struct Part {
        const Orn_Hdl::Signal* signal = nullptr;
        std::size_t net = 0;
        std::int64_t start = 0;
        std::int64_t end = 0;
    };
    struct Net {
        const Orn_Hdl::Signal* signal = nullptr;
        std::vector<End> ends;
        /// What the net gets as an alias of other nets, and from constants.
        std::vector<Source> sources;
        std::vector<Constant> constants;
        /// The nets that are aliases of this one.
        std::vector<std::size_t> aliases;
        bool drawn = true;
    };
    struct Wire {
        std::size_t pin = 0;
        std::size_t net = 0;
        const Orn_Hdl::Signal* part = nullptr;
    };
    struct Box {
        const Orn_Hdl::Instance* instance = nullptr;
        std::vector<Wire> wires;
        bool drawn = true;
    };
    /// The ends of one net, sorted for drawing.
    struct Sorted {
        std::vector<const End*> drivers;
        std::vector<const End*> readers;
        bool hasHiddenDriver = false;
        bool hasHiddenReader = false;
    };

    void AddBox(const Orn_Hdl::Instance& instance);
    void AddPort(const Orn_Hdl::Signal& signal);
    void AddSources(Orn_Hdl::Signal& signal);
    std::size_t GetOrAddNet(const Orn_Hdl::Signal& signal);
    /// Appends the parts that a signal consists of.
    void AddParts(const Orn_Hdl::Signal& signal, std::vector<Part>& parts);
    std::vector<Part> GetParts(const Orn_Hdl::Signal& signal);

    void Reach(std::size_t net, bool always, std::vector<std::size_t>& boxes);
    /// Whether a net has too many ends to be drawn as lines.
    static bool IsWide(const Net& net) noexcept;
    bool IsDrawn(const End& end) const { return end.box == NoBox || boxes_[end.box].drawn; }
    Sorted Sort(const Net& net) const;
    bool HasDot(const Net& net, const Sorted& sorted) const;
    std::string GetStart(const Net& net, const Sorted& sorted) const;

    std::string GetPinText(const Box& box, const Orn_Hdl::Pin& pin, std::size_t number) const;
    void WriteBox(std::string& text, std::size_t index) const;
    void WritePort(std::string& text, const Net& net) const;
    void WriteNet(std::string& text, const Net& net) const;
    void WriteWideNet(std::string& text, const Net& net) const;
    void WriteStub(std::string& text, const Net& net) const;
    void WriteDot(std::string& text, const Net& net, const Sorted& sorted) const;
    /// The lines from constants and from the nets whose alias this one is.
    void WriteSources(std::string& text, const Net& net, const std::string& to) const;
    void WriteLine(std::string& text, std::string_view from, std::string_view to,
                   const Orn_Hdl::Signal& part, const char* more) const;
    std::string GetNode(std::string_view kind, const Net& net) const;
    std::string GetConstantNode(const Net& net, std::size_t index) const;

    std::vector<Box> boxes_;
    std::vector<Net> nets_;
    std::unordered_map<const Orn_Hdl::Signal*, std::size_t> netIndex_;
    std::unordered_map<const Orn_Hdl::Instance*, std::size_t> boxIndex_;
    const Orn_Hdl::Netlist& netlist_;
};

} // namespace Tool
