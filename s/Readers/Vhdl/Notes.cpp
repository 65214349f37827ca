#include "Readers/Vhdl/Notes.h"

#include <cstddef>

namespace Orn_Hdl::Readers::Vhdl {

namespace {

bool IsSwitch(std::string_view text) {
    bool isHidden = false;
    return text.find("translate_o") != std::string_view::npos && TakeSwitch(text, isHidden);
}

bool IsAny(std::string_view /*text*/) {
    return true;
}

} // namespace

void Notes::Collect(bool isOn) {
    scanner_.SetCommentFilter(!isOn ? nullptr : keepsComments_ ? IsAny : IsSwitch);
}

void Notes::TakeBefore() {
    std::vector<Comment>& comments = scanner_.GetComments();
    if (comments.empty()) {
        return;
    }
    for (const Comment& comment : comments) {
        if (!TakeSwitch(comment.text, isHidden_, obeysAll_) && keepsComments_) {
            AddLines(comment, lines_);
        }
    }
    comments.clear();
}

void Notes::TakeInside() {
    std::vector<Comment>& comments = scanner_.GetComments();
    if (comments.empty()) {
        return;
    }
    for (const Comment& comment : comments) {
        TakeSwitch(comment.text, isHidden_, obeysAll_);
    }
    comments.clear();
}

void Notes::GiveTo(Object& object) {
    for (const std::string& line : lines_) {
        object.AddComment(line.c_str());
    }
    lines_.clear();
}

void Notes::GiveUnitTo(Object& object) {
    TakeBefore();
    DropBanner(lines_, '-');
    GiveTo(object);
}

void Notes::EndStatement() {
    lines_.clear();
    std::vector<Comment>& comments = scanner_.GetComments();
    const Place& end = scanner_.GetFormerPlace();
    std::size_t count = 0;
    for (; count < comments.size(); ++count) {
        const Place& place = comments[count].place;
        if (place.line > end.line || (place.line == end.line && place.column > end.column)) {
            break;
        }
        TakeSwitch(comments[count].text, isHidden_, obeysAll_);
    }
    comments.erase(comments.begin(), comments.begin() + static_cast<std::ptrdiff_t>(count));
}

void Notes::Drop() {
    lines_.clear();
}

} // namespace Orn_Hdl::Readers::Vhdl
