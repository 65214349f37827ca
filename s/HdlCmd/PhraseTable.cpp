#include "HdlCmd/PhraseTable.h"

#include "Containers/EightBytes.h"
#include "Port/Ascii.h"

namespace Orn_Hdl {

PhraseTable::Word::Word(std::string_view text) noexcept : text_(text) {
    if (text.size() < sizeof start_) {
        start_ = EightBytes::ToUpper(EightBytes::LoadShort(text.data(), text.size()));
    } else {
        start_ = EightBytes::ToUpper(EightBytes::Load(text.data()));
        end_ = EightBytes::ToUpper(EightBytes::Load(text.data() + text.size() - sizeof end_));
    }
}

bool PhraseTable::Word::operator==(const Word& other) const noexcept {
    constexpr std::size_t Compared = sizeof start_ + sizeof end_;
    return start_ == other.start_ && end_ == other.end_ && text_.size() == other.text_.size() &&
           (text_.size() <= Compared || Port::EqualIgnoringCase(text_, other.text_));
}

std::size_t PhraseTable::GetChild(std::size_t node, const Word& word) const noexcept {
    for (const Child& child : nodes_[node].children) {
        if (child.word == word) {
            return child.node;
        }
    }
    return None;
}

void PhraseTable::Add(std::string_view phrase, CommandCreator creator) {
    std::size_t node = 0;
    for (bool more = true; more;) {
        const std::size_t end = phrase.find(' ');
        const std::string_view text = phrase.substr(0, end);
        more = end != std::string_view::npos;
        phrase.remove_prefix(more ? end + 1 : phrase.size());
        std::size_t child = GetChild(node, Word(text));
        if (child == None) {
            child = nodes_.size();
            nodes_.emplace_back();
            nodes_[node].children.push_back({Word(texts_.emplace_back(text)), child});
        }
        node = child;
    }
    nodes_[node].creator = creator;
}

std::size_t PhraseTable::GetDescendant(std::size_t node, std::string_view words) const noexcept {
    std::size_t end = words.find(' ');
    while (end != std::string_view::npos &&
           (node = GetChild(node, Word(words.substr(0, end)))) != None) {
        words.remove_prefix(end + 1);
        end = words.find(' ');
    }
    return node == None ? None : GetChild(node, Word(words));
}

CommandCreator PhraseTable::Find(const StringArray& words) const noexcept {
    CommandCreator found = nullptr;
    std::size_t node = 0;
    for (int i = 0; i < words.GetSize() && !nodes_[node].children.empty(); ++i) {
        const std::string_view word = words.GetView(i);
        const std::size_t child = GetChild(node, Word(word));
        node = child != None ? child : GetDescendant(node, word);
        if (node == None) {
            break;
        }
        if (nodes_[node].creator != nullptr) {
            found = nodes_[node].creator;
        }
    }
    return found;
}

} // namespace Orn_Hdl
