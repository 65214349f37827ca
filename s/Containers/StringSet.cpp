#include "Orn_Hdl/Containers/StringSet.h"

#include "Containers/NameTable.h"
#include "Port/Ascii.h"

#include <utility>

namespace Orn_Hdl {

const Port::StringBase<char> StringSetIterator::operator*() const {
    return GetView();
}

std::string_view StringSetIterator::GetView() const noexcept {
    return position_ == nullptr ? std::string_view()
                                : static_cast<const NameTable::Node*>(position_)->name;
}

StringSetIterator& StringSetIterator::operator++() noexcept {
    if (position_ != nullptr) {
        position_ = static_cast<const NameTable::Node*>(position_)->next;
    }
    return *this;
}

StringSet::StringSet()
    : ignoringCase_(std::make_unique<NameTable>(true)),
      keepingCase_(std::make_unique<NameTable>(false)) {}

StringSet::StringSet(const StringSet& other)
    : ignoringCase_(std::make_unique<NameTable>(*other.ignoringCase_)),
      keepingCase_(std::make_unique<NameTable>(*other.keepingCase_)) {}

StringSet& StringSet::operator=(const StringSet& other) {
    if (this != &other) {
        StringSet copy(other);
        std::swap(ignoringCase_, copy.ignoringCase_);
        std::swap(keepingCase_, copy.keepingCase_);
    }
    return *this;
}

StringSet::~StringSet() = default;

void StringSet::Add(const char* name) {
    Add(Port::ViewOf(name));
}

void StringSet::Add(std::string_view name) {
    ignoringCase_->Insert(name);
    keepingCase_->Insert(name);
}

bool StringSet::Contains(const char* name) const noexcept {
    return Contains(Port::ViewOf(name));
}

bool StringSet::Contains(std::string_view name) const noexcept {
    return keepingCase_->Contains(name);
}

bool StringSet::IContains(const char* name) const noexcept {
    return IContains(Port::ViewOf(name));
}

bool StringSet::IContains(std::string_view name) const noexcept {
    return ignoringCase_->Contains(name);
}

void StringSet::Remove(const char* name) noexcept {
    Remove(Port::ViewOf(name));
}

void StringSet::Remove(std::string_view name) noexcept {
    ignoringCase_->Remove(name);
    keepingCase_->Remove(name);
}

bool StringSet::IsEmpty() const noexcept {
    return keepingCase_->IsEmpty();
}

void StringSet::Empty() noexcept {
    keepingCase_->Empty();
}

StringSetIterator StringSet::GetBeginPos() const noexcept {
    return StringSetIterator(keepingCase_->GetFirst());
}

} // namespace Orn_Hdl
