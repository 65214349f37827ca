#include "Orn_Hdl/Model.h"
#include "Orn_Hdl/Readers.h"
#include "Port/Ascii.h"
#include "Readers/Heads.h"
#include "Readers/NetlistMaker.h"
#include "Readers/Top.h"
#include "Readers/Vhdl/ArchitectureReader.h"
#include "Readers/Vhdl/HeadReader.h"
#include "Readers/Vhdl/ReadVhdl.h"
#include "Readers/Vhdl/Types.h"
#include "Readers/Vhdl/WriterOptions.h"

#include <algorithm>
#include <utility>

namespace Orn_Hdl {

using Port::ViewOf;

struct VhdlReader::Implementation {
    Readers::VhdlSetup setup;
    Readers::Heads components{true};
    std::vector<Renaming> renamings;
};

namespace {

namespace Vhdl = Readers::Vhdl;

using Readers::FailAt;
using Readers::ModuleHead;
using Readers::Quoted;

/// One reading of one file.
class Reading {
public:
    /// \param sink gets what is read; null when a netlist does.
    Reading(const char* fileName, const Readers::VhdlSetup& setup, const Readers::Heads& components,
            Readers::NetlistSink* sink = nullptr)
        : fileName_(ViewOf(fileName)), setup_(setup), sink_(sink) {
        files_.Add(fileName_);
        ReadHeads(fileName_, false);
        for (const std::string& library : setup_.libraries) {
            ReadHeads(library, true);
        }
        AddComponents(components);
    }

    /// \return the names that were replaced.
    std::vector<ReaderRenaming> FillNetlist(Netlist& netlist, HdlOptions::VhdlOption& options);
    const std::string& GetFileName() const noexcept { return fileName_; }
    /// What a sink is not told.
    Readers::VhdlFrame& GetFrame() noexcept { return frame_; }

private:
    void ReadHeads(const std::string& fileName, bool isLibrary);
    void AddComponents(const Readers::Heads& components);
    const Vhdl::Architecture& FindArchitecture(const ModuleHead& entity,
                                               const std::string& name) const;
    void SetClauses(const ModuleHead& entity, const Vhdl::Architecture& architecture);
    const Vhdl::Configuration* FindOwnConfiguration(const ModuleHead& entity) const;
    void MarkPrimitives(const ModuleHead& entity, const Netlist& netlist) const;
    void SetOptions(const ModuleHead& entity, const Vhdl::Architecture& architecture,
                    const Vhdl::ArchitectureReader& reader, HdlOptions::VhdlOption& options) const;

