// The models of an engine, with a look-up by name that does not visit each of them.
#pragma once

#include "Containers/HashSlots.h"
#include "HdlModel/Objects/NameListener.h"
#include "Orn_Hdl/Model.h"

#include <cstdint>
#include <map>
#include <memory>
#include <string_view>

namespace Orn_Hdl {

/// Owns models, in the order in which they were added. Several may have the same name, because a
/// model can be renamed at any time; a look-up returns the first of them.
class ModelRegistry {
public:
    ModelRegistry() = default;
    ModelRegistry(const ModelRegistry&) = delete;
    ModelRegistry& operator=(const ModelRegistry&) = delete;
    /// Deletes the models, the last one first.
    ~ModelRegistry();

    void Add(std::unique_ptr<Model> model);
    /// The first model of that name, letter case ignored; null if there is none.
    Model* Find(std::string_view name) const;
    /// Removes and returns the first model of that name; null if there is none.
    std::unique_ptr<Model> Remove(std::string_view name);
    /// Calls `look` for each model.
    template <class Look> void ForEach(const Look& look) const {
        for (const auto& [number, entry] : entries_) {
            look(*entry.model);
        }
    }

private:
    /// Models are numbered in the order in which they are added.
    using Number = std::uint64_t;

    /// A model, which notifies its registry when it is renamed.
    struct Entry final : NameListener {
        Entry(ModelRegistry& owner, Number ownNumber, std::unique_ptr<Model> ownModel) noexcept;
        void NameChanged() noexcept override;

        ModelRegistry& registry;
        Number number;
        std::unique_ptr<Model> model;
        /// The hash of the name under which the model is listed.
        std::uint32_t hash;
    };

    Entry* FindEntry(std::string_view name) const;

    std::map<Number, Entry> entries_;
    HashSlots<Entry*> byName_;
    Number next_ = 0;
};

} // namespace Orn_Hdl
