// The components that the cells of an imported design are placements of.
#pragma once

#include "ImportContext.h"
#include "ImportDesign.h"
#include "ImportNames.h"
#include "ImportSink.h"

#include <map>
#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

namespace Tool::Import {

struct ComponentPin {
    std::string_view oldName;
    std::string baseName;
    /// With the range, if the pin has one.
    std::string name;
    Direction direction = Direction::InOut;
    std::uint32_t width = 1;
    bool scalar = true;
};

struct Generic {
    std::string_view oldName;
    /// With the value that cells get which have none of their own.
    TypedValue value;
};

struct Component {
    std::string_view oldName;
    /// The first cell that needs it.
    const Cell* firstCell = nullptr;
    std::string name;
    /// By the pin index of the type.
    std::vector<ComponentPin> pins;
    std::vector<Generic> generics;
};

/// Finds the components of a design: one for each type of cell, and further ones where cells of one
/// type differ in the widths of their pins, or in parameters whose default nobody knows.
class Components {
public:
    /// Checks the cells of the top module against the leaf modules of the design, and chooses
    /// names. \param names the names that components share with instances and signals. \throws
    /// Error when a cell has contents, or does not fit its leaf module.
    Components(Design& design, Context& context, NameTable& names);

    const std::vector<Component>& GetAll() const noexcept { return components_; }
    const Component& GetOf(std::size_t cell) const { return components_[componentOf_[cell]]; }
    const Generic& GetGeneric(std::size_t cell, std::string_view parameter) const;

    void Emit(Sink& sink) const;

private:
    static constexpr std::uint32_t NoIndex = 0xFFFFFFFF;

    struct Pin {
        const ModulePort* port = nullptr;
        std::uint32_t width = 0;
        /// Whether cells of the type disagree on the width.
        bool varies = false;
    };
    struct Parameter {
        std::string_view name;
        /// The value of the first cell that has it.
        const Value* first = nullptr;
        const Value* defaultValue = nullptr;
        std::uint32_t cells = 0;
        bool kindVaries = false;
    };
    struct Type {
        const Module* leaf = nullptr;
        const Cell* firstCell = nullptr;
        std::uint32_t cells = 0;
        std::vector<Pin> pins;
        std::vector<Parameter> parameters;
        std::unordered_map<std::string_view, std::uint32_t> parameterIndex;
        /// Whether the cells need more than one component.
        bool varies = false;
        std::map<std::vector<std::uint32_t>, std::uint32_t> components;
    };

    void FindLeaf(std::uint32_t index, const Cell& firstCell);
    void CountCell(const Cell& cell);
    void Settle(Type& type);
    void TellLosses(const Type& type);
    std::vector<std::uint32_t> GetVariant(const Type& type, const Cell& cell) const;
    std::uint32_t GetOrAddComponent(const Cell& cell);
    void AddComponent(std::uint32_t type, const std::vector<std::uint32_t>& variant,
                      const Cell& cell);
    void AddPin(Component& component, const TypePin& pin, std::uint32_t width, const Cell& cell);
    void AddGenerics(Component& component, const Type& type,
                     const std::vector<std::uint32_t>& variant);
    void NameComponents(NameTable& names);
    void NameParts(Component& component, const Type& type);
    static bool NeedsDefault(const Type& type, const Parameter& parameter) noexcept {
        return parameter.cells < type.cells;
    }
    static bool IsPartial(const Type& type, const Parameter& parameter) noexcept {
        return NeedsDefault(type, parameter) && parameter.defaultValue == nullptr;
    }

    Design& design_;
    Context& context_;
    std::unordered_map<std::string_view, const Module*> modules_;
    std::vector<Type> types_;
    std::vector<Component> components_;
    std::vector<std::uint32_t> componentOf_;
};

/// The direction as the command language spells it.
const char* GetDirectionName(Direction direction) noexcept;

} // namespace Tool::Import
