// Writes a graph in DOT, the language of Graphviz.
#pragma once

#include "draw/DesignGraph.h"

#include <string>
#include <string_view>

namespace Orn_Hdl {
class Pin;
}

namespace Tool {

/// Boxes show their pins, inputs on the left; ports are arrows; buses are thick. A net with one
/// driver is drawn from it to every load; any other net has a point to which its drivers lead. Nets
/// with very many ends, such as clocks, are drawn as names at the pins.
class DotWriter {
public:
    /// \param graph not owned; it must outlive the writer.
    explicit DotWriter(const DesignGraph& graph) noexcept : graph_(graph) {}

    /// The drawn part of the graph.
    std::string Write();

private:
    using End = DesignGraph::End;
    using Net = DesignGraph::Net;
    using Box = DesignGraph::Box;
    using SortedEnds = DesignGraph::SortedEnds;

    void WriteSettings();
    void WriteBox(std::size_t index);
    std::string GetPinText(const Box& box, const Orn_Hdl::Pin& pin, std::size_t number) const;
    void WritePort(const Net& net);
    void WriteNet(const Net& net);
    void WriteNetByName(const Net& net);
    void WriteStub(const Net& net);
    void WritePoint(const Net& net, const SortedEnds& ends);
    /// Writes the lines from constants and from the sources of a net.
    void WriteSources(const Net& net, const std::string& to);
    void WriteLine(std::string_view from, std::string_view to, const Orn_Hdl::Signal& part,
                   std::string_view more);

    /// The node, and its side, where the lines of a net begin, unless it has very many ends.
    std::string GetStart(const Net& net, const SortedEnds& ends) const;
    std::string GetEndNode(const Net& net, const End& end) const;
    std::string GetNode(std::string_view kind, const Net& net) const;
    std::string GetConstantNode(const Net& net, std::size_t index) const;

    const DesignGraph& graph_;
    std::string text_;
};

} // namespace Tool
