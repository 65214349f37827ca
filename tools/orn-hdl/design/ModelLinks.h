// Which components of the models of a design are models of it, too.
#pragma once

#include <cstddef>
#include <optional>
#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

namespace Orn_Hdl {
class Model;
}

namespace Tool {

class ModelLinks {
public:
    /// \param models must outlive this object. Of several models of one name, the first one is
    ///        found.
    explicit ModelLinks(const std::vector<Orn_Hdl::Model*>& models);

    /// The index of the model of that name, letter case ignored.
    std::optional<std::size_t> Find(std::string_view name) const;
    /// The indices of all models, used ones first; empty if one contains itself.
    std::vector<std::size_t> Order();
    /// Once `Order` has returned nothing: the models that contain each other, the first one again
    /// at the end.
    const std::vector<std::size_t>& GetChain() const noexcept { return chain_; }

private:
    bool Visit(std::size_t model, std::vector<std::size_t>& order);
    void FindUses(std::size_t model);

    enum class State { New, Open, Done };

    const std::vector<Orn_Hdl::Model*> models_;
    std::unordered_map<std::string, std::size_t> byName_;
    /// By model: the models that it uses.
    std::vector<std::vector<std::size_t>> uses_;
    std::vector<State> states_;
    std::vector<std::size_t> chain_;
};

} // namespace Tool
