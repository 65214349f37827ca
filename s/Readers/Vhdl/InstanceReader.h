// Instances of components and entities.
#pragma once

#include "Readers/Vhdl/Attributes.h"
#include "Readers/Vhdl/Expressions.h"
#include "Readers/Vhdl/Notes.h"
#include "Readers/Vhdl/PortMapReader.h"

#include <map>
#include <string>
#include <vector>

namespace Orn_Hdl::Readers::Vhdl {

class InstanceReader {
public:
    InstanceReader(Parser& parser, NetlistMaker& maker, Notes& notes, ExpressionReader& expressions,
                   AttributeReader& attributes, const Design& design,
                   const Architecture& architecture, const ModuleHead& entity)
        : parser_(parser), maker_(maker), notes_(notes), expressions_(expressions),
          attributes_(attributes), design_(design), architecture_(architecture), entity_(entity),
          portMap_(parser, maker, expressions) {}

    /// Makes the components of the architecture before anything else, so that their names stay what
    /// they are.
    void MakeComponents();

    /// Reads an instance behind its label and the colon; the semicolon is left.
    void Read(const std::string& label, const Place& place);
    /// Reads the rest of an instance of a component whose name is read.
    void ReadBehind(const std::string& label, const Place& place, const std::string& component,
                    const Place& componentPlace);

    /// Whether an instance names an entity.
    bool HasEntities() const noexcept { return hasEntities_; }

private:
    /// What a generic map says.
    struct Generic {
        std::string name;
        Value value;
        Place place;
        bool isHidden = false;
    };

    ModuleHead* FindHead(const Architecture::Use& use) const;
    std::string GetOtherMissing(const std::string& name) const;
    void MakeComponent(ModuleHead& head, const Place& place);
    void ReadEntity(const std::string& label, const Place& place);
    void ReadConfiguration(const std::string& label, const Place& place);
    void ReadInstance(const std::string& label, const Place& place, ModuleHead& head);
    void ReadGenericMap(ModuleHead& head, Instance& instance);
    Value ReadGenericValue(const std::string& generic, const ParameterHead* parameter);
    void SetGeneric(const ModuleHead& head, Instance& instance, const Generic& generic);
    void GiveGeneric(Instance& instance, const Generic& generic) const;
    void GiveInherited(Instance& instance);
    bool IsInOrder(const Component& component) const;

    Parser& parser_;
    NetlistMaker& maker_;
    Notes& notes_;
    ExpressionReader& expressions_;
    AttributeReader& attributes_;
    const Design& design_;
    const Architecture& architecture_;
    const ModuleHead& entity_;
    /// The heads that components were made of, by name.
    std::map<std::string, const ModuleHead*> made_;
    bool hasEntities_ = false;
    /// The head of the last instance of a component, by the name that was written.
    std::string lastName_;
    ModuleHead* lastHead_ = nullptr;
    /// The generics of the present instance that have the value that they have in the component.
    std::vector<Generic> inherited_;
    PortMapReader portMap_;
};

} // namespace Orn_Hdl::Readers::Vhdl
