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
    unsigned threads = HdlOptions().threads;

    Model* Find(const char* name) const { return models.Find(Port::ViewOf(name)); }

    static void Execute(Model* model, const char* text) {
        if (model == nullptr) {
            Fail(EngineUnit, __LINE__, "Missing Model.\n");
        }
        model->Execute(text);
    }
};

Engine::Engine() : implementation_(std::make_unique<Implementation>()) {}

// NOLINTNEXTLINE(performance-noexcept-move-constructor)
Engine::Engine(Engine&& other) : Engine() {
    implementation_.swap(other.implementation_);
}

// NOLINTNEXTLINE(performance-noexcept-move-constructor)
Engine& Engine::operator=(Engine&& other) {
    Engine taken(std::move(other));
    implementation_.swap(taken.implementation_);
    return *this;
}

Engine::~Engine() = default;

bool Engine::CreateAndAddModel(const Port::TextArgument& name,
                               const Port::TextArgument& sourceFile) {
    if (implementation_->Find(name) != nullptr) {
        return false;
    }
    std::unique_ptr<Model> model(implementation_->factory.CreateModel());
    model->SetName(name.GetView());
    model->SetSourceFileName(sourceFile);
    model->GetOptions()->threads = implementation_->threads;
    implementation_->models.Add(std::move(model));
    return true;
}

bool Engine::UseModel(const Port::TextArgument& name) {
    Model* const model = implementation_->Find(name);
    if (model != nullptr) {
        implementation_->current = model;
    }
    return model != nullptr;
}

bool Engine::RemoveModel(const Port::TextArgument& name) {
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

Model* Engine::GetModel(const Port::TextArgument& name) const {
    return implementation_->Find(name);
}

void Engine::SetThreads(unsigned threads) noexcept {
    implementation_->threads = threads;
    implementation_->models.ForEach(
        [threads](Model& model) { model.GetOptions()->threads = threads; });
}

unsigned Engine::GetThreads() const noexcept {
    return implementation_->threads;
}

void Engine::Execute(const Port::TextArgument& text) {
    Implementation::Execute(implementation_->current, text);
}

void Engine::Execute(const Port::TextArgument& modelName, const Port::TextArgument& text) {
    Implementation::Execute(implementation_->Find(modelName), text);
}

bool Engine::ReadCommandFile(const Port::TextArgument& modelName,
                             const Port::TextArgument& fileName) {
    if (implementation_->Find(modelName) == nullptr) {
        CreateAndAddModel(modelName, fileName.GetView());
    }
    return implementation_->Find(modelName)->Read(fileName);
}

bool Engine::WriteCommandFile(const Port::TextArgument& modelName,
                              const Port::TextArgument& fileName) {
    Model* const model = implementation_->Find(modelName);
    return model != nullptr && model->Write(fileName);
}

bool Engine::IsVhdlKeyword(const Port::TextArgument& word) {
    return TraitsOf(Language::Vhdl).isReserved(Port::ViewOf(word));
}

bool Engine::IsVerilogKeyword(const Port::TextArgument& word) {
    return TraitsOf(Language::Verilog).isReserved(Port::ViewOf(word));
}

void Engine::WriteHalvexHeader(const Port::TextArgument& application,
                               const Port::TextArgument& command,
                               const Port::TextArgument& designName,
                               const Port::TextArgument& device, const Port::TextArgument& purpose,
                               const Port::TextArgument& reference, bool vhdlComments,
                               const Port::TextArgument& fileName) {
    TextFileOutStream out(fileName == nullptr ? "" : fileName.Get(), false);
    NetlistHeader(application.Get(), fileName.Get(), command.Get(), designName.Get(), device.Get(),
                  purpose.Get(), reference.Get(), vhdlComments, out)
        .Write();
}

} // namespace Orn_Hdl
