// A model may be removed from its engine or destroyed in the middle of what it does.
#pragma once

#include "Orn_Hdl/Model.h"

namespace Orn_Hdl {

/// A piece of work on a model. Uses of one model end in the reverse order of their beginnings.
/// `Model::Delete` leaves the deletion of a model that is in use to its last use; whoever destroys
/// the model regardless leaves uses without a model.
class Model::Use {
public:
    /// \param model may be null.
    explicit Use(Model* model) noexcept : model_(model) {
        if (model_ != nullptr) {
            outer_ = model_->innermostUse_;
            model_->innermostUse_ = this;
        }
    }
    Use(const Use&) = delete;
    Use& operator=(const Use&) = delete;
    ~Use() {
        if (model_ == nullptr) {
            return;
        }
        model_->innermostUse_ = outer_;
        if (outer_ == nullptr && model_->endsUnused_) {
            // The commands that are destroyed with the model may use it once more.
            model_->endsUnused_ = false;
            delete model_;
        }
    }

    /// Whether the model that was given is still there.
    bool HasModel() const noexcept { return model_ != nullptr; }

    /// Takes a model that is being destroyed away from its uses.
    static void TakeAway(Model& model) noexcept {
        for (Use* use = model.innermostUse_; use != nullptr; use = use->outer_) {
            use->model_ = nullptr;
        }
    }

private:
    Model* model_;
    Use* outer_ = nullptr;
};

} // namespace Orn_Hdl
