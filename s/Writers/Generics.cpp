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
/// Marks in the name of a netlist that models a cell of the HALVEX library and consists of such
/// cells. INIT is the contents of such a cell: the netlist gets it as a parameter or generic and
/// passes it on to the cells inside.
constexpr std::string_view MacroMark = "MHALVEX";
constexpr std::string_view VerilogMacroMark = "HHALVEX";
/// \}

/// The second mark is only used in Verilog. The languages do not require that: it keeps the bytes
/// of existing netlists.
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
