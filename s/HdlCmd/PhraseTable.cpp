#include "HdlCmd/PhraseTable.h"

#include "Port/Ascii.h"

namespace Orn_Hdl {

std::size_t PhraseTable::GetChild(std::size_t node, std::string_view word) const noexcept {
    for (const Child& child : nodes_[node].children) {
        if (Port::EqualIgnoringCase(child.word, word)) {
            return child.node;
        }
    }
    return None;
}

void PhraseTable::Add(std::string_view phrase, CommandCreator creator,
                      const RegisteredCommand* own) {
    std::size_t node = 0;
    for (bool more = true; more;) {
        const std::size_t end = phrase.find(' ');
        const std::string_view text = phrase.substr(0, end);
        more = end != std::string_view::npos;
        phrase.remove_prefix(more ? end + 1 : phrase.size());
        std::size_t child = GetChild(node, text);
        if (child == None) {
            child = nodes_.size();
            nodes_.emplace_back();
            nodes_[node].children.push_back({std::string(text), child});
        }
        node = child;
    }
    nodes_[node].creator = creator;
    nodes_[node].own = own;
}

std::size_t PhraseTable::GetDescendant(std::size_t node, std::string_view words) const noexcept {
    std::size_t end = words.find(' ');
    while (end != std::string_view::npos && (node = GetChild(node, words.substr(0, end))) != None) {
        words.remove_prefix(end + 1);
        end = words.find(' ');
    }
    return node == None ? None : GetChild(node, words);
}

PhraseTable::Match PhraseTable::Find(const StringArray& words) const noexcept {
    Match found;
    std::size_t node = 0;
    for (int i = 0; i < words.GetSize() && !nodes_[node].children.empty(); ++i) {
        const std::string_view word = words.GetView(i);
        const std::size_t child = GetChild(node, word);
        node = child != None ? child : GetDescendant(node, word);
        if (node == None) {
            break;
        }
        if (nodes_[node].creator != nullptr) {
            found = {nodes_[node].creator, nodes_[node].own, i + 1};
        }
    }
    return found;
}

} // namespace Orn_Hdl
