// A netlist that is read, compared with the design that it was written from.
#pragma once

#include "HdlModel/Netlist/SignalsAhead.h"
#include "Orn_Hdl/Model/Netlist.h"
#include "Orn_Hdl/Options.h"
#include "Proof/Assignments.h"
#include "Proof/Findings.h"
#include "Proof/Parameters.h"
#include "Proof/SharedNames.h"
#include "Readers/NetlistSink.h"

#include <string>
#include <string_view>
#include <unordered_map>
#include <unordered_set>
#include <vector>

namespace Orn_Hdl::Proving {

/// Walks the design while the netlist is read: what is read next has to be what comes next. The
/// names of the netlist lead to the signals of the design itself, so nothing of it is made twice.
class Comparison final : public Readers::NetlistSink {
public:
    /// \param findings gets the differences, as \p design does stay as it is.
    Comparison(const Netlist& design, const HdlOptions& options, Language language,
               Findings& findings);

    void TakeModule(std::string_view name, const Readers::Place& place) override;
    Signal* Declare(const std::string& name, const std::optional<Readers::Range>& range,
                    int direction, const Readers::Place& place) override;
    Signal* FindSignal(std::string_view name) override;
    void TakeComponent(const Readers::ModuleHead& head, const Readers::Place& place) override;
    void TakeBinding(const std::vector<std::string>& instances, const std::string& component,
                     const Readers::Place& place) override;
    void BeginInstance(std::string_view name, const Readers::ModuleHead& head,
                       const Readers::Place& place) override;
    void Connect(const Readers::PortHead& port, const Readers::Members& members,
                 const Readers::Place& place) override;
    void ConnectConstant(const Readers::PortHead& port, const Readers::Place& place) override;
    void Assign(const Readers::Members& target, const Readers::Members& source,
                const Readers::Place& place) override;
    void Tie(const Readers::Members& target, const std::string& bits,
             const Readers::Place& place) override;
    void TakeParameter(const Readers::Owner& owner, const std::string& name,
                       const Readers::Value& value, bool isHidden,
                       const Readers::Place& place) override;
    void TakeAttribute(const Readers::Owner& owner, const std::string& name,
                       const Readers::Value& value, bool isDeclared,
                       const Readers::Place& place) override;

    /// Looks for what the netlist lacks.
    void End();

private:
    std::string_view NameInFile(std::string_view name) const noexcept;
    bool IsNothing(const Signal& signal) const noexcept;
    bool IsDeclaredAs(const Signal& signal, std::string_view name) const noexcept;
    Signal* FindInDesign(std::string_view name) const;
    const Signal* NextDeclared();
    Signal* DeclareStranger(const std::string& name, const std::optional<Readers::Range>& range);
    void SkipTo(const Signal& signal, const Readers::Place& place);
    bool CheckDeclared(const Signal& signal, const std::optional<Readers::Range>& range,
                       int direction, const Readers::Place& place);
    void ReportUndeclared(const Signal& signal, const Readers::Place& place);
    void EndDeclarations(const Readers::Place& place);

    void SkipTo(const Instance& instance, const Readers::Place& place);
    void CheckInstance(const Instance& instance, const Readers::ModuleHead& head,
                       const Readers::Place& place);
    void EndInstance();
    void ComparePorts(const Component& component, const Readers::ModuleHead& head,
                      const Readers::Place& place);
    void FindBound();
    void EndComponents();
    std::size_t FindPin(std::string_view port);
    void ReportConnection(const Pin& pin, const std::string& found, const Readers::Place& place);
    bool AreSame(const Signal& signal, const Readers::Members& members);

    const Netlist& design_;
    const HdlOptions& options_;
    const Language language_;
    Findings& findings_;
    const SharedNames shared_;
    Assignments assignments_;
    Parameters parameters_;

    /// \{
    /// What is to be declared next: first the ports, then the signals inside.
    Iterator<Signal*> signals_;
    bool isAmongPorts_ = true;
    /// \}
    /// Signals that the design finds by their former names, as far as they have been declared.
    std::unordered_map<std::string, Signal*> renamed_;
    /// What the netlist declares and the design does not have, or in another form.
    Netlist strangers_;
    bool hasStrangers_ = false;

    Iterator<Instance*> instances_;
    SignalsAhead ahead_;
    /// The instance in the design; null when it has none of the name.
    const Instance* instance_ = nullptr;
    std::vector<const Pin*> pins_;
    std::vector<bool> isConnected_;
    std::size_t nextPin_ = 0;
    /// The signal that is read next, when all is well.
    const Signal* expected_ = nullptr;

    /// \{
    /// Of VHDL: the components that were declared, those of the instances, and what the
    /// configuration has to bind.
    std::unordered_set<const Component*> declared_;
    std::unordered_set<const Component*> used_;
    std::unordered_map<const Component*, std::vector<const Instance*>> bound_;
    bool hasBound_ = false;
    /// \}

    /// Where the reader is.
    Readers::Place place_;
    BitQueue bits_;
    Runs runs_;
};

} // namespace Orn_Hdl::Proving
