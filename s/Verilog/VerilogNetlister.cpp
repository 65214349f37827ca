#include "Orn_Hdl/Writers/Verilog.h"

#include "HdlModel/Names/Names.h"
#include "HdlModel/Signals/SignalBits.h"
#include "Orn_Hdl/LegalNetlist.h"
#include "Verilog/Dialects.h"
#include "Verilog/WriteSignalVisitor.h"
#include "Writers/DontCares.h"
#include "Writers/NetlistPass.h"

namespace Orn_Hdl {

using std::string_view;
using Writers::Put;
using Writers::PutLine;

namespace {

/// The columns before the first port's name besides the module's name: "module", "(" and blanks.
constexpr std::size_t ModuleHeadLength = 8;
/// The columns before the first pin of an instance besides both names.
constexpr std::size_t InstanceHeadLength = 3;

/// The statements write scalar signals and buses by name.
bool IsNamedPlainly(const Signal& signal) {
    return signal.GetSignalType() == SignalTypeScalar || signal.GetSignalType() == SignalTypeBus;
}

} // namespace

class VerilogNetlister::Writer : private Writers::NetlistPass {
public:
    Writer(OutStream& out, VerilogStatements& statements, Netlist& netlist,
           const HdlOptions& options)
        : NetlistPass(Language::Verilog, out, netlist, options), statements_(statements),
          dialect_(DialectOf(options.verilog.synthesisType)),
          connection_(out, WriteSignalVisitor::Connection),
          reference_(out, WriteSignalVisitor::Assignment) {}
    /// Writes parts of what `whole` writes to a stream of their own.
    Writer(OutStream& out, VerilogStatements& statements, const Writer& whole)
        : NetlistPass(out, whole), statements_(statements), dialect_(whole.dialect_),
          connection_(out, WriteSignalVisitor::Connection),
          reference_(out, WriteSignalVisitor::Assignment) {}

    void Write();

private:
    class Part;

    void Prepare();
    void SetNameCase();
    static void SetNameCase(Object& object, HdlOptions::VerilogOption::CaseType nameCase);

    void WriteHead();
    void WriteModulelAndPorts(const std::vector<Signal*>& ports);
    void WriteParameters();
    void WritePortDeclarations(const std::vector<Signal*>& ports);
    void WriteSignalDeclarations(const std::vector<Signal*>& signals);
    void WriteSignalDeclaration(const Signal& signal);
    void WriteSignalAssignments(const Writers::SignalLists& signals);
    void WriteConstantAssignment(Signal& signal);
    void WriteConstantAssignment(Signal& signal, bool singleBit, const BitVectorValue& value);
    void WriteAlias(Signal& signal, Signal& alias);
    void WriteReference(Signal& signal);
    void WriteInstances();
    void WriteInstance(const Instance& instance);
    void WriteInstantiation(const Instance& instance);
    void WriteConnections(const Instance& instance, std::size_t column);
    void WriteDefParam(const Instance& instance, const PtrArray<Attribute*>& attributes);

    void WriteNextItem(std::size_t column);
    void WriteSemicolon() { PutLine(out_, ";"); }
    void EndStatement(const Iterator<Attribute*>& attributes, string_view objectName);
    template <class WriteStatement>
    void WriteGenericAttrs(const Writers::GenericAttrs& attributes,
                           const WriteStatement& writeStatement);

    VerilogStatements& statements_;
    const Dialect& dialect_;
    WriteSignalVisitor connection_;
    WriteSignalVisitor reference_;
    PtrArray<Attribute*> effectiveAttrs_;
    Writers::GenericAttrs genericAttrs_;
};

/// Writes declarations of signals and instances to a stream of its own.
class VerilogNetlister::Writer::Part {
public:
    Part(OutStream& out, const Writer& whole)
        : statements_(out), writer_(out, statements_, whole) {}
    Part(const Part&) = delete;
    Part& operator=(const Part&) = delete;

    void operator()(const Signal& signal) { writer_.WriteSignalDeclaration(signal); }

