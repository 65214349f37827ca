#include "HdlEngine/ModelRegistry.h"

#include "Containers/HashByEights.h"
#include "Port/Ascii.h"

#include <iterator>

namespace Orn_Hdl {

namespace {

std::uint32_t HashOfName(const Model& model) noexcept {
    return HashUpperByEights(model.GetNetlist()->GetNameView());
}

} // namespace

ModelRegistry::Entry::Entry(ModelRegistry& owner, Number number) noexcept
    : registry(owner), key(0, number) {}

void ModelRegistry::Entry::NameChanged() noexcept {
    // The node moves to its new place, so nothing has to be allocated.
    auto node = registry.byName_.extract(key);
    key.first = HashOfName(*model);
    node.value() = key;
    registry.byName_.insert(std::move(node));
}

ModelRegistry::~ModelRegistry() {
    while (!entries_.empty()) {
        entries_.erase(std::prev(entries_.end()));
    }
}

void ModelRegistry::Add(std::unique_ptr<Model> model) {
    const Number number = next_++;
    const Key key(HashOfName(*model), number);
    byName_.insert(key);
    try {
        Entry& entry = entries_.try_emplace(entries_.end(), number, *this, number)->second;
        entry.key = key;
        entry.model = std::move(model);
        entry.model->GetNetlist()->SetNameListener(&entry);
    } catch (...) {
        byName_.erase(key);
        throw;
    }
}

const ModelRegistry::Entry* ModelRegistry::FindEntry(std::string_view name) const {
    const std::uint32_t hash = HashUpperByEights(name);
    for (auto key = byName_.lower_bound(Key(hash, 0)); key != byName_.end() && key->first == hash;
         ++key) {
        const Entry& entry = entries_.at(key->second);
        if (Port::EqualIgnoringCase(entry.model->GetNetlist()->GetNameView(), name)) {
            return &entry;
        }
    }
    return nullptr;
}

Model* ModelRegistry::Find(std::string_view name) const {
    const Entry* const entry = FindEntry(name);
    return entry == nullptr ? nullptr : entry->model.get();
}

std::unique_ptr<Model> ModelRegistry::Remove(std::string_view name) {
    const Entry* const found = FindEntry(name);
    if (found == nullptr) {
        return nullptr;
    }
    const auto entry = entries_.find(found->key.second);
    std::unique_ptr<Model> model = std::move(entry->second.model);
    model->GetNetlist()->SetNameListener(nullptr);
    byName_.erase(entry->second.key);
    entries_.erase(entry);
    return model;
}

} // namespace Orn_Hdl
