#include "Orn_Hdl/Engine.h"

#include "Exception/Failure.h"
#include "HdlEngine/ModelRegistry.h"
#include "Options/LanguageTraits.h"
#include "Orn_Hdl/Commands.h"
#include "Orn_Hdl/Model.h"
#include "Orn_Hdl/Streams.h"
#include "Orn_Hdl/Writers/NetlistHeader.h"
#include "Port/Ascii.h"

#include <memory>
#include <utility>

namespace Orn_Hdl {

struct Engine::Implementation {
    // The models are destroyed before the factory that they use.
    CommandFactory factory;
    ModelRegistry models;
    Model* current = nullptr;

    Model* Find(const char* name) const { return models.Find(Port::ViewOf(name)); }

    static void Execute(Model* model, const char* text) {
        if (model == nullptr) {
            Fail(EngineUnit, __LINE__, "Missing Model.\n");
        }
        model->Execute(text);
    }
};

Engine::Engine() : implementation_(std::make_unique<Implementation>()) {}

Engine::~Engine() = default;

bool Engine::CreateAndAddModel(const char* name, const char* sourceFile) {
    if (implementation_->Find(name) != nullptr) {
        return false;
    }
    std::unique_ptr<Model> model(implementation_->factory.CreateModel());
    model->SetName(name == nullptr ? "" : name);
    model->SetSourceFileName(sourceFile);
    implementation_->models.Add(std::move(model));
    return true;
}

bool Engine::UseModel(const char* name) {
    Model* const model = implementation_->Find(name);
    if (model != nullptr) {
        implementation_->current = model;
    }
    return model != nullptr;
}

bool Engine::RemoveModel(const char* name) {
    std::unique_ptr<Model> model = implementation_->models.Remove(Port::ViewOf(name));
    if (model == nullptr) {
        return false;
    }
    if (implementation_->current == model.get()) {
        implementation_->current = nullptr;
    }
    Model::Delete(std::move(model));
    return true;
}

Model* Engine::GetModel(const char* name) const {
    return implementation_->Find(name);
}

void Engine::Execute(const char* text) {
    Implementation::Execute(implementation_->current, text);
}

void Engine::Execute(const char* modelName, const char* text) {
    Implementation::Execute(implementation_->Find(modelName), text);
}

bool Engine::ReadCommandFile(const char* modelName, const char* fileName) {
    if (implementation_->Find(modelName) == nullptr) {
        CreateAndAddModel(modelName, fileName == nullptr ? "" : fileName);
    }
    return implementation_->Find(modelName)->Read(fileName);
}

bool Engine::WriteCommandFile(const char* modelName, const char* fileName) {
    Model* const model = implementation_->Find(modelName);
    return model != nullptr && model->Write(fileName);
}

bool Engine::IsVhdlKeyword(const char* word) {
    return TraitsOf(Language::Vhdl).isReserved(Port::ViewOf(word));
}

bool Engine::IsVerilogKeyword(const char* word) {
    return TraitsOf(Language::Verilog).isReserved(Port::ViewOf(word));
}

void Engine::WriteHalvexHeader(const char* application, const char* command, const char* designName,
                               const char* device, const char* purpose, const char* reference,
                               bool vhdlComments, const char* fileName) {
    TextFileOutStream out(fileName == nullptr ? "" : fileName, false);
    NetlistHeader(application, fileName, command, designName, device, purpose, reference,
                  vhdlComments, out)
        .Write();
}

} // namespace Orn_Hdl
