#include "Readers/Vhdl/WriterOptions.h"

#include "Port/Ascii.h"

#include <algorithm>
#include <cstddef>
#include <iterator>
#include <string>
#include <string_view>
#include <vector>

namespace Orn_Hdl::Readers::Vhdl {

namespace {

/// The clauses that a model has without naming them.
constexpr std::string_view DefaultLibraries[] = {"ieee", "KESTRA"};
constexpr std::string_view DefaultUses[] = {"ieee.std_logic_1164.all", "ieee.numeric_std.all",
                                            "KESTRA.Vcomponents.all"};
/// What the types of the ports need.
constexpr std::string_view TypesLibrary = "ieee";
constexpr std::string_view TypesUse = "ieee.std_logic_1164.all";

bool Contains(const std::vector<std::string>& texts, std::string_view text) {
    return std::any_of(texts.begin(), texts.end(), [text](const std::string& each) {
        return Port::EqualIgnoringCase(each, text);
    });
}

template <std::size_t Count>
bool ContainsAll(const std::vector<std::string>& texts, const std::string_view (&wanted)[Count]) {
    return std::all_of(std::begin(wanted), std::end(wanted),
                       [&texts](std::string_view text) { return Contains(texts, text); });
}

template <std::size_t Count>
void RemoveAll(std::vector<std::string>& texts, const std::string_view (&unwanted)[Count]) {
    texts.erase(std::remove_if(texts.begin(), texts.end(),
                               [&unwanted](const std::string& each) {
                                   return std::any_of(std::begin(unwanted), std::end(unwanted),
                                                      [&each](std::string_view text) {
                                                          return Port::EqualIgnoringCase(each,
                                                                                         text);
                                                      });
                               }),
                texts.end());
}

void AddNew(const std::vector<std::string>& from, std::vector<std::string>& to) {
    for (const std::string& text : from) {
        if (!Contains(to, text)) {
            to.push_back(text);
        }
    }
}

StringArray MakeArray(const std::vector<std::string>& texts) {
    StringArray array;
    for (const std::string& text : texts) {
        array.Add(text.c_str());
    }
    return array;
}

} // namespace

void SetClauses(const Clauses& ofEntity, const Clauses& ofArchitecture,
                HdlOptions::VhdlOption& options) {
    std::vector<std::string> libraries;
    std::vector<std::string> uses;
    for (const Clauses* clauses : {&ofEntity, &ofArchitecture}) {
        AddNew(clauses->libraries, libraries);
        AddNew(clauses->uses, uses);
    }
    options.useDefaultLibrary =
        ContainsAll(libraries, DefaultLibraries) && ContainsAll(uses, DefaultUses);
    if (options.useDefaultLibrary) {
        RemoveAll(libraries, DefaultLibraries);
        RemoveAll(uses, DefaultUses);
    } else {
        AddNew({std::string(TypesLibrary)}, libraries);
        AddNew({std::string(TypesUse)}, uses);
    }
    options.libraries = MakeArray(libraries);
    options.useClauses = MakeArray(uses);
}

} // namespace Orn_Hdl::Readers::Vhdl
