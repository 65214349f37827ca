#include "C/Texts.h"

#include <cstdlib>
#include <new>
#include <string>
#include <vector>

namespace Orn_Hdl::CInterface {

namespace {

struct PlacedText {
    orn_hdl_text_t* target;
    std::size_t start;
    std::size_t length;
};

struct ThreadTexts {
    std::string bytes;
    std::vector<PlacedText> texts;
};

thread_local ThreadTexts threadTexts;

} // namespace

Texts::Texts() noexcept {
    threadTexts.bytes.clear();
    threadTexts.texts.clear();
}

void Texts::Put(orn_hdl_text_t& target, std::string_view text) {
    const std::size_t start = threadTexts.bytes.size();
    threadTexts.bytes.append(text).push_back('\0');
    threadTexts.texts.push_back({&target, start, text.size()});
}

void Texts::HandOut() noexcept {
    for (const PlacedText& text : threadTexts.texts) {
        text.target->data = threadTexts.bytes.data() + text.start;
        text.target->length = text.length;
    }
    threadTexts.texts.clear();
}

void HandOutText(orn_hdl_text_t& target, std::string_view text) {
    Texts texts;
    texts.Put(target, text);
    texts.HandOut();
}

void HandOutCopy(std::string_view text, char** target, std::size_t* length) {
    auto* const copy = static_cast<char*>(std::malloc(text.size() + 1));
    if (copy == nullptr) {
        throw std::bad_alloc();
    }
    text.copy(copy, text.size());
    copy[text.size()] = '\0';
    *target = copy;
    if (length != nullptr) {
        *length = text.size();
    }
}

} // namespace Orn_Hdl::CInterface
