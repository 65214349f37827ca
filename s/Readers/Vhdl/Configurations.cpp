#include "Readers/Vhdl/Configurations.h"

#include <cstddef>
#include <string>
#include <string_view>
#include <vector>

namespace Orn_Hdl::Readers::Vhdl {

namespace {

constexpr std::string_view OwnPrefix = "CFG_";

/// Reads "use entity WORK.NAME(ARCHITECTURE)" up to the semicolon.
std::string ReadBindingIndication(Parser& parser, const std::string& component) {
    parser.Next();
    const Keyword keyword = parser.GetKeyword();
    std::string name;
    if (keyword == Keyword::Open) {
        parser.Next();
        return "the binding \"open\": a model has no configuration that leaves an instance out";
    }
    if (keyword != Keyword::Entity && keyword != Keyword::Configuration) {
        parser.FailExpected("\"entity\" or \"configuration\"");
    }
    parser.Next();
    parser.TakeSelectedName(name, "name of an entity or a configuration");
    if (keyword == Keyword::Entity && parser.Accept('(')) {
        std::string architecture;
        parser.TakeName(architecture, "name of an architecture");
        parser.Expect(')');
    }
    const std::string expected =
        keyword == Keyword::Entity ? component : std::string(OwnPrefix) + component;
    if (!IsSameName(name, expected, true)) {
        return "a binding of " + Quoted(component) + " to " + Quoted(name) +
               ": a model's instances are of components by name; instantiate " + Quoted(name) +
               " instead";
    }
    if (parser.GetKeyword() == Keyword::Generic || parser.GetKeyword() == Keyword::Port) {
        return "a binding with a generic map or a port map: a model has those of instances alone";
    }
    return "";
}

/// Reads "U1, U2 : COMPONENT" or the name of a block. \return whether it is a list of instances.
/// \param labels gets the instances; null when nobody wants them.
bool ReadSpecification(Parser& parser, std::string& component,
                       std::vector<std::string>* labels = nullptr) {
    parser.Expect(Keyword::For, "for");
    do {
        if (!parser.Accept(Keyword::All) && !parser.Accept(Keyword::Others)) {
            parser.TakeName(component, "label of an instance");
            if (labels != nullptr) {
                labels->push_back(component);
            }
        }
    } while (parser.Accept(','));
    if (!parser.Accept(':')) {
        return false;
    }
    parser.TakeSelectedName(component, "name of a component");
    return true;
}

/// Reads "for ... end for;".
/// \param isOwn whether it configures the architecture itself, not one of a component.
void ReadItem(Parser& parser, Configuration& configuration, bool isOwn, std::size_t depth,
              NetlistSink* sink) {
    constexpr std::size_t Deepest = 100;
    if (depth > Deepest) {
        parser.Fail("a configuration that is nested too deeply");
    }
    std::string component;
    std::vector<std::string> labels;
    const Place begin = parser.Get().place;
    const bool isInstance =
        ReadSpecification(parser, component, sink == nullptr ? nullptr : &labels);
    if (isInstance && sink != nullptr && parser.GetKeyword() == Keyword::Use) {
        sink->TakeBinding(labels, component, begin);
    }
    if (depth == 0 && !isInstance) {
        configuration.architecture = component;
    }
    if (isInstance && parser.GetKeyword() == Keyword::Use) {
        const Place place = parser.Get().place;
        const std::string problem = ReadBindingIndication(parser, component);
        if (isOwn) {
            configuration.components.insert(KeyOf(component));
        }
        if (isOwn && configuration.problem.empty()) {
            configuration.problem = problem;
            configuration.problemPlace = place;
        }
        parser.SkipStatement();
    }
    while (!parser.Accept(Keyword::End)) {
        if (parser.GetKeyword() == Keyword::Use) {
            parser.SkipStatement();
        } else if (parser.GetKeyword() == Keyword::For) {
            ReadItem(parser, configuration, isOwn && !isInstance, depth + 1, sink);
        } else {
            parser.FailExpected("\"for\" or \"end\"");
        }
    }
    parser.Expect(Keyword::For, "for");
    parser.Expect(';');
}

} // namespace

std::string ReadBinding(Parser& parser, Place& place) {
    std::string component;
    if (!ReadSpecification(parser, component)) {
        parser.FailExpected("\":\"");
    }
    place = parser.Get().place;
    if (parser.GetKeyword() != Keyword::Use) {
        parser.FailExpected("\"use\"");
    }
    std::string problem = ReadBindingIndication(parser, component);
    parser.SkipStatement();
    if (parser.Accept(Keyword::End)) {
        parser.Expect(Keyword::For, "for");
        parser.Expect(';');
    }
    return problem;
}

Configuration ReadConfiguration(Parser& parser, NetlistSink* sink) {
    Configuration configuration;
    parser.Next();
    parser.TakeName(configuration.name, "name of a configuration");
    parser.Expect(Keyword::Of, "of");
    parser.TakeSelectedName(configuration.entity, "name of an entity");
    parser.Expect(Keyword::Is, "is");
    while (!parser.Accept(Keyword::End)) {
        const Keyword keyword = parser.GetKeyword();
        if (keyword == Keyword::Use || keyword == Keyword::Attribute || keyword == Keyword::Group) {
            parser.SkipStatement();
        } else if (keyword == Keyword::For) {
            ReadItem(parser, configuration, true, 0, sink);
        } else {
            parser.FailExpected("\"for\" or \"end\"");
        }
    }
    parser.SkipEnd(configuration.name);
    return configuration;
}

} // namespace Orn_Hdl::Readers::Vhdl
