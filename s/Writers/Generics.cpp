#include "Writers/Generics.h"

namespace Orn_Hdl::Writers {

namespace {

Attribute* FindInitIn(const PtrArray<Attribute*>& attributes) {
    for (Attribute* attribute : Iterator<Attribute*>(&attributes)) {
        if (attribute->GetNameView() == "INIT") {
            return attribute;
        }
    }
    return nullptr;
}

/// \{
/// The marks, in any place of its name, of a netlist that stands for a cell of the HALVEX library
/// and is made of such cells. INIT is the contents of such a cell, so whoever places the netlist
/// says what the cells in it hold.
constexpr std::string_view MacroMark = "MHALVEX";
constexpr std::string_view VerilogMacroMark = "HHALVEX";
/// \}

/// The second mark counts in Verilog alone. Nothing in the languages asks for that: netlists have
/// always been written so, and their bytes are kept.
bool HasInitMark(Language language, std::string_view name) {
    return name.find(MacroMark) != std::string_view::npos ||
           (language == Language::Verilog && name.find(VerilogMacroMark) != std::string_view::npos);
}

} // namespace

void GenericAttrs::Split(const Iterator<Attribute*>& attributes) {
    syn.Empty();
    nosyn.Empty();
    for (Attribute* attribute : attributes) {
        if (attribute == nullptr) {
            continue;
        }
        if (attribute->GetGenericOption() == Attribute::GenericSyn) {
            syn.Add(attribute);
        } else if (attribute->GetGenericOption() == Attribute::GenericNoSyn) {
            nosyn.Add(attribute);
        }
    }
}

Attribute* GenericAttrs::FindInit() const {
    Attribute* const init = FindInitIn(syn);
    return init != nullptr ? init : FindInitIn(nosyn);
}

bool PassesInit(Language language, const Netlist& netlist) {
    return HasInitMark(language, netlist.GetNameView()) &&
           GenericAttrs(netlist.GetAttrIterator()).FindInit() != nullptr;
}

} // namespace Orn_Hdl::Writers
