// A model as a whole: its parts, its lines and files. What it does to the design stands in the
// files beside this one.
#include "Orn_Hdl/Model.h"

#include "HdlCmd/Script/CommandScript.h"
#include "HdlModel/ModelUse.h"
#include "Orn_Hdl/Commands.h"
#include "Orn_Hdl/Streams.h"

#include <memory>
#include <utility>

namespace Orn_Hdl {

struct Model::Implementation {
    bool modified = false;
    Netlist netlist;
    HdlOptions options;
    CommandManager commands;
    CommandFactory* factory;
    /// The words of the line that is being executed; kept so that a line costs no allocation.
    StringArray words;
    OutputGuard* outputGuard = nullptr;
    int writeError = 0;
    std::uint64_t writeLeftover = 0;
    Port::StringBase<char> writtenFileName;

    explicit Implementation(CommandFactory* commandFactory) : factory(commandFactory) {}
};

OutputGuard::~OutputGuard() = default;

const Port::Folder* OutputGuard::GetFolder(const char* /*fileName*/,
                                           Port::StringBase<char>& /*path*/) {
    return nullptr;
}

Model::Model(CommandFactory* factory)
    : implementation_(std::make_unique<Implementation>(factory)) {}

Model::~Model() {
    // A command that is destroyed may use its model, all of which is still there.
    implementation_->commands.End();
    Use::TakeAway(*this);
}

void Model::Delete(std::unique_ptr<Model> model) noexcept {
    if (model != nullptr && model->innermostUse_ != nullptr) {
        model->endsUnused_ = true;
        static_cast<void>(model.release());
    }
}

bool Model::IsModified() const noexcept {
    return implementation_->modified;
}

void Model::SetModifiedFlag(bool modified) noexcept {
    implementation_->modified = modified;
}

Netlist* Model::GetNetlist() noexcept {
    return &implementation_->netlist;
}

const Netlist* Model::GetNetlist() const noexcept {
    return &implementation_->netlist;
}

HdlOptions* Model::GetOptions() noexcept {
    return &implementation_->options;
}

CommandFactory* Model::GetCommandFactory() const noexcept {
    return implementation_->factory;
}

CommandManager* Model::GetCommandManager() noexcept {
    return &implementation_->commands;
}

Port::StringBase<char> Model::GetName() const {
    return implementation_->netlist.GetName();
}

void Model::SetName(const Port::TextArgument& name) {
    implementation_->netlist.SetName(name == nullptr ? "HDL_NETLIST" : name.Get());
}

Port::StringBase<char> Model::GetSourceFileName() const {
    return implementation_->netlist.GetSourceFileName();
}

void Model::SetSourceFileName(const Port::TextArgument& name) {
    implementation_->netlist.SetSourceFileName(name);
}

bool Model::ExecuteLine(std::string_view line) {
    const Use use(this);
    line = line.substr(0, line.find('\0'));
    // A command may run another line, so the words are taken out while they are in use.
    StringArray words = std::move(implementation_->words);
    words.Empty();
    words.ParseCommandLine(line);
    const bool result = Execute(words);
    if (use.HasModel()) {
        implementation_->words = std::move(words);
    }
    return result;
}

bool Model::Execute(const StringArray& tokens) {
    return tokens.IsEmpty() ||
           implementation_->commands.CreateAndExecute(tokens, this, GetCommandFactory());
}

bool Model::Read(const Port::TextArgument& fileName) {
    const Use use(this);
    CommandReader reader(*this);
    if (!reader.Open(fileName)) {
        SetModifiedFlag(false);
        return false;
    }
    // A line either is executed or throws.
    while (const StringArray* words = reader.Next()) {
        Execute(*words);
        if (!use.HasModel()) {
            return true;
        }
    }
    SetModifiedFlag(false);
    return reader.GetError() == 0;
}

void Model::WriteCommands(OutStream& out) const {
    WriteCommandScript(implementation_->netlist, implementation_->options, out);
}

bool Model::WriteCommands(const Port::TextArgument& fileName) const {
    TextFileOutStream out(fileName.Get(), TextFileOutStream::Replace);
    if (!out.IsOpen()) {
        return false;
    }
    WriteCommands(out);
    out.Close();
    return out.GetError() == 0;
}

bool Model::Write(const Port::TextArgument& /*fileName*/) {
    SetModifiedFlag(false);
    return true;
}

void Model::SetOutputGuard(OutputGuard* guard) noexcept {
    implementation_->outputGuard = guard;
}

OutputGuard* Model::GetOutputGuard() const noexcept {
    return implementation_->outputGuard;
}

void Model::RecordWrite(const Port::TextArgument& fileName, int error, std::uint64_t leftover) {
    implementation_->writtenFileName = fileName.Get();
    implementation_->writeError = error;
    implementation_->writeLeftover = leftover;
}

int Model::GetWriteError() const noexcept {
    return implementation_->writeError;
}

std::uint64_t Model::GetWriteLeftover() const noexcept {
    return implementation_->writeLeftover;
}

Port::StringBase<char> Model::GetWrittenFileName() const {
    return implementation_->writtenFileName;
}

} // namespace Orn_Hdl
