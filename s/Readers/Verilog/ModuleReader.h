// The second walk over a file: the statements of one module become a netlist.
#pragma once

#include "Readers/NetlistMaker.h"
#include "Readers/Verilog/Attributes.h"
#include "Readers/Verilog/Expressions.h"
#include "Readers/Verilog/Parser.h"

#include <cstddef>
#include <map>
#include <optional>
#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

namespace Orn_Hdl::Readers {

/// Whether a name is a keyword of Verilog.
bool IsVerilogKeyword(std::string_view name);

class ModuleReader {
public:
    ModuleReader(Scanner& scanner, Heads& heads, const ModuleHead& head, NetlistMaker& maker,
                 const VerilogSetup& setup);

    /// Reads the module of the file that the scanner has opened.
    void Read();

private:
    /// A parameter of an instance.
    struct Override {
        std::string name;
        Value value;
        Place place;
    };
    /// A parameter of a component whose default is not known, and the one that is declared.
    struct Assumed {
        std::string name;
        Value value;
    };
    /// A defparam statement in front of its instance.
    struct EarlyOverride {
        std::string instance;
        Override override;
        bool isHidden = false;
    };
    enum class NetKind { Wire, Supply0, Supply1 };

    void SkipToModule();
    void ReadHead();
    void DeclarePorts();
    void ReadParametersInHead();
    void ReadPortsInHead();
    void MakeComponents();
    void ReadBody();
    void ReadStatement();
    [[noreturn]] void RefuseStatement(Keyword keyword);
    void ReadPortDeclaration();
    void ReadNetDeclaration(NetKind kind);
    void ReadOneNet(NetKind kind, const std::optional<Range>& range);
    Signal* DeclareNet(const std::optional<Range>& range, const Place& place);
    void RefuseStrengthOrDelay(std::string_view what);
    void ReadParameters(bool isLocal);
    void GiveParameter(const Place& place);
    void ReadAssignments();
    void Assign(const Expression& target, const Expression& value);
    void Tie(Signal& signal, const Expression& value);
    void ReadDefparams();
    Value ReadValue(std::string_view parameter);
    Value ReadNamedValue(std::string_view parameter);
    Value ReadBitsValue();

    void ReadInstances();
    void ReadOverrides(const ModuleHead& head);
    void ReadOneInstance(ModuleHead& head);
    void ReadConnections(const ModuleHead& head, Instance& instance);
    std::size_t FindPort(const ModuleHead& head, std::string_view name, std::size_t hint);
    void ReadNamedConnection(const ModuleHead& head, const Instance& instance, std::size_t& port);
    void ReadImplicitConnection(const ModuleHead& head, const Instance& instance, std::size_t port);
    void Connect(const ModuleHead& head, const Instance& instance, std::size_t port);
    void SetParameter(Instance& instance, const ModuleHead& head, const Override& override,
                      bool isHidden);
    bool DeclareGeneric(const ModuleHead& head, const std::string& name, const Value& value,
                        bool isHidden);
    void LeaveOutAssumed();
    ModuleHead* FindHead(const Instance& instance) const;
    void SetEarlyOverrides();

    Parser parser_;
    Scanner& scanner_;
    Heads& heads_;
    const ModuleHead& head_;
    NetlistMaker& maker_;
    AttributeReader attributes_;
    ExpressionReader expressions_;
    std::vector<EarlyOverride> earlyOverrides_;
    std::map<const Component*, ModuleHead*> headsOfComponents_;
    std::unordered_map<const Component*, std::vector<Assumed>> assumed_;
    std::unordered_map<const ModuleHead*, std::unordered_map<std::string_view, std::size_t>>
        portPlaces_;
    /// Room that is kept between statements.
    std::vector<Override> overrides_;
    std::vector<Pin*> pins_;
    std::vector<bool> isConnected_;
    Expression target_;
    Expression value_;
    std::string name_;
    std::string typeName_;
    ModuleHead* lastHead_ = nullptr;
};

} // namespace Orn_Hdl::Readers
