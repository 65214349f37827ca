// Finds the command of a line by its leading words.
#pragma once

#include "HdlCmd/Catalogue.h"

#include <cstddef>
#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

namespace Orn_Hdl {

/// The phrases of a factory as a tree with one word a node; letter case is ignored. A line is
/// looked up word by word until no phrase continues with the next word, so its arguments cost
/// nothing.
class PhraseTable {
public:
    /// The command of a phrase.
    struct Match {
        /// Null if there is none.
        CommandCreator creator = nullptr;
        /// The command of the language that has the creator; null if a program registered it.
        const RegisteredCommand* own = nullptr;
        /// How many words of the line the phrase takes. A quoted word can hold several of its own.
        int words = 0;
    };

    /// Enters a phrase, or gives a present one another command.
    /// \param own the command of the language that has the creator; null for other creators.
    void Add(std::string_view phrase, CommandCreator creator, const RegisteredCommand* own);
    /// The command of the longest phrase that the words, joined by one blank, begin with. A phrase
    /// ends where a word ends.
    Match Find(const StringArray& words) const noexcept;

private:
    /// A word with what tells most words apart, made once to be compared with many.
    struct Key {
        explicit Key(std::string_view word) noexcept;

        std::string_view word;
        /// Up to eight characters that the word begins with, in upper case.
        std::uint64_t start;
    };
    struct Child {
        std::string word;
        std::uint64_t start;
        std::size_t node;
    };
    struct Node {
        CommandCreator creator = nullptr;
        const RegisteredCommand* own = nullptr;
        std::vector<Child> children;
    };

    /// No node: index 0 is the root, which is no node's child.
    static constexpr std::size_t None = 0;

    /// The child of a node for one word; `None` if there is none.
    std::size_t GetChild(std::size_t node, const Key& key) const noexcept;
    /// The descendant of a node for a quoted word that contains blanks, and so several words of a
    /// phrase; `None` if there is none, or no blank.
    std::size_t GetDescendant(std::size_t node, std::string_view words) const noexcept;

    std::vector<Node> nodes_{1};
};

} // namespace Orn_Hdl
