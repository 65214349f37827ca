// Keeps a model from ending in the middle of what it does.
#pragma once

#include "Orn_Hdl/Model.h"

namespace Orn_Hdl {

/// As long as one of these lives, `Model::Delete` puts the end of its model off.
class Model::Use {
public:
    /// \param model may be null.
    explicit Use(Model* model) noexcept : model_(model) {
        if (model_ != nullptr) {
            ++model_->uses_;
        }
    }
    Use(const Use&) = delete;
    Use& operator=(const Use&) = delete;
    ~Use() {
        if (model_ != nullptr && --model_->uses_ == 0 && model_->endsUnused_) {
            // What ends with the model may use it once more.
            model_->endsUnused_ = false;
            delete model_;
        }
    }

private:
    Model* model_;
};

} // namespace Orn_Hdl
