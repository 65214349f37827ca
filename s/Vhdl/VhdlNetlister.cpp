#include "Orn_Hdl/Writers/Vhdl.h"

#include "HdlModel/Names/Names.h"
#include "HdlModel/Netlist/Primitives.h"
#include "HdlModel/Signals/SignalBits.h"
#include "Orn_Hdl/LegalNetlist.h"
#include "Port/Prefetch.h"
#include "Streams/DirectText.h"
#include "Vhdl/InstanceLists.h"
#include "Vhdl/WritePortAssignmentVisitor.h"
#include "Writers/DontCares.h"
#include "Writers/NetlistPass.h"

#include <algorithm>
#include <cstdint>
#include <optional>
#include <vector>

namespace Orn_Hdl {

using std::string_view;
using Writers::Put;
using Writers::PutLine;
using namespace std::literals::string_view_literals;

namespace {

constexpr string_view PortIndentation = "       ";      // 7 blanks
constexpr string_view GenericIndentation = "         "; // 9 blanks

/// The keywords of a generic clause or a generic map.
struct GenericForm {
    string_view keyword;
    string_view separator;
    string_view closing;
};
constexpr GenericForm GenericClause = {"generic", ";", ";"};
constexpr GenericForm GenericMap = {"generic map", ",", ""};

bool IsWritable(string_view name) {
    return Writers::IsWritable(Language::Vhdl, name);
}

/// Whether an assignment can only use the bits of the signal, not the whole signal.
bool IsCompoundOrAgainst(const Signal& signal) {
    return signal.GetSignalType() == SignalTypeCompoundBus || Writers::RunsAgainstParent(signal);
}

/// Whether an alias of the signal must be written bit by bit: a bus of one bit, which is a vector,
/// may be aliased with a bit.
bool IsAliasedByBits(const Signal& signal) {
    return (!SignalBits::IsSingle(signal) && signal.GetWidth() == 1) || IsCompoundOrAgainst(signal);
}

/// Whether the signal is a slice of one bit of a bus with an ascending range. The range of such a
/// slice is written as descending, which VHDL does not allow for a part of that bus.
bool IsOneBitOfAscendingBus(const Signal& signal) {
    if (signal.GetSignalType() != SignalTypeBusSlice || signal.GetWidth() != 1) {
        return false;
    }
    const Bus* const parent = static_cast<const BusSlice&>(signal).GetParentBus();
    return parent != nullptr && parent->GetWidth() > 1 && !parent->IsDownTo();
}

/// The names of the leftmost `count` bits of a signal.
StringArray GetBitNames(const Signal& signal, std::int64_t count) {
    StringArray names;
    SignalBits::ForEach(signal, count, [&names](string_view name) { names.Add(name); });
    return names;
}

bool IsBinary(string_view digits, bool dontCares) {
    return digits.find_first_not_of(dontCares ? "01-" : "01") == string_view::npos;
}

} // namespace

class VhdlNetlister::Writer : private Writers::NetlistPass {
public:
    Writer(OutStream& out, VhdlStatements& statements, StringSet& declared, Netlist& netlist,
           const HdlOptions& options)
        : NetlistPass(Language::Vhdl, out, netlist, options), statements_(statements),
          declared_(declared) {}
    /// Writes parts of what `whole` writes to a stream of their own.
    Writer(OutStream& out, VhdlStatements& statements, const Writer& whole)
        : NetlistPass(out, whole), statements_(statements), declared_(whole.declared_) {}

    void Write();

private:
    class Declarations;
    class Instances;

