// The commands of the language, made from the entries of their table.
#pragma once

#include "HdlCmd/Arguments.h"
#include "HdlCmd/Catalogue.h"
#include "Port/Pool.h"

#include <array>
#include <cstddef>
#include <iterator>
#include <new>
#include <string_view>
#include <utility>

namespace Orn_Hdl {

/// The command of one entry of a table. Its class is its entry: an object holds its model and its
/// arguments and no pointer to the entry, since millions of done commands are kept.
template <const auto& Table, std::size_t Index> class CatalogueCommand final : public Command {
public:
    static Command* Create(Model* model, const StringArray& tokens) {
        constexpr std::size_t PhraseLength = std::string_view(Entry.info.phrase).size();
        const std::size_t room = Arguments::RoomFor(tokens, PhraseLength);
        // The arguments are the last member, with nothing between them and the base.
        void* const memory = Port::Pool::AllocatePacked(sizeof(Command) + sizeof(Arguments) + room,
                                                        Port::Pool::Commands);
        return ::new (memory) CatalogueCommand(model, room);
    }

    bool Parse(const StringArray& tokens) override { return Entry.parse(tokens, arguments_); }
    void Execute() override { Entry.execute(RequireModel(GetModel()), arguments_); }
    const char* GetName() const override { return Entry.info.phrase; }

private:
    static constexpr const CommandEntry& Entry = Table[Index];

    CatalogueCommand(Model* model, std::size_t room) noexcept : Command(model), arguments_(room) {}

    Arguments arguments_;
};

namespace CommandDetail {

template <const auto& Table, std::size_t... Indices>
constexpr auto RegisterAll(std::index_sequence<Indices...> /*indices*/) {
    return std::array<RegisteredCommand, sizeof...(Indices)>{
        {{Table[Indices].info, &CatalogueCommand<Table, Indices>::Create}...}};
}

} // namespace CommandDetail

/// The phrases of a whole table with their creators.
template <const auto& Table>
constexpr auto RegisteredCommandsOf =
    CommandDetail::RegisterAll<Table>(std::make_index_sequence<std::size(Table)>());

} // namespace Orn_Hdl
