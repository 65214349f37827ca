// The legal netlists of several models that use each other.
#pragma once

#include "Port/NameScope.h"

#include <cstddef>
#include <memory>
#include <optional>
#include <string>
#include <unordered_map>
#include <vector>

namespace Orn_Hdl {
class Component;
class LegalNetlist;
class Model;
} // namespace Orn_Hdl

namespace Tool {

/// The legal netlists of a design of several models. A model or a port that gets another name gets
/// it in every instance, too: the components of the models are changed for that.
class LegalDesign {
public:
    /// \param models those that are used come first; they must outlive this object.
    explicit LegalDesign(const std::vector<Orn_Hdl::Model*>& models);
    LegalDesign(const LegalDesign&) = delete;
    LegalDesign& operator=(const LegalDesign&) = delete;
    ~LegalDesign();

    /// The legal netlist of a model, by its index.
    Orn_Hdl::LegalNetlist& Get(std::size_t model) const { return *netlists_[model]; }
    /// What keeps the names from agreeing; empty for nothing.
    const std::string& GetProblem() const noexcept { return problem_; }

private:
    void Plan(Orn_Hdl::Model& model);
    void RenameComponents(Orn_Hdl::Model& model);
    void RenamePins(Orn_Hdl::Model& model, Orn_Hdl::Component& component, std::size_t used) const;
    const std::size_t* FindPlanned(const Orn_Hdl::Component& component) const;
    void FindProblem();

    const std::vector<Orn_Hdl::Model*> models_;
    std::vector<std::unique_ptr<Orn_Hdl::LegalNetlist>> netlists_;
    /// The index of each model that is planned, by the name that it had without the marks of an
    /// escaped name.
    std::unordered_map<std::string, std::size_t> planned_;
    /// By the name as models compare it.
    std::unordered_map<std::string, std::size_t> plannedKeys_;
    Port::NameScope names_;
    std::string problem_;
};

} // namespace Tool
