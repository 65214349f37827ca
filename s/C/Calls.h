// How a call of the C interface runs: its handle is resolved, and whatever is thrown becomes a
// status.
#pragma once

#include "C/Handles.h"

#include <exception>
#include <string>
#include <string_view>

namespace Orn_Hdl::CInterface {

/// Thrown inside a call that ends with this status.
struct CallFailure {
    orn_hdl_status_t status;
    /// Empty for the text of the status.
    std::string text = {};
};

/// The status of the exception that is being handled, which is remembered with its text.
/// \param error null for a call that remembers nothing.
orn_hdl_status_t StatusOfException(LastError* error) noexcept;

/// Runs an action that throws when it fails. \return its status.
template <class Action> orn_hdl_status_t Attempt(LastError* error, const Action& action) noexcept {
    try {
        action();
        return ORN_HDL_OK;
    } catch (...) {
        return StatusOfException(error);
    }
}

/// Fails with `ORN_HDL_INVALID_ARGUMENT` unless the condition holds.
inline void Require(bool condition) {
    if (!condition) {
        throw CallFailure{ORN_HDL_INVALID_ARGUMENT};
    }
}

/// Fails with a status.
[[noreturn]] inline void End(orn_hdl_status_t status) {
    throw CallFailure{status};
}

/// Marks a model as changing.
class Changing {
public:
    explicit Changing(ModelEntity& entity) : entity_(entity) {
        if (entity.IsBusy()) {
            End(ORN_HDL_BUSY);
        }
        entity.isChanging = true;
    }
    Changing(const Changing&) = delete;
    Changing& operator=(const Changing&) = delete;
    ~Changing() { entity_.isChanging = false; }

private:
    ModelEntity& entity_;
};

/// Runs an action on an entity and remembers its failure there.
template <class T, class Action>
orn_hdl_status_t Call(std::uint64_t id, const Action& action) noexcept {
    T* entity = nullptr;
    const orn_hdl_status_t status = Resolve(id, entity);
    return status != ORN_HDL_OK ? status : Attempt(&entity->error, [&] { action(*entity); });
}

/// Runs an action that looks at an entity, and remembers nothing.
template <class T, class Action>
orn_hdl_status_t Look(std::uint64_t id, const Action& action) noexcept {
    T* entity = nullptr;
    const orn_hdl_status_t status = Resolve(id, entity);
    return status != ORN_HDL_OK ? status : Attempt(nullptr, [&] { action(*entity); });
}

/// Runs an action that may change a model.
template <class Action>
orn_hdl_status_t Change(orn_hdl_model_t model, const Action& action) noexcept {
    return Call<ModelEntity>(model.id, [&](ModelEntity& entity) {
        const Changing changing(entity);
        action(entity.model);
    });
}

/// Runs an action that looks at a model.
template <class Action>
orn_hdl_status_t LookAt(orn_hdl_model_t model, const Action& action) noexcept {
    return Look<ModelEntity>(model.id, [&](ModelEntity& entity) { action(entity); });
}

/// The language of a constant of the interface.
Language ToLanguage(orn_hdl_language_t language);

/// Tells what the last failed call was.
orn_hdl_status_t TellError(const LastError& error, orn_hdl_error_t* result);

} // namespace Orn_Hdl::CInterface
