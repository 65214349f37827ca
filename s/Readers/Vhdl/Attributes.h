// Attribute declarations and specifications.
#pragma once

#include "Readers/NetlistMaker.h"
#include "Readers/Value.h"
#include "Readers/Vhdl/Design.h"
#include "Readers/Vhdl/Parser.h"

#include <map>
#include <string>
#include <unordered_map>
#include <vector>

namespace Orn_Hdl::Readers::Vhdl {

/// Gives an object a generic or an attribute. \return an empty text, or why it cannot have it.
std::string GiveAttribute(AttributeHolder& holder, const std::string& name, const Value& value,
                          const char* generic, const char* synthesis);

class AttributeReader {
public:
    /// \param keepsAttributes whether attributes become attributes of objects.
    AttributeReader(Parser& parser, NetlistMaker& maker, const Design& design,
                    const Architecture& architecture, bool keepsAttributes)
        : parser_(parser), maker_(maker), design_(design), architecture_(architecture),
          keepsAttributes_(keepsAttributes) {}

    /// Reads a declaration or a specification, the token being "attribute".
    void Read(const Parser::Resolve& resolve);
    /// Gives an instance the attributes that stand in front of it.
    void GiveTo(const std::string& label, Instance& instance);
    /// Refuses attributes of labels that there are not.
    void RefuseUnused() const;
    /// Whether an attribute has a type other than string.
    bool HasTypes() const noexcept { return hasTypes_; }

private:
    struct Pending {
        std::string name;
        Value value;
        Place place;
        bool isDeclared = false;
    };

    void ReadSpecification(const std::string& name, const Parser::Resolve& resolve);
    AttributeHolder* FindHolder(Keyword entityClass, const std::string& name, const Place& place);
    void Set(AttributeHolder& holder, const Pending& attribute) const;

    Parser& parser_;
    NetlistMaker& maker_;
    const Design& design_;
    const Architecture& architecture_;
    const bool keepsAttributes_;
    /// The types of the attributes that the file declares.
    std::map<std::string, std::string> types_;
    /// The attributes of instances that are yet to come, by label.
    std::unordered_map<std::string, std::vector<Pending>> pending_;
    bool hasTypes_ = false;
};

} // namespace Orn_Hdl::Readers::Vhdl
