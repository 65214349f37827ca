#include "HdlEngine/ModelRegistry.h"

#include "Containers/HashByEights.h"
#include "Port/Ascii.h"

#include <iterator>
#include <utility>

namespace Orn_Hdl {

namespace {

std::uint32_t HashOfName(const Model& model) noexcept {
    return HashUpperByEights(model.GetNetlist()->GetNameView());
}

} // namespace

ModelRegistry::Entry::Entry(ModelRegistry& owner, Number ownNumber,
                            std::unique_ptr<Model> ownModel) noexcept
    : registry(owner), number(ownNumber), model(std::move(ownModel)), hash(HashOfName(*model)) {}

void ModelRegistry::Entry::NameChanged() noexcept {
    // The removed model leaves room, so nothing is allocated.
    registry.byName_.Remove(hash, this);
    hash = HashOfName(*model);
    registry.byName_.Add(hash, this);
}

ModelRegistry::~ModelRegistry() {
    while (!entries_.empty()) {
        entries_.erase(std::prev(entries_.end()));
    }
}

void ModelRegistry::Add(std::unique_ptr<Model> model) {
    byName_.MakeRoom();
    const Number number = next_++;
    Entry& entry =
        entries_.try_emplace(entries_.end(), number, *this, number, std::move(model))->second;
    byName_.Add(entry.hash, &entry);
    entry.model->GetNetlist()->SetNameListener(&entry);
}

ModelRegistry::Entry* ModelRegistry::FindEntry(std::string_view name) const {
    const std::uint32_t hash = HashUpperByEights(name);
    Entry* first = nullptr;
    // The predicate rejects every model, so that it is called for all models of the name.
    byName_.Find(hash, [hash, name, &first](std::uint32_t other, Entry* entry) {
        if (other == hash && (first == nullptr || entry->number < first->number) &&
            Port::EqualIgnoringCase(entry->model->GetNetlist()->GetNameView(), name)) {
            first = entry;
        }
        return false;
    });
    return first;
}

Model* ModelRegistry::Find(std::string_view name) const {
    const Entry* const entry = FindEntry(name);
    return entry == nullptr ? nullptr : entry->model.get();
}

std::unique_ptr<Model> ModelRegistry::Remove(std::string_view name) {
    Entry* const entry = FindEntry(name);
    if (entry == nullptr) {
        return nullptr;
    }
    std::unique_ptr<Model> model = std::move(entry->model);
    model->GetNetlist()->SetNameListener(nullptr);
    byName_.Remove(entry->hash, entry);
    entries_.erase(entry->number);
    return model;
}

} // namespace Orn_Hdl