    std::string fileName_;
    const Readers::VhdlSetup& setup_;
    Readers::NetlistSink* const sink_;
    Readers::Files files_;
    Vhdl::Design design_;
    Readers::VhdlFrame frame_;
};

void Reading::ReadHeads(const std::string& fileName, bool isLibrary) {
    Vhdl::Scanner scanner(files_);
    scanner.Open(fileName);
    Vhdl::HeadReader(scanner, design_, isLibrary, isLibrary ? nullptr : sink_).Read();
}

void Reading::AddComponents(const Readers::Heads& components) {
    for (const auto& component : components.GetAll()) {
        if (ModuleHead* const head = design_.components.Add(component->name, component->place)) {
            head->ports = component->ports;
            head->parameters = component->parameters;
            head->hasParameters = false;
        }
    }
}

const Vhdl::Architecture& Reading::FindArchitecture(const ModuleHead& entity,
                                                    const std::string& name) const {
    const Vhdl::Architecture* const architecture = design_.FindArchitecture(entity, name);
    if (architecture == nullptr) {
        FailAt(files_, entity.place,
               "the entity " + Quoted(entity.name) + " has no architecture" +
                   (name.empty() ? std::string() : " " + Quoted(name)) + " in this file");
    }
    if (design_.unfinished != nullptr && design_.unfinished != architecture) {
        FailAt(files_, design_.unfinished->place, "\"end\" does not follow this");
    }
    for (const Vhdl::Configuration& configuration : design_.configurations) {
        if (Readers::IsSameName(configuration.entity, entity.name, true) &&
            !configuration.problem.empty()) {
            FailAt(files_, configuration.problemPlace, configuration.problem);
        }
    }
    return *architecture;
}

std::vector<ReaderRenaming> Reading::FillNetlist(Netlist& netlist,
                                                 HdlOptions::VhdlOption& options) {
    std::string top = setup_.top;
    std::string architectureName;
    const std::size_t parenthesis = top.find('(');
    if (parenthesis != std::string::npos && top.back() == ')' && top.front() != '\\') {
        architectureName = top.substr(parenthesis + 1, top.size() - parenthesis - 2);
        top.erase(parenthesis);
    }
    const ModuleHead& entity = Readers::FindTop(design_.entities, top, "entity", files_);
    const Vhdl::Architecture& architecture = FindArchitecture(entity, architectureName);
    Readers::NetlistMaker maker(netlist, setup_.names,
                                {true, false, Vhdl::IsReserved, setup_.keepsName}, sink_);
    maker.KeepDontCares(setup_.keepsDontCares);
    Vhdl::Scanner scanner(files_);
    scanner.Open(fileName_);
    Vhdl::ArchitectureReader reader(scanner, design_, entity, architecture, maker, setup_);
    reader.Read();
    if (sink_ != nullptr) {
        SetClauses(entity, architecture);
        return {};
    }
    MarkPrimitives(entity, netlist);
    SetOptions(entity, architecture, reader, options);
    return std::move(maker.GetRenamings());
}

void Reading::SetClauses(const ModuleHead& entity, const Vhdl::Architecture& architecture) {
    const Vhdl::Clauses& ofEntity = design_.clausesOfEntities.at(&entity);
    const Vhdl::Clauses& ofArchitecture = architecture.clauses;
    frame_.libraries = ofEntity.libraries;
    frame_.uses = ofEntity.uses;
    frame_.architecture = architecture.name;
    frame_.libraries.insert(frame_.libraries.end(), ofArchitecture.libraries.begin(),
                            ofArchitecture.libraries.end());
    frame_.uses.insert(frame_.uses.end(), ofArchitecture.uses.begin(), ofArchitecture.uses.end());
    for (const Vhdl::Configuration& configuration : design_.configurations) {
        frame_.configurations.push_back(configuration.name);
        frame_.configured = configuration.architecture;
        frame_.configuredEntity = configuration.entity;
        frame_.isConfigurationHidden = configuration.isHidden;
    }
}

/// The configuration that a model has; null if the file has none.
const Vhdl::Configuration* Reading::FindOwnConfiguration(const ModuleHead& entity) const {
    const auto found =
        std::find_if(design_.configurations.begin(), design_.configurations.end(),
                     [&entity](const Vhdl::Configuration& configuration) {
                         return Readers::IsSameName(configuration.entity, entity.name, true) &&
                                Readers::IsSameName(configuration.name, "CFG_" + entity.name, true);
                     });
    return found == design_.configurations.end() ? nullptr : &*found;
}

/// Marks the cells of the primitive library, which the configuration of a model leaves out.
void Reading::MarkPrimitives(const ModuleHead& entity, const Netlist& netlist) const {
    const Vhdl::Configuration* const configuration = FindOwnConfiguration(entity);
    if (configuration == nullptr) {
        return;
    }
    for (Component* component : netlist.GetComponentIterator()) {
        const Attribute* const box = component->GetAttr("BOX_TYPE");
        const std::string key = Vhdl::KeyOf(std::string(component->GetNameView()));
        if (box != nullptr && box->GetValueString() == Port::String("BLACK_BOX") &&
            component->GetAttr("LEVEL") == nullptr && configuration->components.count(key) == 0) {
            component->AddAttr(AttributeString::CreateAttribute("LEVEL", "HALVEX"));
        }
    }
}

void Reading::SetOptions(const ModuleHead& entity, const Vhdl::Architecture& architecture,
                         const Vhdl::ArchitectureReader& reader,
                         HdlOptions::VhdlOption& options) const {
    Vhdl::SetClauses(design_.clausesOfEntities.at(&entity), architecture.clauses, options);
    options.suppressConfiguration =
        std::none_of(design_.configurations.begin(), design_.configurations.end(),
                     [&entity](const Vhdl::Configuration& configuration) {
                         return Readers::IsSameName(configuration.entity, entity.name, true) &&
                                Readers::IsSameName(configuration.name, "CFG_" + entity.name, true);
                     });
    options.suppressComponent = !architecture.uses.empty() && !reader.HasEntityInstances() &&
                                architecture.components.GetAll().empty();
    options.useAttrType = reader.HasTypedAttributes();
}

/// Adds the components that heads describe, with the defaults of their generics.
void AddComponents(const Readers::Heads& heads, Readers::NetlistMaker& maker) {
    for (const auto& head : heads.GetAll()) {
        if (!maker.MakeComponent(*head).empty()) {
            continue;
        }
        for (const Readers::ParameterHead& parameter : head->parameters) {
            if (parameter.value) {
                Readers::SetAttribute(*head->component, parameter.name, *parameter.value, "SYN",
                                      nullptr);
            }
        }
    }
}

/// Adds the types of the generics of a netlist's components.
void AddGenerics(const Netlist& netlist, Readers::Heads& heads) {
    for (const Component* component : netlist.GetComponentIterator()) {
        ModuleHead* const head =
            component == nullptr ? nullptr : heads.Find(component->GetNameView());
        if (head == nullptr || !head->parameters.empty()) {
            continue;
        }
        for (const Attribute* attribute : component->GetAttrIterator()) {
            if (attribute->GetGenericOption() == Attribute::GenericNone) {
                continue;
            }
            Readers::ParameterHead parameter;
            parameter.name = attribute->GetNameView();
            parameter.typeName = Vhdl::GetTypeName(*attribute);
            head->parameters.push_back(std::move(parameter));
        }
    }
}

} // namespace

Readers::VhdlFrame Readers::ReadVhdl(const char* fileName, const VhdlSetup& setup,
                                     const Netlist& library, NetlistSink& sink) {
    Heads components{true};
    components.Add(library);
    AddGenerics(library, components);
    Reading reading(fileName, setup, components, &sink);
    Netlist parts;
    HdlOptions::VhdlOption options;
    reading.FillNetlist(parts, options);
    return std::move(reading.GetFrame());
}

VhdlReader::VhdlReader() : implementation_(std::make_unique<Implementation>()) {}

VhdlReader::~VhdlReader() = default;

void VhdlReader::SetTop(const char* name) {
    implementation_->setup.top = ViewOf(name);
}

void VhdlReader::AddLibrary(const char* fileName) {
    implementation_->setup.libraries.emplace_back(ViewOf(fileName));
}

void VhdlReader::AddLibrary(const Netlist& netlist) {
    implementation_->components.Add(netlist);
    AddGenerics(netlist, implementation_->components);
}

void VhdlReader::SetNames(Names names) noexcept {
    implementation_->setup.names = names;
}

void VhdlReader::SetKeptNames(std::function<bool(std::string_view name)> keeps) {
    implementation_->setup.keepsName = std::move(keeps);
}

void VhdlReader::KeepComments(bool keep) noexcept {
    implementation_->setup.keepsComments = keep;
}

void VhdlReader::KeepAttributes(bool keep) noexcept {
    implementation_->setup.keepsAttributes = keep;
}

void VhdlReader::KeepDontCares(bool keep) noexcept {
    implementation_->setup.keepsDontCares = keep;
}

void VhdlReader::ReadComponents(const char* fileName, Netlist& netlist) {
    const std::string name(ViewOf(fileName));
    Readers::Files files;
    files.Add(name);
    Vhdl::Design design;
    Vhdl::Scanner scanner(files);
    scanner.Open(name);
    Vhdl::HeadReader(scanner, design, true).Read();
    Readers::NetlistMaker maker(netlist, ReaderNames::Literal, {true, false, Vhdl::IsReserved});
    AddComponents(design.components, maker);
    AddComponents(design.entities, maker);
}

void VhdlReader::Read(const char* fileName, Model& model) {
    Reading reading(fileName, implementation_->setup, implementation_->components);
    Netlist netlist;
    netlist.SetSourceFileName(reading.GetFileName().c_str());
    HdlOptions::VhdlOption options = model.GetOptions()->vhdl;
    std::vector<Renaming> renamings = reading.FillNetlist(netlist, options);
    const bool hasDontCares =
        implementation_->setup.keepsDontCares && Readers::HasDontCares(netlist);
    *model.GetNetlist() = std::move(netlist);
    model.GetOptions()->dontCares |= hasDontCares;
    model.GetOptions()->vhdl = std::move(options);
    implementation_->renamings = std::move(renamings);
    model.SetModifiedFlag(true);
}

const std::vector<VhdlReader::Renaming>& VhdlReader::GetRenamings() const noexcept {
    return implementation_->renamings;
}

} // namespace Orn_Hdl
