#include "Orn_Hdl/Readers.h"

#include "Orn_Hdl/Model.h"
#include "Port/Ascii.h"
#include "Readers/Heads.h"
#include "Readers/NetlistMaker.h"
#include "Readers/Top.h"
#include "Readers/Undeclared.h"
#include "Readers/Verilog/HeadReader.h"
#include "Readers/Verilog/ModuleReader.h"
#include "Readers/Verilog/ReadVerilog.h"
#include "Readers/Verilog/UndeclaredReader.h"

#include <algorithm>
#include <utility>

namespace Orn_Hdl {

using Port::ViewOf;

struct VerilogReader::Implementation {
    Readers::VerilogSetup setup;
    Readers::Heads components;
    std::vector<Renaming> renamings;
};

namespace {

using Readers::FailAt;

/// One reading of one file.
class Reading {
public:
    Reading(const char* fileName, const Readers::VerilogSetup& setup,
            const Readers::Heads& components)
        : fileName_(ViewOf(fileName)), setup_(setup) {
        files_.Add(fileName_);
        ReadHeads();
        AddComponents(components);
    }

    /// \return the names that were replaced.
    std::vector<VerilogReader::Renaming> FillNetlist(Netlist& netlist,
                                                     Readers::NetlistSink* sink = nullptr);
    const std::vector<std::string>& GetKeptIncludes() const noexcept { return keptIncludes_; }
    const std::string& GetFileName() const noexcept { return fileName_; }

private:
    void ReadHeads();
    void ReadHeads(const std::string& fileName, bool isLibrary);
    void AddComponents(const Readers::Heads& components);
    void AddUndeclared(const Readers::ModuleHead& top);

    std::string fileName_;
    const Readers::VerilogSetup& setup_;
    Readers::Files files_;
    Readers::Heads heads_;
    std::vector<std::string> keptIncludes_;
};

void Reading::ReadHeads() {
    ReadHeads(fileName_, false);
    for (const std::string& library : setup_.libraries) {
        ReadHeads(library, true);
    }
}

void Reading::ReadHeads(const std::string& fileName, bool isLibrary) {
    Readers::Scanner scanner(files_, setup_);
    scanner.Open(fileName);
    Readers::HeadReader(scanner, heads_, isLibrary).Read();
    if (!isLibrary) {
        keptIncludes_ = scanner.GetKeptIncludes();
    }
}

void Reading::AddComponents(const Readers::Heads& components) {
    for (const auto& component : components.GetAll()) {
        if (Readers::ModuleHead* const head = heads_.Add(component->name, component->place)) {
            head->ports = component->ports;
            head->hasParameters = false;
        }
    }
}

/// Adds heads of the modules that only the connections of their instances tell of.
void Reading::AddUndeclared(const Readers::ModuleHead& top) {
    const bool isComplete =
        std::all_of(top.uses.begin(), top.uses.end(), [this](const Readers::ModuleHead::Use& use) {
            return heads_.Find(use.name) != nullptr;
        });
    if (!isComplete) {
        Readers::Scanner scanner(files_, setup_);
        scanner.Open(files_.GetName(top.source));
        Readers::UndeclaredReader(scanner, heads_, top).Read();
    }
}

std::vector<VerilogReader::Renaming> Reading::FillNetlist(Netlist& netlist,
                                                          Readers::NetlistSink* sink) {
    const Readers::ModuleHead& top = Readers::FindTop(heads_, setup_.top, "module", files_);
    const Readers::ModuleHead* const unfinished = heads_.GetUnfinished();
    if (unfinished != nullptr && unfinished != &top) {
        FailAt(files_, heads_.GetUnfinishedPlace(), "\"endmodule\" does not follow this");
    }
    if (setup_.undeclared == ReaderUndeclared::Infer) {
        AddUndeclared(top);
    }
    Readers::NetlistMaker maker(netlist, setup_.names,
                                {false, true, Readers::IsVerilogKeyword, setup_.keepsName}, sink);
    maker.KeepDontCares(setup_.keepsDontCares);
    Readers::Scanner scanner(files_, setup_);
    scanner.Open(files_.GetName(top.source));
    Readers::ModuleReader(scanner, heads_, top, maker, setup_).Read();
    Readers::SettleUndeclared(files_, heads_, netlist);
    return std::move(maker.GetRenamings());
}

} // namespace

std::vector<std::string> Readers::ReadVerilog(const char* fileName, const VerilogSetup& setup,
                                              const Heads& components, NetlistSink& sink) {
    Reading reading(fileName, setup, components);
    Netlist parts;
    reading.FillNetlist(parts, &sink);
    return reading.GetKeptIncludes();
}

VerilogReader::VerilogReader() : implementation_(std::make_unique<Implementation>()) {}

VerilogReader::~VerilogReader() = default;

void VerilogReader::SetTop(const char* name) {
    implementation_->setup.top = ViewOf(name);
}

void VerilogReader::AddLibrary(const char* fileName) {
    implementation_->setup.libraries.emplace_back(ViewOf(fileName));
}

void VerilogReader::AddLibrary(const Netlist& netlist) {
    implementation_->components.Add(netlist);
}

void VerilogReader::AddIncludeFolder(const char* folder) {
    implementation_->setup.includeFolders.emplace_back(ViewOf(folder));
}

void VerilogReader::Define(const char* name, const char* text) {
    implementation_->setup.macros.emplace_back(ViewOf(name), ViewOf(text));
}

void VerilogReader::SetIncludes(Includes includes) noexcept {
    implementation_->setup.includes = includes;
}

void VerilogReader::SetNames(Names names) noexcept {
    implementation_->setup.names = names;
}

void VerilogReader::SetKeptNames(std::function<bool(std::string_view name)> keeps) {
    implementation_->setup.keepsName = std::move(keeps);
}

void VerilogReader::SetUndeclared(Undeclared undeclared) noexcept {
    implementation_->setup.undeclared = undeclared;
}

void VerilogReader::KeepComments(bool keep) noexcept {
    implementation_->setup.keepsComments = keep;
}

void VerilogReader::KeepAttributes(bool keep) noexcept {
    implementation_->setup.keepsAttributes = keep;
}

void VerilogReader::KeepDontCares(bool keep) noexcept {
    implementation_->setup.keepsDontCares = keep;
}

void VerilogReader::Read(const char* fileName, Model& model) {
    Reading reading(fileName, implementation_->setup, implementation_->components);
    Netlist netlist;
    netlist.SetSourceFileName(reading.GetFileName().c_str());
    std::vector<Renaming> renamings = reading.FillNetlist(netlist);
    StringArray includes(model.GetOptions()->verilog.includePaths);
    for (const std::string& include : reading.GetKeptIncludes()) {
        includes.Add(include.c_str());
    }
    const bool hasDontCares =
        implementation_->setup.keepsDontCares && Readers::HasDontCares(netlist);
    *model.GetNetlist() = std::move(netlist);
    model.GetOptions()->dontCares |= hasDontCares;
    model.GetOptions()->verilog.includePaths = std::move(includes);
    implementation_->renamings = std::move(renamings);
    model.SetModifiedFlag(true);
}

const std::vector<VerilogReader::Renaming>& VerilogReader::GetRenamings() const noexcept {
    return implementation_->renamings;
}

} // namespace Orn_Hdl
