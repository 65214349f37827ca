// What the handles of the C interface stand for.
#pragma once

#include "Orn_Hdl/Engine.h"
#include "Orn_Hdl/Model.h"
#include "Orn_Hdl/Readers.h"
#include "Orn_Hdl/orn_hdl.h"

#include <atomic>
#include <cstdint>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

namespace Orn_Hdl::CInterface {

/// What the last failed call with a handle said.
struct LastError {
    orn_hdl_status_t status = ORN_HDL_OK;
    std::string text;
    std::string file;
    std::uint64_t line = 0;

    /// Remembers a failure. If allocation fails, the texts are empty.
    void Set(orn_hdl_status_t newStatus, std::string_view newText) noexcept;
    /// Adds the line that failed. If allocation fails, the name of the file is empty.
    void SetPlace(std::string_view newFile, std::uint64_t newLine) noexcept;
};

/// Something that has a handle. The handle is dead when the entity is destroyed.
class Entity {
public:
    Entity(const Entity&) = delete;
    Entity& operator=(const Entity&) = delete;
    virtual ~Entity();

    /// The handle's number, which no other entity has or ever gets.
    std::uint64_t GetId() const noexcept { return id_; }
    /// The entity with that number; null when there is none any more. Any number is safe.
    static Entity* Find(std::uint64_t id) noexcept;

    LastError error;

protected:
    /// \throws std::bad_alloc
    Entity();

private:
    std::uint64_t id_;
};

/// Passes the question whether a file may be written on to a callback.
class CallbackGuard final : public OutputGuard {
public:
    CallbackGuard(orn_hdl_guard_t guard, void* user) noexcept : guard_(guard), user_(user) {}
    Port::StringBase<char> WhyNot(const char* fileName) override { return guard_(user_, fileName); }

private:
    orn_hdl_guard_t guard_;
    void* user_;
};

struct EngineEntity;

/// A model and who is at work on it.
struct ModelEntity final : Entity {
    ModelEntity(EngineEntity& ownEngine, Model& ownModel) : engine(ownEngine), model(ownModel) {}

    EngineEntity& engine;
    Model& model;
    /// Whether a call is under way that may change the model.
    bool isChanging = false;
    /// How many calls are under way that must not see a change.
    std::atomic<int> walks{0};
    /// How many pins and attributes were destroyed by themselves.
    std::uint64_t removedParts = 0;
    std::unique_ptr<CallbackGuard> guard;

    bool IsBusy() const noexcept { return isChanging || walks.load() > 0; }
};

/// An engine with the entities of its models.
struct EngineEntity final : Entity {
    // The engine is destroyed before the guards that its models ask.
    std::vector<std::unique_ptr<ModelEntity>> models;
    Engine engine;
    /// The number of the current model; 0 for none.
    std::uint64_t current = 0;

    /// The model of that name; null when there is none.
    ModelEntity* Find(const char* name) const;
    /// \throws std::bad_alloc, nothing added
    ModelEntity* Add(const char* name, const char* sourceFile);
    /// Destroys a model with its entity.
    /// \throws std::bad_alloc, nothing destroyed
    void Remove(const ModelEntity& entity);
    bool IsBusy() const noexcept;
};

/// A reader of either language.
struct ReaderEntity final : Entity {
    /// One of the two is there.
    std::unique_ptr<VerilogReader> verilog;
    std::unique_ptr<VhdlReader> vhdl;
    bool isBusy = false;
};

/// A finding with texts of its own.
struct Finding {
    bool isError = true;
    std::string rule;
    std::string message;
    std::string notes;
    std::string_view cause;
    std::string first;
    std::string second;
    std::uint64_t line = 0;
    std::uint64_t column = 0;
    std::string source;
    std::int32_t verdicts[ORN_HDL_TARGET_COUNT] = {};
};

/// What a check or a proof has found.
struct FindingsEntity final : Entity {
    std::vector<Finding> findings;
};

/// The entity of a handle's number.
/// \param entity receives it if the status is `ORN_HDL_OK`.
template <class T> orn_hdl_status_t Resolve(std::uint64_t id, T*& entity) noexcept {
    if (id == 0) {
        return ORN_HDL_NULL_HANDLE;
    }
    Entity* const found = Entity::Find(id);
    if (found == nullptr) {
        return ORN_HDL_DEAD_HANDLE;
    }
    entity = dynamic_cast<T*>(found);
    return entity == nullptr ? ORN_HDL_WRONG_KIND : ORN_HDL_OK;
}

} // namespace Orn_Hdl::CInterface
