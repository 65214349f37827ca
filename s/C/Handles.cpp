#include "C/Handles.h"

#include <algorithm>
#include <array>
#include <cstddef>
#include <mutex>
#include <new>

namespace Orn_Hdl::CInterface {

namespace {

/// A place for one entity at a time.
struct HandleSlot {
    /// Raised when an entity comes and when it goes, so it is odd while there is one.
    std::atomic<std::uint32_t> generation{0};
    Entity* entity = nullptr;
    std::uint32_t nextFree = 0;
};

/// The slots of all entities of the process. Looking one up takes no lock. Slots are used again but
/// never freed, so any number can be looked up at any time; each block has twice as many as the one
/// before.
class HandleTable {
public:
    std::uint64_t Add(Entity& entity) {
        const std::lock_guard<std::mutex> lock(mutex_);
        if (firstFree_ == None) {
            MakeBlock();
        }
        const std::uint32_t index = firstFree_;
        HandleSlot& slot = *GetSlot(index);
        firstFree_ = slot.nextFree;
        slot.entity = &entity;
        const std::uint32_t generation = slot.generation.load(std::memory_order_relaxed) + 1;
        slot.generation.store(generation, std::memory_order_release);
        return (std::uint64_t(generation) << 32U) | index;
    }

    void Remove(std::uint64_t id) noexcept {
        const std::lock_guard<std::mutex> lock(mutex_);
        const auto index = static_cast<std::uint32_t>(id);
        HandleSlot& slot = *GetSlot(index);
        const std::uint32_t generation = slot.generation.load(std::memory_order_relaxed) + 1;
        slot.generation.store(generation, std::memory_order_release);
        slot.entity = nullptr;
        // A slot whose numbers are used up is not used again.
        if (generation != 0) {
            slot.nextFree = firstFree_;
            firstFree_ = index;
        }
    }

    Entity* Find(std::uint64_t id) noexcept {
        const auto generation = static_cast<std::uint32_t>(id >> 32U);
        HandleSlot* const slot = GetSlot(static_cast<std::uint32_t>(id));
        const bool isAlive = slot != nullptr && generation % 2 == 1 &&
                             slot->generation.load(std::memory_order_acquire) == generation;
        return isAlive ? slot->entity : nullptr;
    }

private:
    static constexpr std::uint32_t None = UINT32_MAX;
    static constexpr std::uint32_t FirstBlockSize = 64;
    static constexpr std::size_t MostBlocks = 20;

    static std::uint32_t SizeOf(std::size_t block) noexcept { return FirstBlockSize << block; }

    HandleSlot* GetSlot(std::uint32_t index) noexcept {
        std::uint32_t rest = index;
        for (std::size_t block = 0; block < MostBlocks; ++block) {
            if (rest < SizeOf(block)) {
                HandleSlot* const slots = blocks_[block].load(std::memory_order_acquire);
                return slots == nullptr ? nullptr : slots + rest;
            }
            rest -= SizeOf(block);
        }
        return nullptr;
    }

    void MakeBlock() {
        if (blockCount_ == MostBlocks) {
            throw std::bad_alloc();
        }
        const std::uint32_t size = SizeOf(blockCount_);
        auto* const slots = new HandleSlot[size];
        for (std::uint32_t i = 0; i < size; ++i) {
            slots[i].nextFree = i + 1 < size ? slotCount_ + i + 1 : None;
        }
        blocks_[blockCount_].store(slots, std::memory_order_release);
        firstFree_ = slotCount_;
        slotCount_ += size;
        ++blockCount_;
    }

    std::mutex mutex_;
    std::array<std::atomic<HandleSlot*>, MostBlocks> blocks_ = {};
    std::size_t blockCount_ = 0;
    std::uint32_t slotCount_ = 0;
    std::uint32_t firstFree_ = None;
};

/// Destroyed never: a program may use handles until it ends.
HandleTable& GetHandleTable() noexcept {
    alignas(HandleTable) static unsigned char place[sizeof(HandleTable)];
    static auto* const table = new (place) HandleTable;
    return *table;
}

} // namespace

void LastError::Set(orn_hdl_status_t newStatus, std::string_view newText) noexcept {
    status = newStatus;
    line = 0;
    file.clear();
    try {
        text = newText;
    } catch (const std::bad_alloc&) {
        text.clear();
    }
}

void LastError::SetPlace(std::string_view newFile, std::uint64_t newLine) noexcept {
    line = newLine;
    try {
        file = newFile;
    } catch (const std::bad_alloc&) {
        file.clear();
    }
}

Entity::Entity() : id_(GetHandleTable().Add(*this)) {}

Entity::~Entity() {
    GetHandleTable().Remove(id_);
}

Entity* Entity::Find(std::uint64_t id) noexcept {
    return GetHandleTable().Find(id);
}

ModelEntity* EngineEntity::Find(const char* name) const {
    const Model* const model = engine.GetModel(name);
    for (const std::unique_ptr<ModelEntity>& entity : models) {
        if (&entity->model == model) {
            return entity.get();
        }
    }
    return nullptr;
}

ModelEntity* EngineEntity::Add(const char* name, const char* sourceFile) {
    models.reserve(models.size() + 1);
    if (!engine.CreateAndAddModel(name, sourceFile)) {
        return nullptr;
    }
    try {
        models.push_back(std::make_unique<ModelEntity>(*this, *engine.GetModel(name)));
    } catch (...) {
        engine.RemoveModel(name);
        throw;
    }
    return models.back().get();
}

void EngineEntity::Remove(const ModelEntity& entity) {
    // Commands can give two models one name, and the engine removes the first of a name.
    const std::string name = "\x01" + std::to_string(entity.GetId());
    entity.model.SetName(name);
    engine.RemoveModel(name);
    models.erase(std::find_if(models.begin(), models.end(),
                              [&entity](const auto& present) { return present.get() == &entity; }));
}

bool EngineEntity::IsBusy() const noexcept {
    for (const std::unique_ptr<ModelEntity>& entity : models) {
        if (entity->IsBusy()) {
            return true;
        }
    }
    return false;
}

} // namespace Orn_Hdl::CInterface
