// The functions of the C interface for engines.
#include "C/Lines.h"

namespace CInterface = Orn_Hdl::CInterface;

using CInterface::Call;
using CInterface::End;
using CInterface::EngineEntity;
using CInterface::ModelEntity;
using CInterface::Require;

namespace {

ModelEntity& FindModel(const EngineEntity& engine, const char* name) {
    ModelEntity* const model = engine.Find(name);
    if (model == nullptr) {
        End(ORN_HDL_NOT_FOUND);
    }
    return *model;
}

} // namespace

extern "C" {

orn_hdl_status_t orn_hdl_engine_create(orn_hdl_engine_t* engine) {
    return CInterface::Attempt(nullptr, [&] {
        Require(engine != nullptr);
        // The handle leads to the entity, which the destroying call deletes.
        engine->id = (new EngineEntity)->GetId();
    });
}

orn_hdl_status_t orn_hdl_engine_destroy(orn_hdl_engine_t engine) {
    EngineEntity* doomed = nullptr;
    const orn_hdl_status_t status = Call<EngineEntity>(engine.id, [&](EngineEntity& entity) {
        if (entity.IsBusy()) {
            End(ORN_HDL_BUSY);
        }
        doomed = &entity;
    });
    delete doomed;
    return status;
}

orn_hdl_status_t orn_hdl_engine_add_model(orn_hdl_engine_t engine, const char* name,
                                          const char* sourceFile, orn_hdl_model_t* model) {
    return Call<EngineEntity>(engine.id, [&](EngineEntity& entity) {
        const ModelEntity* const added = entity.Add(name, sourceFile);
        if (added == nullptr) {
            End(ORN_HDL_EXISTS);
        }
        if (model != nullptr) {
            model->id = added->GetId();
        }
    });
}

orn_hdl_status_t orn_hdl_engine_get_model(orn_hdl_engine_t engine, const char* name,
                                          orn_hdl_model_t* model) {
    return CInterface::Look<EngineEntity>(engine.id, [&](const EngineEntity& entity) {
        Require(model != nullptr);
        model->id = FindModel(entity, name).GetId();
    });
}

orn_hdl_status_t orn_hdl_engine_use_model(orn_hdl_engine_t engine, const char* name) {
    return Call<EngineEntity>(engine.id, [&](EngineEntity& entity) {
        entity.current = FindModel(entity, name).GetId();
        entity.engine.UseModel(name);
    });
}

orn_hdl_status_t orn_hdl_engine_remove_model(orn_hdl_engine_t engine, const char* name) {
    return Call<EngineEntity>(engine.id, [&](EngineEntity& entity) {
        const ModelEntity& model = FindModel(entity, name);
        if (model.IsBusy()) {
            End(ORN_HDL_BUSY);
        }
        entity.Remove(model);
    });
}

orn_hdl_status_t orn_hdl_model_destroy(orn_hdl_model_t model) {
    return Call<ModelEntity>(model.id, [](ModelEntity& entity) {
        if (entity.IsBusy()) {
            End(ORN_HDL_BUSY);
        }
        entity.engine.Remove(entity);
    });
}

orn_hdl_status_t orn_hdl_engine_execute(orn_hdl_engine_t engine, const char* line) {
    return Call<EngineEntity>(engine.id, [&](EngineEntity& entity) {
        ModelEntity* model = nullptr;
        if (CInterface::Resolve(entity.current, model) != ORN_HDL_OK) {
            // There is no current model, as the engine's exception tells.
            entity.engine.Execute(line);
            return;
        }
        const CInterface::Changing changing(*model);
        CInterface::RunLine(model->model, Port::ViewOf(line));
    });
}

orn_hdl_status_t orn_hdl_engine_replay(orn_hdl_engine_t engine, const char* model,
                                       const char* fileName) {
    orn_hdl_status_t replayed = ORN_HDL_OK;
    const orn_hdl_status_t status = Call<EngineEntity>(engine.id, [&](EngineEntity& entity) {
        ModelEntity* target = entity.Find(model);
        if (target == nullptr) {
            target = entity.Add(model, fileName);
        }
        replayed = CInterface::Replay(*target, fileName, {}, entity.error);
    });
    return status != ORN_HDL_OK ? status : replayed;
}

orn_hdl_status_t orn_hdl_engine_error(orn_hdl_engine_t engine, orn_hdl_error_t* error) {
    EngineEntity* entity = nullptr;
    const orn_hdl_status_t status = CInterface::Resolve(engine.id, entity);
    return status != ORN_HDL_OK ? status : CInterface::TellError(entity->error, error);
}

} // extern "C"
