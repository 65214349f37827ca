#include "Readers/Top.h"

#include <set>

namespace Orn_Hdl::Readers {

namespace {

constexpr Place Whole{0, 0, 0};

const ModuleHead& FindOnlyTop(const Heads& heads, std::string_view kind, const Files& files) {
    std::set<const ModuleHead*> used;
    for (const auto& head : heads.GetAll()) {
        for (const ModuleHead::Use& use : head->uses) {
            used.insert(heads.Find(use.name));
        }
    }
    const ModuleHead* top = nullptr;
    std::string names;
    for (const auto& head : heads.GetAll()) {
        if (head->canBeTop && used.find(head.get()) == used.end()) {
            names.append(names.empty() ? "" : ", ").append(Quoted(head->name));
            top = top == nullptr ? head.get() : top;
        }
    }
    const std::string word(kind);
    if (top == nullptr) {
        FailAt(files, Whole, "there is no " + word + " that no other one instantiates");
    }
    if (names != Quoted(top->name)) {
        FailAt(files, Whole, "no " + word + " instantiates " + names + ": say which one to read");
    }
    return *top;
}

} // namespace

const ModuleHead& FindTop(const Heads& heads, const std::string& name, std::string_view kind,
                          const Files& files) {
    if (name.empty()) {
        return FindOnlyTop(heads, kind, files);
    }
    const ModuleHead* const top = heads.Find(name);
    if (top == nullptr || top->isPrimitive) {
        FailAt(files, Whole, "there is no " + std::string(kind) + " " + Quoted(name));
    }
    return *top;
}

} // namespace Orn_Hdl::Readers
