// The commands of the language, made from the entries of their table.
#pragma once

#include "HdlCmd/Arguments.h"
#include "HdlCmd/Catalogue.h"

#include <algorithm>
#include <array>
#include <cstddef>
#include <iterator>
#include <string_view>
#include <utility>

namespace Orn_Hdl {

/// The command of one entry of a table, for callers who want it as an object. A manager carries out
/// the entry itself.
template <const auto& Table, std::size_t Index> class CatalogueCommand final : public Command {
public:
    static Command* Create(Model* model, const StringArray& /*tokens*/) {
        return new CatalogueCommand(model);
    }

    bool Parse(const StringArray& tokens) override { return Entry.parse(tokens, arguments_); }
    void Execute() override { Entry.execute(RequireModel(GetModel()), arguments_); }
    const char* GetName() const override { return Entry.info.phrase; }

private:
    static constexpr const CommandEntry& Entry = Table[Index];

    explicit CatalogueCommand(Model* model) noexcept : Command(model) {}

    Arguments arguments_;
};

namespace CommandDetail {

constexpr int CountWords(std::string_view phrase) {
    return 1 + static_cast<int>(std::count(phrase.begin(), phrase.end(), ' '));
}

template <const auto& Table, std::size_t... Indices>
constexpr auto RegisterAll(std::index_sequence<Indices...> /*indices*/) {
    return std::array<RegisteredCommand, sizeof...(Indices)>{
        {{Table[Indices], &CatalogueCommand<Table, Indices>::Create,
          CountWords(Table[Indices].info.phrase)}...}};
}

} // namespace CommandDetail

/// The phrases of a whole table with their creators.
template <const auto& Table>
constexpr auto RegisteredCommandsOf =
    CommandDetail::RegisterAll<Table>(std::make_index_sequence<std::size(Table)>());

} // namespace Orn_Hdl
