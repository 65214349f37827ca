#include "HdlCmd/PhraseTable.h"

#include "Containers/EightBytes.h"
#include "Port/Ascii.h"

namespace Orn_Hdl {

inline PhraseTable::Key::Key(std::string_view text) noexcept
    : word(text), start(EightBytes::ToUpper(text.size() < EightBytes::Count
                                                ? EightBytes::LoadShort(text.data(), text.size())
                                                : EightBytes::Load(text.data()))) {}

inline std::size_t PhraseTable::GetChild(std::size_t node, const Key& key) const noexcept {
    const std::size_t size = key.word.size();
    for (const Child& child : nodes_[node].children) {
        // Words of up to eight characters that have one length and one start are the same.
        if (child.start == key.start && child.word.size() == size &&
            (size <= EightBytes::Count || Port::EqualIgnoringCase(child.word, key.word))) {
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
        const Key key(text);
        std::size_t child = GetChild(node, key);
        if (child == None) {
            child = nodes_.size();
            nodes_.emplace_back();
            nodes_[node].children.push_back({std::string(text), key.start, child});
        }
        node = child;
    }
    nodes_[node].creator = creator;
    nodes_[node].own = own;
}

std::size_t PhraseTable::GetDescendant(std::size_t node, std::string_view words) const noexcept {
    std::size_t end = words.find(' ');
    if (end == std::string_view::npos) {
        return None;
    }
    while (end != std::string_view::npos &&
           (node = GetChild(node, Key(words.substr(0, end)))) != None) {
        words.remove_prefix(end + 1);
        end = words.find(' ');
    }
    return node == None ? None : GetChild(node, Key(words));
}

PhraseTable::Match PhraseTable::Find(const StringArray& words) const noexcept {
    std::size_t found = None;
    int length = 0;
    const int count = words.GetSize();
    std::size_t node = 0;
    for (int i = 0; i < count && !nodes_[node].children.empty(); ++i) {
        const std::string_view word = words.GetView(i);
        const std::size_t child = GetChild(node, Key(word));
        node = child != None ? child : GetDescendant(node, word);
        if (node == None) {
            break;
        }
        if (nodes_[node].creator != nullptr) {
            found = node;
            length = i + 1;
        }
    }
    return {nodes_[found].creator, nodes_[found].own, length};
}

} // namespace Orn_Hdl
