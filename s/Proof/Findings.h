// The differences that a comparison finds.
#pragma once

#include "Orn_Hdl/Proof.h"
#include "Readers/Place.h"

#include <string>
#include <utility>
#include <vector>

namespace Orn_Hdl::Proving {

/// Thrown when enough differences were found.
struct EnoughFound {};

using Cause = Check::Cause;
using Kind = Check::Cause::Kind;

class Findings {
public:
    /// \throws EnoughFound when this is the last one that is looked for.
    void Add(std::string message, const Readers::Place& place, Cause cause) {
        Proof::Difference difference;
        difference.message = std::move(message);
        difference.line = place.line;
        difference.column = place.column;
        difference.cause = std::move(cause);
        differences_.push_back(std::move(difference));
        if (differences_.size() == Proof::MostDifferences) {
            throw EnoughFound();
        }
    }
    std::vector<Proof::Difference> Take() noexcept { return std::move(differences_); }

private:
    std::vector<Proof::Difference> differences_;
};

} // namespace Orn_Hdl::Proving