    void operator()(const Instance& instance) { writer_.WriteInstance(instance); }

private:
    VerilogStatements statements_;
    Writer writer_;
};

VerilogNetlister::VerilogNetlister(OutStream& out)
    : out_(out), statements_(std::make_unique<VerilogStatements>(out)) {}

VerilogNetlister::~VerilogNetlister() = default;

void VerilogNetlister::WriteNetlist(Netlist* netlist, const HdlOptions& options) {
    if (netlist != nullptr && options.legal) {
        LegalNetlist(*netlist, options).Write(Language::Verilog, out_);
    } else if (netlist != nullptr) {
        WriteLiterally(*netlist, options);
    }
}

void VerilogNetlister::WriteLiterally(Netlist& netlist, const HdlOptions& options) {
    Writer(out_, *statements_, netlist, options).Write();
}

void VerilogNetlister::WriteNetlist(Netlist* netlist, HdlOptions& options) {
    if (netlist != nullptr) {
        options.hierarchicalInit = Writers::PassesInit(Language::Verilog, *netlist);
    }
    WriteNetlist(netlist, static_cast<const HdlOptions&>(options));
}

void VerilogNetlister::Writer::Write() {
    Prepare();
    const Writers::SignalLists signals(netlist_, Language::Verilog);
    WriteHead();
    WriteModulelAndPorts(signals.ports);
    out_.Indent();
    WriteParameters();
    WritePortDeclarations(signals.ports);
    WriteSignalDeclarations(signals.internals);
    WriteSignalAssignments(signals);
    WriteInstances();
    out_.Unindent();
    PutLine(out_, "endmodule");
}

void VerilogNetlister::Writer::Prepare() {
    NetlistPass::Prepare();
    SetNameCase();
}

void VerilogNetlister::Writer::SetNameCase() {
    for (Signal* signal : netlist_.GetSignalIterator()) {
        SetNameCase(*signal, options_.verilog.signalCase);
    }
    for (Component* component : netlist_.GetComponentIterator()) {
        SetNameCase(*component, options_.verilog.componentCase);
    }
    for (Instance* instance : netlist_.GetInstanceIterator()) {
        SetNameCase(*instance, options_.verilog.instanceCase);
    }
}

void VerilogNetlister::Writer::SetNameCase(Object& object,
                                           HdlOptions::VerilogOption::CaseType nameCase) {
    if (nameCase == HdlOptions::VerilogOption::DEFSULT) {
        return;
    }
    Port::String name = object.GetName();
    if (nameCase == HdlOptions::VerilogOption::UPPERCASE) {
        name.MakeUpper();
    } else {
        name.MakeLower();
    }
    object.SetName(name.CStr());
}

void VerilogNetlister::Writer::WriteHead() {
    WriteOpening();
    statements_.WriteIncludePath(options_.verilog.includePaths);
    statements_.WriteTimeScale("1ns", "1ps");
    out_.WriteEmptyLine();
}

void VerilogNetlister::Writer::WriteModulelAndPorts(const std::vector<Signal*>& ports) {
    const string_view name = netlist_.GetNameView();
    Put(out_, "module", " ", name, "(");
    bool isFirst = true;
    for (const Signal* port : ports) {
        if (!isFirst) {
            WriteNextItem(name.size() + ModuleHeadLength);
        }
        isFirst = false;
        const string_view portName = port->GetNameView();
        Put(out_, (port->GetSignalType() == SignalTypeBus ? Names::BaseName(portName) : portName));
    }
    PutLine(out_, ");");
    out_.WriteEmptyLine();
}

void VerilogNetlister::Writer::WriteParameters() {
    const Writers::GenericAttrs attributes(netlist_.GetAttrIterator());
    if (!attributes.IsEmpty()) {
        WriteGenericAttrs(attributes, [this](Attribute* attribute) {
            statements_.WriteParameterStatement(attribute);
        });
        out_.WriteEmptyLine();
    }
}

void VerilogNetlister::Writer::WritePortDeclarations(const std::vector<Signal*>& ports) {
    for (const Signal* port : ports) {
        statements_.WriteComment(port);
        statements_.WritePortDeclaration(port->GetNameView(), port->GetPortPolarity());
        EndStatement(port->GetAttrIterator(), Names::BaseName(port->GetNameView()));
    }
    out_.WriteEmptyLine();
}

void VerilogNetlister::Writer::WriteSignalDeclarations(const std::vector<Signal*>& signals) {
    WriteEachSignal(signals, [this](OutStream& out) { return Part(out, *this); });
    out_.WriteEmptyLine();
}

void VerilogNetlister::Writer::WriteSignalDeclaration(const Signal& signal) {
    statements_.WriteComment(&signal);
    statements_.WriteSignalDeclaration(signal.GetNameView());
    EndStatement(signal.GetAttrIterator(), Names::BaseName(signal.GetNameView()));
}

void VerilogNetlister::Writer::WriteSignalAssignments(const Writers::SignalLists& signals) {
    WriteAssignments(
        signals, [this](Signal& signal) { WriteConstantAssignment(signal); },
        [this](Signal& signal, Signal& alias) { WriteAlias(signal, alias); });
}

void VerilogNetlister::Writer::WriteConstantAssignment(Signal& signal) {
    const BitVectorValue& value = signal.GetConstantValue();
    const bool isSingle = SignalBits::IsSingle(signal);
    if (options_.dontCares && isSingle && Writers::IsDontCare(value)) {
        WriteConstantAssignment(signal, false, BitVectorValue("1:B:x"));
    } else if (options_.dontCares && !isSingle && Writers::HasDontCare(value)) {
        WriteConstantAssignment(signal, false, Writers::InVerilog(value));
    } else {
        WriteConstantAssignment(signal, isSingle, value);
    }
}

void VerilogNetlister::Writer::WriteConstantAssignment(Signal& signal, bool singleBit,
                                                       const BitVectorValue& value) {
    if (IsNamedPlainly(signal)) {
        statements_.WriteConstantSignalAssignment(signal.GetNameView(), singleBit, value);
    } else {
        Put(out_, "assign", " ");
        WriteReference(signal);
        Put(out_, " = ");
        statements_.WriteConstant(singleBit, value);
    }
    WriteSemicolon();
}

void VerilogNetlister::Writer::WriteAlias(Signal& signal, Signal& alias) {
    Put(out_, "assign", " ");
    WriteReference(signal);
    Put(out_, " = ");
    WriteReference(alias);
    WriteSemicolon();
}

void VerilogNetlister::Writer::WriteReference(Signal& signal) {
    if (IsNamedPlainly(signal)) {
        statements_.WriteSignalName(signal.GetNameView());
    } else {
        signal.AcceptSignal(reference_);
    }
}

void VerilogNetlister::Writer::WriteInstances() {
    WriteEachInstance([this](OutStream& out) { return Part(out, *this); });
}

void VerilogNetlister::Writer::WriteInstance(const Instance& instance) {
    WriteInstantiation(instance);
    Writers::GetEffectiveAttrs(instance, effectiveAttrs_);
    EndStatement(Iterator<Attribute*>(&effectiveAttrs_), instance.GetNameView());
    WriteDefParam(instance, effectiveAttrs_);
}

void VerilogNetlister::Writer::WriteInstantiation(const Instance& instance) {
    const Component* const component = instance.GetComponent();
    string_view componentName;
    if (component != nullptr) {
        statements_.WriteComment(component);
        componentName = component->GetNameView();
    }
    statements_.WriteComment(&instance);
    const string_view name = instance.GetNameView();
    Put(out_, componentName, " ", name, " ", "(");
    WriteConnections(instance, componentName.size() + name.size() + InstanceHeadLength);
    Put(out_, ")");
}

void VerilogNetlister::Writer::WriteConnections(const Instance& instance, std::size_t column) {
    bool isFirst = true;
    for (const Pin* pin : instance.GetPinIterator()) {
        if (!isFirst) {
            WriteNextItem(column);
        }
        isFirst = false;
        Put(out_, ".", Writers::GetBaseName(*pin), "(");
        if (Signal* const signal = pin->GetSignal()) {
            signal->AcceptSignal(connection_);
        }
        Put(out_, ")");
    }
}

void VerilogNetlister::Writer::WriteDefParam(const Instance& instance,
                                             const PtrArray<Attribute*>& attributes) {
    genericAttrs_.Split(Iterator<Attribute*>(&attributes));
    if (genericAttrs_.IsEmpty()) {
        return;
    }
    const Port::String name = instance.GetName();
    if (Attribute* const init = FindPassedInit(genericAttrs_)) {
        statements_.WriteDefParamInitStatement(init, name.CStr());
        WriteSemicolon();
        // A parameter that is hidden from synthesis stays: simulation uses the instance's own
        // value.
        genericAttrs_.syn.Remove(init);
    }
    WriteGenericAttrs(genericAttrs_, [this, &name](Attribute* attribute) {
        statements_.WriteDefParamStatement(attribute, name.CStr());
    });
}

/// Separates two items of a list.
void VerilogNetlister::Writer::WriteNextItem(std::size_t column) {
    Put(out_, ", ");
    if (options_.onePortPerLine) {
        PutLine(out_);
        Writers::WriteBlanks(out_, column);
    }
}

/// Ends a statement whose object may have synthesis attributes.
void VerilogNetlister::Writer::EndStatement(const Iterator<Attribute*>& attributes,
                                            string_view objectName) {
    if (attributes.IsAtEnd()) {
        WriteSemicolon();
        return;
    }
    if (dialect_.isSemicolonFirst) {
        WriteSemicolon();
    }
    dialect_.write(statements_, attributes, Port::String(objectName).CStr());
    if (!dialect_.isSemicolonFirst) {
        WriteSemicolon();
    }
}

template <class WriteStatement>
void VerilogNetlister::Writer::WriteGenericAttrs(const Writers::GenericAttrs& attributes,
                                                 const WriteStatement& writeStatement) {
    const auto writeStatements = [this, &writeStatement](const PtrArray<Attribute*>& list) {
        for (Attribute* attribute : Iterator<Attribute*>(&list)) {
            writeStatement(attribute);
            WriteSemicolon();
        }
    };
    writeStatements(attributes.syn);
    if (!attributes.nosyn.IsEmpty()) {
        WriteHidden([&attributes, &writeStatements] { writeStatements(attributes.nosyn); });
    }
}

} // namespace Orn_Hdl