    void Prepare();
    int GetLongestAttrName(const Writers::SignalLists& signals,
                           const InstanceLists& instances) const;
    void WriteHead();
    void WriteEntity(const Writers::SignalLists& signals);
    void WriteArchitecture(const Writers::SignalLists& signals, const InstanceLists& instances);
    void WriteAttrDeclarations(const std::vector<Signal*>& signals, const InstanceLists& instances);
    void WriteSignalDeclaration(const Signal& signal, int width);
    void WriteComponents(const std::vector<const Component*>& components);
    void WriteComponent(const Component& component);
    void WriteGenericMap(const AttributeHolder& holder);
    void WriteSynthesisAttrAssignment(const std::vector<Signal*>& signals,
                                      const std::vector<const Instance*>& instances);
    void WriteInstanceAttrAssignment(const Instance& instance);
    void WriteConstant(const Signal& signal);
    void WriteConstantBit(string_view name, const BitVectorValue& value);
    void WriteConstantVector(const Signal& signal, const BitVectorValue& value);
    void WriteConstantBits(const Signal& signal, const BitVectorValue& value);
    void WriteAlias(const Signal& signal, const Signal& alias);
    void WriteAliasBits(const StringArray& bits, const StringArray& aliasBits);
    void WriteInstances();
    void WriteInstance(const Instance& instance, WritePortAssignmentVisitor& portMap);
    void WriteInstanceGenericMap(const Instance& instance);
    void WriteConfiguration(const InstanceLists& instances);
    void WriteConfigurationItem(const Component& component,
                                const std::vector<const Instance*>& instances);

    template <class List, class WritePort>
    void WritePortClause(const List& ports, const WritePort& writePort);
    template <class WriteItem>
    void WriteGenerics(const Writers::GenericAttrs& attributes, const GenericForm& form,
                       const WriteItem& writeItem);
    template <class WriteItem>
    void WriteGenericList(const Writers::GenericAttrs& attributes, const GenericForm& form,
                          const WriteItem& writeItem);
    void WriteAttrDeclaration(const AttributeHolder* holder);
    void WriteAttrAssignment(const Signal& signal);

    VhdlStatements& statements_;
    DirectText text_{out_};
    /// The names of the attributes that this file has declared.
    StringSet& declared_;
    /// The width of the column of names in the declarations of attributes.
    int attrWidth_ = 0;
    PtrArray<Attribute*> effectiveAttrs_;
    Writers::GenericAttrs genericAttrs_;
};

/// Writes declarations of signals to a stream of its own.
class VhdlNetlister::Writer::Declarations {
public:
    Declarations(OutStream& out, const Writer& whole, int width)
        : statements_(out), writer_(out, statements_, whole), width_(width) {}
    Declarations(const Declarations&) = delete;
    Declarations& operator=(const Declarations&) = delete;

    void operator()(const Signal& signal) { writer_.WriteSignalDeclaration(signal, width_); }

private:
    VhdlStatements statements_;
    Writer writer_;
    const int width_;
};

/// Writes instances to a stream of its own.
class VhdlNetlister::Writer::Instances {
public:
    Instances(OutStream& out, const Writer& whole)
        : statements_(out), writer_(out, statements_, whole),
          portMap_(whole.options_.onePortPerLine, statements_, out) {}
    Instances(const Instances&) = delete;
    Instances& operator=(const Instances&) = delete;

