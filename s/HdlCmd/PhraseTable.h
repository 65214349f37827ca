// Finds the command of a line by its leading words.
#pragma once

#include "Orn_Hdl/Commands.h"

#include <cstddef>
#include <string>
#include <string_view>
#include <vector>

namespace Orn_Hdl {

/// The phrases of a factory, letter case ignored, as a tree with one word a node. A line is looked
/// up word by word and given up at the first word that no phrase goes on with, so the words behind
/// the phrase cost nothing.
class PhraseTable {
public:
    /// Enters a phrase, or gives one that is present another creator.
    void Add(std::string_view phrase, CommandCreator creator);
    /// The creator of the longest phrase that the words, joined by one blank, begin with as whole
    /// words; null when there is none.
    CommandCreator Find(const StringArray& words) const noexcept;

private:
    struct Child {
        std::string word;
        std::size_t node;
    };
    struct Node {
        CommandCreator creator = nullptr;
        std::vector<Child> children;
    };

    /// The root is nobody's child.
    static constexpr std::size_t None = 0;

    /// The node behind another one that a word leads to.
    std::size_t GetChild(std::size_t node, std::string_view word) const noexcept;
    /// The same for a word that was in quotes, and may hold blanks and so several words of a
    /// phrase.
    std::size_t GetDescendant(std::size_t node, std::string_view words) const noexcept;

    std::vector<Node> nodes_{1};
};

} // namespace Orn_Hdl
