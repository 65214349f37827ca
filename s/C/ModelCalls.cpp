// The functions of the C interface for models: lines, files and state.
#include "C/Lines.h"
#include "C/Texts.h"
#include "Orn_Hdl/Commands.h"

namespace CInterface = Orn_Hdl::CInterface;

using CInterface::Call;
using CInterface::Change;
using CInterface::LookAt;
using CInterface::ModelEntity;
using CInterface::Require;
using Orn_Hdl::Model;

namespace {

/// Carries out the lines of a text.
/// \param present counts the lines that were begun.
void RunLines(Model& model, std::string_view text, std::uint64_t& present) {
    while (!text.empty()) {
        ++present;
        const std::size_t end = text.find('\n');
        std::string_view line = text.substr(0, end);
        text = end == std::string_view::npos ? std::string_view() : text.substr(end + 1);
        if (!line.empty() && line.back() == '\r') {
            line.remove_suffix(1);
        }
        CInterface::RunLine(model, line);
    }
}

} // namespace

extern "C" {

orn_hdl_status_t orn_hdl_model_execute(orn_hdl_model_t model, const char* line) {
    return Change(model, [&](Model& target) { CInterface::RunLine(target, Port::ViewOf(line)); });
}

orn_hdl_status_t orn_hdl_model_execute_lines(orn_hdl_model_t model, const char* lines,
                                             size_t length) {
    ModelEntity* entity = nullptr;
    const orn_hdl_status_t resolved = CInterface::Resolve(model.id, entity);
    if (resolved != ORN_HDL_OK) {
        return resolved;
    }
    std::uint64_t present = 0;
    const orn_hdl_status_t status = CInterface::Attempt(&entity->error, [&] {
        Require(lines != nullptr || length == 0);
        const CInterface::Changing changing(*entity);
        RunLines(entity->model, length == 0 ? std::string_view() : std::string_view(lines, length),
                 present);
    });
    if (status != ORN_HDL_OK) {
        entity->error.SetPlace({}, present);
    }
    return status;
}

orn_hdl_status_t orn_hdl_model_replay(orn_hdl_model_t model, const char* fileName,
                                      orn_hdl_progress_t progress, orn_hdl_failure_t failure,
                                      void* user) {
    orn_hdl_status_t replayed = ORN_HDL_OK;
    const orn_hdl_status_t status = Call<ModelEntity>(model.id, [&](ModelEntity& entity) {
        replayed = CInterface::Replay(entity, fileName, {progress, failure, user}, entity.error);
    });
    return status != ORN_HDL_OK ? status : replayed;
}

orn_hdl_status_t orn_hdl_model_error(orn_hdl_model_t model, orn_hdl_error_t* error) {
    ModelEntity* entity = nullptr;
    const orn_hdl_status_t status = CInterface::Resolve(model.id, entity);
    return status != ORN_HDL_OK ? status : CInterface::TellError(entity->error, error);
}

orn_hdl_status_t orn_hdl_model_set_guard(orn_hdl_model_t model, orn_hdl_guard_t guard, void* user) {
    return Call<ModelEntity>(model.id, [&](ModelEntity& entity) {
        const CInterface::Changing changing(entity);
        auto newGuard =
            guard == nullptr ? nullptr : std::make_unique<CInterface::CallbackGuard>(guard, user);
        entity.model.SetOutputGuard(newGuard.get());
        entity.guard = std::move(newGuard);
    });
}

orn_hdl_status_t orn_hdl_model_get_last_write(orn_hdl_model_t model, int* error, uint64_t* leftover,
                                              orn_hdl_text_t* fileName) {
    return LookAt(model, [&](const ModelEntity& entity) {
        if (fileName != nullptr) {
            CInterface::HandOutText(*fileName, entity.model.GetWrittenFileName().GetView());
        }
        if (error != nullptr) {
            *error = entity.model.GetWriteError();
        }
        if (leftover != nullptr) {
            *leftover = entity.model.GetWriteLeftover();
        }
    });
}

orn_hdl_status_t orn_hdl_model_get_done_count(orn_hdl_model_t model, size_t* count) {
    return LookAt(model, [&](const ModelEntity& entity) {
        Require(count != nullptr);
        *count = static_cast<size_t>(entity.model.GetCommandManager()->GetDoneCommandCount());
    });
}

orn_hdl_status_t orn_hdl_model_clear_done(orn_hdl_model_t model) {
    return Change(model, [&](Model& target) { target.GetCommandManager()->Clear(); });
}

orn_hdl_status_t orn_hdl_model_get_name(orn_hdl_model_t model, orn_hdl_text_t* name) {
    return LookAt(model, [&](const ModelEntity& entity) {
        Require(name != nullptr);
        CInterface::HandOutText(*name, entity.model.GetNetlist()->GetNameView());
    });
}

orn_hdl_status_t orn_hdl_model_set_name(orn_hdl_model_t model, const char* name) {
    return Change(model, [&](Model& target) { target.SetName(name); });
}

orn_hdl_status_t orn_hdl_model_get_source_file(orn_hdl_model_t model, orn_hdl_text_t* name) {
    return LookAt(model, [&](const ModelEntity& entity) {
        Require(name != nullptr);
        CInterface::HandOutText(*name, entity.model.GetSourceFileName().GetView());
    });
}

orn_hdl_status_t orn_hdl_model_set_source_file(orn_hdl_model_t model, const char* name) {
    return Change(model, [&](Model& target) { target.SetSourceFileName(name); });
}

orn_hdl_status_t orn_hdl_model_is_modified(orn_hdl_model_t model, int* modified) {
    return LookAt(model, [&](const ModelEntity& entity) {
        Require(modified != nullptr);
        *modified = entity.model.IsModified() ? 1 : 0;
    });
}

orn_hdl_status_t orn_hdl_model_set_modified(orn_hdl_model_t model, int modified) {
    return Change(model, [&](Model& target) { target.SetModifiedFlag(modified != 0); });
}

} // extern "C"