    void operator()(const Instance& instance) { writer_.WriteInstance(instance, portMap_); }

private:
    VhdlStatements statements_;
    Writer writer_;
    WritePortAssignmentVisitor portMap_;
};

VhdlNetlister::VhdlNetlister(OutStream& out)
    : out_(out), statements_(std::make_unique<VhdlStatements>(out)) {}

VhdlNetlister::VhdlNetlister(const VhdlNetlister& other)
    : out_(other.out_), statements_(std::make_unique<VhdlStatements>(other.out_)),
      declared_(other.declared_) {}

VhdlNetlister::~VhdlNetlister() = default;

void VhdlNetlister::WriteNetlist(Netlist* netlist, const HdlOptions* options) {
    if (netlist == nullptr || options == nullptr) {
        return;
    }
    if (options->legal) {
        LegalNetlist(*netlist, *options).Write(Language::Vhdl, out_);
    } else {
        WriteLiterally(*netlist, *options);
    }
}

void VhdlNetlister::WriteLiterally(Netlist& netlist, const HdlOptions& options) {
    declared_ = StringSet();
    Writer(out_, *statements_, declared_, netlist, options).Write();
}

void VhdlNetlister::Writer::Write() {
    Prepare();
    const Writers::SignalLists signals(netlist_, Language::Vhdl);
    const InstanceLists instances(netlist_);
    attrWidth_ = GetLongestAttrName(signals, instances);
    WriteHead();
    WriteEntity(signals);
    WriteArchitecture(signals, instances);
    out_.WriteEmptyLine();
    if (!options_.vhdl.suppressConfiguration) {
        WriteHidden([this, &instances] { WriteConfiguration(instances); });
        out_.WriteEmptyLine();
    }
}

void VhdlNetlister::Writer::Prepare() {
    netlist_.SetBoxTypeAttribute();
    NetlistPass::Prepare();
    if (!options_.vhdl.openPin) {
        netlist_.ConnectOpenPinToDummy();
    }
}

/// The length of the longest name of an attribute of the netlist or of an object in it.
int VhdlNetlister::Writer::GetLongestAttrName(const Writers::SignalLists& signals,
                                              const InstanceLists& instances) const {
    int longest = std::max(Netlist::GetLongestAttrName(static_cast<AttributeHolder*>(&netlist_)),
                           signals.longestAttr);
    for (const Component* component : netlist_.GetComponentIterator()) {
        longest = std::max(longest, Netlist::GetLongestAttrName(component));
    }
    for (const Instance* instance : instances.GetAttributed()) {
        longest = std::max(longest, Netlist::GetLongestAttrName(instance));
    }
    return longest;
}

void VhdlNetlister::Writer::WriteHead() {
    WriteOpening();
    out_.WriteEmptyLine();
    statements_.WriteUserLibrary(options_.vhdl.libraries);
    statements_.WriteUseUserLibrary(options_.vhdl.useClauses);
    if (options_.vhdl.useDefaultLibrary) {
        statements_.WriteIEEELibrary();
        statements_.WriteKestraLibrary(false);
        out_.WriteEmptyLine();
    }
}

void VhdlNetlister::Writer::WriteEntity(const Writers::SignalLists& signals) {
    const string_view name = netlist_.GetNameView();
    PutLine(out_, "entity", " ", name, " ", "is");
    out_.Indent();
    WriteGenericMap(netlist_);
    const int width = signals.longestPort;
    // VHDL has no empty list of ports.
    if (!signals.ports.empty() || !options_.legal) {
        WritePortClause(signals.ports, [this, width](const Signal& port) {
            statements_.WritePortStatement(port.GetNameView(), port.GetPortPolarity(), width);
        });
    }
    for (const Signal* port : signals.ports) {
        WriteAttrDeclaration(port);
        WriteAttrAssignment(*port);
    }
    out_.Unindent();
    PutLine(out_, "end", " ", name, ";");
}

template <class List, class WritePort>
void VhdlNetlister::Writer::WritePortClause(const List& ports, const WritePort& writePort) {
    Put(out_, "port", " ( ");
    bool isFirst = true;
    for (const auto* port : ports) {
        if (!isFirst) {
            PutLine(out_, "; ");
            Put(out_, PortIndentation);
        }
        isFirst = false;
        writePort(*port);
    }
    PutLine(out_, ");");
}

void VhdlNetlister::Writer::WriteAttrDeclaration(const AttributeHolder* holder) {
    statements_.WriteAttrDeclaration(holder, declared_, options_.vhdl.useAttrType, attrWidth_);
}

void VhdlNetlister::Writer::WriteAttrAssignment(const Signal& signal) {
    if (signal.HasAttrs()) {
        const Port::String baseName(Names::BaseName(signal.GetNameView()));
        statements_.WriteAttrAssignment(&signal, baseName.CStr(), "signal",
                                        options_.vhdl.useAttrType);
    }
}

void VhdlNetlister::Writer::WriteArchitecture(const Writers::SignalLists& signals,
                                              const InstanceLists& instances) {
    PutLine(out_, "architecture", " BEHAVIORAL ", "of", " ", netlist_.GetNameView(), " ", "is");
    out_.Indent();
    WriteAttrDeclarations(signals.attributed, instances);
    const int width = signals.longestDeclared;
    WriteEachSignal(signals.internals,
                    [this, width](OutStream& out) { return Declarations(out, *this, width); });
    if (!options_.vhdl.suppressComponent) {
        WriteComponents(instances.GetComponents());
    }
    WriteSynthesisAttrAssignment(signals.attributed, instances.GetAttributed());
    out_.Unindent();
    PutLine(out_, "begin");
    out_.Indent();
    WriteAssignments(
        signals, [this](const Signal& signal) { WriteConstant(signal); },
        [this](const Signal& signal, const Signal& alias) { WriteAlias(signal, alias); });
    WriteInstances();
    out_.Unindent();
    PutLine(out_, "end", " BEHAVIORAL;");
}

void VhdlNetlister::Writer::WriteAttrDeclarations(const std::vector<Signal*>& signals,
                                                  const InstanceLists& instances) {
    for (const Signal* signal : signals) {
        WriteAttrDeclaration(signal);
    }
    for (const AttributeHolder* holder : instances.GetHolders()) {
        WriteAttrDeclaration(holder);
    }
}

void VhdlNetlister::Writer::WriteSignalDeclaration(const Signal& signal, int width) {
    statements_.WriteComment(&signal);
    if (signal.GetSignalType() == SignalTypeBus) {
        statements_.WriteSignalVectorStatement(signal.GetNameView(), width);
    } else {
        VhdlStatements::WriteSignalStatement(text_, signal.GetNameView(), width);
    }
}

/// Of several components whose names differ only in letter case, the first is written.
void VhdlNetlister::Writer::WriteComponents(const std::vector<const Component*>& components) {
    StringSet written;
    for (const Component* component : components) {
        if (!written.IContains(component->GetNameView())) {
            written.Add(component->GetNameView());
            WriteComponent(*component);
        }
    }
}

void VhdlNetlister::Writer::WriteComponent(const Component& component) {
    statements_.WriteComment(&component);
    PutLine(out_, "component", " ", component.GetNameView());
    out_.Indent();
    WriteGenericMap(component);
    const Iterator<Pin*> pins = component.GetPinIterator();
    if (!pins.IsAtEnd()) {
        const int width = Netlist::GetLongestPinName(pins);
        WritePortClause(pins, [this, width](const Pin& pin) {
            statements_.WritePortStatement(pin.GetNameView(), pin.GetPolarity(), width);
        });
    }
    out_.Unindent();
    PutLine(out_, "end", " ", "component", ";");
    statements_.WriteAttrAssignment(&component, component.GetName().CStr(), "component",
                                    options_.vhdl.useAttrType);
    out_.WriteEmptyLine();
}

void VhdlNetlister::Writer::WriteGenericMap(const AttributeHolder& holder) {
    genericAttrs_.Split(holder.GetAttrIterator());
    WriteGenerics(genericAttrs_, GenericClause,
                  [this](Attribute* attribute) { statements_.WriteGenericMapAttrType(attribute); });
}

/// Writes a generic clause or map. If every item is hidden from synthesis, all of it is hidden.
template <class WriteItem>
void VhdlNetlister::Writer::WriteGenerics(const Writers::GenericAttrs& attributes,
                                          const GenericForm& form, const WriteItem& writeItem) {
    if (!attributes.syn.IsEmpty()) {
        WriteGenericList(attributes, form, writeItem);
    } else if (!attributes.nosyn.IsEmpty()) {
        WriteHidden([&] { WriteGenericList(attributes, form, writeItem); });
    }
}

/// The items that are hidden from synthesis come last.
template <class WriteItem>
void VhdlNetlister::Writer::WriteGenericList(const Writers::GenericAttrs& attributes,
                                             const GenericForm& form, const WriteItem& writeItem) {
    bool isFirst = true;
    const auto writeItems = [&](const PtrArray<Attribute*>& items) {
        for (Attribute* attribute : Iterator<Attribute*>(&items)) {
            if (!isFirst) {
                PutLine(out_, form.separator);
                Put(out_, GenericIndentation);
            }
            isFirst = false;
            writeItem(attribute);
        }
    };
    Put(out_, form.keyword, "( ");
    writeItems(attributes.syn);
    if (attributes.syn.IsEmpty() || attributes.nosyn.IsEmpty()) {
        writeItems(attributes.nosyn);
    } else {
        PutLine(out_);
        WriteHidden([&] {
            writeItems(attributes.nosyn);
            PutLine(out_);
        });
    }
    PutLine(out_, ")", form.closing);
}

void VhdlNetlister::Writer::WriteSynthesisAttrAssignment(
    const std::vector<Signal*>& signals, const std::vector<const Instance*>& instances) {
    for (const Signal* signal : signals) {
        WriteAttrAssignment(*signal);
    }
    for (const Instance* instance : instances) {
        WriteInstanceAttrAssignment(*instance);
    }
}

/// Generics that the component's declaration sets already are not repeated.
void VhdlNetlister::Writer::WriteInstanceAttrAssignment(const Instance& instance) {
    for (Attribute* attribute : instance.GetAttrIterator()) {
        if (attribute->GetSynAttrOption() == Attribute::SynAttrNone) {
            continue;
        }
        const Attribute* const inherited = instance.GetComponentAttr(attribute->GetName().CStr());
        if (inherited == nullptr || *inherited != *attribute) {
            statements_.WriteAttrAssignment(attribute, instance.GetName().CStr(), "label",
                                            options_.vhdl.useAttrType);
        }
    }
}

void VhdlNetlister::Writer::WriteConstant(const Signal& signal) {
    const BitVectorValue& value = signal.GetConstantValue();
    if (SignalBits::IsSingle(signal)) {
        WriteConstantBit(signal.GetNameView(), value);
    } else if (options_.dontCares && Writers::HasDontCare(value)) {
        WriteConstantVector(signal, Writers::InVhdl(value));
    } else {
        WriteConstantVector(signal, value);
    }
}

void VhdlNetlister::Writer::WriteConstantVector(const Signal& signal, const BitVectorValue& value) {
    if (IsCompoundOrAgainst(signal) || IsOneBitOfAscendingBus(signal)) {
        WriteConstantBits(signal, value);
    } else {
        statements_.WriteConstantSignalAssignment(signal.GetNameView(), false, value);
    }
}

void VhdlNetlister::Writer::WriteConstantBit(string_view name, const BitVectorValue& value) {
    if (options_.dontCares && Writers::IsDontCare(value)) {
        statements_.WriteSignalAssignment(name, "'-'");
    } else {
        statements_.WriteConstantSignalAssignment(name, true, value);
    }
}

/// Writes nothing if the digits of the constant are not the bits of the signal.
void VhdlNetlister::Writer::WriteConstantBits(const Signal& signal, const BitVectorValue& value) {
    const string_view digits = value.GetValue();
    const std::optional<std::int64_t> count = SignalBits::Count(signal);
    if (value.GetBase() != 2 || !IsBinary(digits, options_.dontCares) || !count ||
        digits.size() != static_cast<std::size_t>(*count)) {
        return;
    }
    std::size_t position = 0;
    SignalBits::ForEach(signal, *count, [this, digits, &position](string_view bit) {
        const Port::String digit(digits.substr(position++, 1));
        if (IsWritable(bit)) {
            WriteConstantBit(bit, BitVectorValue(digit.CStr()));
        }
    });
}

void VhdlNetlister::Writer::WriteAlias(const Signal& signal, const Signal& alias) {
    if (IsAliasedByBits(signal) || IsAliasedByBits(alias)) {
        const std::optional<std::int64_t> count = SignalBits::Count(signal);
        const std::optional<std::int64_t> aliasCount = SignalBits::Count(alias);
        // The names of the bits are held in memory, so the narrower side must not be too wide
        // either.
        const std::int64_t narrower = std::min(count.value_or(0), aliasCount.value_or(0));
        if (count && aliasCount && narrower <= Names::MostExpandedBits) {
            WriteAliasBits(GetBitNames(signal, narrower), GetBitNames(alias, narrower));
            return;
        }
    }
    statements_.WriteSignalAssignment(signal.GetNameView(), alias.GetNameView());
}

void VhdlNetlister::Writer::WriteAliasBits(const StringArray& bits, const StringArray& aliasBits) {
    for (int i = 0; i < std::min(bits.GetSize(), aliasBits.GetSize()); ++i) {
        if (IsWritable(bits.GetView(i)) && IsWritable(aliasBits.GetView(i))) {
            statements_.WriteSignalAssignment(bits.GetView(i), aliasBits.GetView(i));
        }
    }
}

void VhdlNetlister::Writer::WriteInstances() {
    WriteEachInstance([this](OutStream& out) { return Instances(out, *this); });
}

void VhdlNetlister::Writer::WriteInstance(const Instance& instance,
                                          WritePortAssignmentVisitor& portMap) {
    const Component* const component = instance.GetComponent();
    statements_.WriteComment(&instance);
    text_.PutLine(instance.GetNameView(), " : ",
                  component == nullptr ? string_view() : component->GetNameView());
    WriteInstanceGenericMap(instance);
    out_.Indent();
    const Iterator<Pin*> pins = instance.GetPinIterator();
    if (!pins.IsAtEnd()) {
        text_.Put("port", " ", "map", " (");
        portMap.BeginPortMap();
        for (const Pin* pin : pins) {
            portMap.WritePin(*pin);
        }
        text_.Put(")");
    }
    text_.PutLine(";");
    out_.Unindent();
}

void VhdlNetlister::Writer::WriteInstanceGenericMap(const Instance& instance) {
    if (Writers::GetEffectiveAttrs(instance, effectiveAttrs_); effectiveAttrs_.IsEmpty()) {
        return;
    }
    genericAttrs_.Split(Iterator<Attribute*>(&effectiveAttrs_));
    Attribute* const init = FindPassedInit(genericAttrs_);
    if (init != nullptr) {
        genericAttrs_.syn.Remove(init);
        genericAttrs_.nosyn.Remove(init);
        genericAttrs_.syn.InsertAt(0, init);
    }
    out_.Indent();
    WriteGenerics(genericAttrs_, GenericMap, [this, init](Attribute* attribute) {
        if (attribute == init) {
            statements_.WriteGenericMapInitAttr(attribute);
        } else {
            statements_.WriteGenericMapAttr(attribute);
        }
    });
    out_.Unindent();
}

void VhdlNetlister::Writer::WriteConfiguration(const InstanceLists& instances) {
    const string_view name = netlist_.GetNameView();
    PutLine(out_, "configuration", " ", "CFG_", name, " ", "of", "  ", name, " ", "is");
    out_.Indent();
    PutLine(out_, "for", " ", "BEHAVIORAL");
    out_.Indent();
    for (const Component* component : netlist_.GetComponentIterator()) {
        // Cells of the primitive library need no configuration.
        const std::vector<const Instance*>& placed = instances.GetInstances(component);
        if (!placed.empty() && !IsPrimitive(*component)) {
            WriteConfigurationItem(*component, placed);
        }
    }
    out_.Unindent();
    PutLine(out_, "end", " ", "for", ";");
    out_.Unindent();
    PutLine(out_, "end", " ", "CFG_", name, ";");
}

void VhdlNetlister::Writer::WriteConfigurationItem(const Component& component,
                                                   const std::vector<const Instance*>& instances) {
    Put(out_, "for", " ");
    constexpr std::size_t Lead = 8;
    for (std::size_t i = 0; i < instances.size(); ++i) {
        Port::Prefetch(instances[std::min(i + Lead, instances.size() - 1)]);
        text_.Put((i == 0 ? ""sv : ", "sv), instances[i]->GetNameView());
    }
    PutLine(out_, " : ", component.GetNameView());
    out_.Indent();
    PutLine(out_, "use", " ", "configuration", " ", "WORK.CFG_", component.GetNameView(), ";");
    out_.Unindent();
    PutLine(out_, "end", " ", "for", ";");
}

} // namespace Orn_Hdl
