#include "Readers/Vhdl/Keywords.h"

#include "Port/Ascii.h"
#include "Readers/WordTable.h"

#include <algorithm>
#include <cstddef>
#include <iterator>

namespace Orn_Hdl::Readers::Vhdl {

namespace {

struct Entry {
    std::string_view word;
    Keyword keyword;
};

/// IEEE 1076-1993, 13.9.
constexpr Entry Entries[] = {
    {"abs", Keyword::Operator},
    {"access", Keyword::Other},
    {"after", Keyword::After},
    {"alias", Keyword::Alias},
    {"all", Keyword::All},
    {"and", Keyword::Operator},
    {"architecture", Keyword::Architecture},
    {"array", Keyword::Other},
    {"assert", Keyword::Behaviour},
    {"attribute", Keyword::Attribute},
    {"begin", Keyword::Begin},
    {"block", Keyword::Block},
    {"body", Keyword::Body},
    {"buffer", Keyword::Buffer},
    {"bus", Keyword::Bus},
    {"case", Keyword::Case},
    {"component", Keyword::Component},
    {"configuration", Keyword::Configuration},
    {"constant", Keyword::Constant},
    {"disconnect", Keyword::Behaviour},
    {"downto", Keyword::Downto},
    {"else", Keyword::Other},
    {"elsif", Keyword::Other},
    {"end", Keyword::End},
    {"entity", Keyword::Entity},
    {"exit", Keyword::Behaviour},
    {"file", Keyword::Behaviour},
    {"for", Keyword::For},
    {"function", Keyword::Function},
    {"generate", Keyword::Generate},
    {"generic", Keyword::Generic},
    {"group", Keyword::Group},
    {"guarded", Keyword::Behaviour},
    {"if", Keyword::If},
    {"impure", Keyword::Behaviour},
    {"in", Keyword::In},
    {"inertial", Keyword::Behaviour},
    {"inout", Keyword::Inout},
    {"is", Keyword::Is},
    {"label", Keyword::Label},
    {"library", Keyword::Library},
    {"linkage", Keyword::Linkage},
    {"literal", Keyword::Other},
    {"loop", Keyword::Behaviour},
    {"map", Keyword::Map},
    {"mod", Keyword::Operator},
    {"nand", Keyword::Operator},
    {"new", Keyword::New},
    {"next", Keyword::Behaviour},
    {"nor", Keyword::Operator},
    {"not", Keyword::Operator},
    {"null", Keyword::Behaviour},
    {"of", Keyword::Of},
    {"on", Keyword::Other},
    {"open", Keyword::Open},
    {"or", Keyword::Operator},
    {"others", Keyword::Others},
    {"out", Keyword::Out},
    {"package", Keyword::Package},
    {"port", Keyword::Port},
    {"postponed", Keyword::Postponed},
    {"procedure", Keyword::Procedure},
    {"process", Keyword::Process},
    {"pure", Keyword::Behaviour},
    {"range", Keyword::Other},
    {"record", Keyword::Record},
    {"register", Keyword::Other},
    {"reject", Keyword::Behaviour},
    {"rem", Keyword::Operator},
    {"report", Keyword::Behaviour},
    {"return", Keyword::Behaviour},
    {"rol", Keyword::Operator},
    {"ror", Keyword::Operator},
    {"select", Keyword::Behaviour},
    {"severity", Keyword::Other},
    {"shared", Keyword::Behaviour},
    {"signal", Keyword::Signal},
    {"sla", Keyword::Operator},
    {"sll", Keyword::Operator},
    {"sra", Keyword::Operator},
    {"srl", Keyword::Operator},
    {"subtype", Keyword::Subtype},
    {"then", Keyword::Other},
    {"to", Keyword::To},
    {"transport", Keyword::Behaviour},
    {"type", Keyword::Type},
    {"unaffected", Keyword::Behaviour},
    {"units", Keyword::Units},
    {"until", Keyword::Behaviour},
    {"use", Keyword::Use},
    {"variable", Keyword::Behaviour},
    {"wait", Keyword::Behaviour},
    {"when", Keyword::When},
    {"while", Keyword::Behaviour},
    {"with", Keyword::With},
    {"xnor", Keyword::Operator},
    {"xor", Keyword::Operator},
};

/// What IEEE 1076-2008, 15.10, adds. These words are names in netlists that are older.
constexpr std::string_view LaterWords[] = {
    "assume",
    "assume_guarantee",
    "context",
    "cover",
    "default",
    "fairness",
    "force",
    "parameter",
    "property",
    "protected",
    "release",
    "restrict",
    "restrict_guarantee",
    "sequence",
    "strong",
    "vmode",
    "vprop",
    "vunit",
};

constexpr std::size_t Count = std::size(Entries);
constexpr WordTable<Count> Table(Entries);

} // namespace

Keyword FindKeyword(std::string_view word) noexcept {
    const std::size_t found = Table.Find(word, [word](std::size_t index) {
        return Port::EqualIgnoringCase(Entries[index].word, word);
    });
    return found == Count ? Keyword::None : Entries[found].keyword;
}

bool IsReserved(std::string_view name) {
    return FindKeyword(name) != Keyword::None ||
           std::any_of(std::begin(LaterWords), std::end(LaterWords), [name](std::string_view word) {
               return Port::EqualIgnoringCase(word, name);
           });
}

} // namespace Orn_Hdl::Readers::Vhdl
