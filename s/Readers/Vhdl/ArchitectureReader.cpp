#include "Readers/Vhdl/ArchitectureReader.h"

#include "Readers/Vhdl/Configurations.h"

#include <cstddef>
#include <optional>
#include <utility>
#include <vector>

namespace Orn_Hdl::Readers::Vhdl {

namespace {

bool IsSamePlace(const Place& a, const Place& b) noexcept {
    return a.line == b.line && a.column == b.column;
}

} // namespace

ArchitectureReader::ArchitectureReader(Scanner& scanner, const Design& design,
                                       const ModuleHead& entity, const Architecture& architecture,
                                       NetlistMaker& maker, const VhdlSetup& setup)
    : parser_(scanner), scanner_(scanner), design_(design), entity_(entity),
      architecture_(architecture), maker_(maker),
      notes_(scanner, setup.keepsComments, maker.GetSink() == nullptr),
      expressions_(parser_, maker, entity),
      attributes_(parser_, maker, design, architecture, setup.keepsAttributes),
      instances_(parser_, maker, notes_, expressions_, attributes_, design, architecture, entity) {}

void ArchitectureReader::Read() {
    maker_.SetPlace(entity_.place);
    maker_.SetName(entity_.name);
    instances_.MakeComponents();
    DeclareGenerics();
    DeclarePorts();
    SkipToUnit(design_.clausesOfEntities.at(&entity_), Keyword::Entity);
    ReadEntity();
    SkipToUnit(architecture_.clauses, Keyword::Architecture);
    while (!parser_.Accept(Keyword::Is)) {
        parser_.Next();
    }
    while (parser_.GetKeyword() != Keyword::Begin) {
        notes_.TakeBefore();
        RefuseHidden();
        ReadDeclaration();
        notes_.EndStatement();
    }
    parser_.Next();
    while (parser_.GetKeyword() != Keyword::End) {
        notes_.TakeBefore();
        RefuseHidden();
        ReadStatement();
        parser_.Expect(';');
        notes_.EndStatement();
    }
    notes_.TakeBefore();
    RefuseHidden();
    CheckEnd(architecture_.name);
    attributes_.RefuseUnused();
}

/// A sink is not told that synthesis does not see a statement, which is so in no written netlist.
void ArchitectureReader::RefuseHidden() {
    if (maker_.GetSink() != nullptr && notes_.IsHidden()) {
        parser_.Fail("this is hidden from synthesis");
    }
}

/// Skips to the first word of a unit, and gives the comments in front of it to the netlist.
void ArchitectureReader::SkipToUnit(const Clauses& clauses, Keyword keyword) {
    if (clauses.formerEnd.line > 0) {
        notes_.Collect(false);
        while (!IsSamePlace(parser_.Get().place, clauses.formerEnd)) {
            parser_.Next();
        }
        scanner_.GetComments().clear();
    }
    notes_.Collect(true);
    parser_.Next();
    while (parser_.GetKeyword() != keyword) {
        parser_.Next();
    }
    notes_.GiveUnitTo(maker_.GetNetlist());
    parser_.Next();
}

/// Makes the generics of the entity attributes of the netlist.
void ArchitectureReader::DeclareGenerics() {
    for (const ParameterHead& parameter : entity_.parameters) {
        const auto what = [&parameter] { return "the generic " + Quoted(parameter.name); };
        if (!parameter.value) {
            parser_.Fail(entity_.place, what() + " of the entity has no value that is a literal, "
                                                 "and a model has one");
        }
        if (NetlistSink* const sink = maker_.GetSink()) {
            sink->TakeParameter({}, parameter.name, *parameter.value, parameter.isHidden,
                                entity_.place);
            continue;
        }
        const std::string problem =
            GiveAttribute(maker_.GetNetlist(), parameter.name, *parameter.value,
                          parameter.isHidden ? "NOSYN" : "SYN", nullptr);
        if (!problem.empty()) {
            parser_.Fail(entity_.place, what().append(": ").append(problem));
        }
    }
}

void ArchitectureReader::DeclarePorts() {
    for (const PortHead& port : entity_.ports) {
        const std::string what = "the port " + Quoted(port.name);
        if (!port.problem.empty()) {
            parser_.Fail(entity_.place, what + ": " + port.problem);
        }
        if (port.hasDefault) {
            parser_.Fail(entity_.place, what + " has a default value, which a model cannot say");
        }
        if (!port.parameters.empty()) {
            parser_.Fail(entity_.place, what + " depends on the generic " +
                                            Quoted(port.parameters.front()) +
                                            ", which a model cannot say: write a number");
        }
        if (maker_.DeclarePort(port) == nullptr) {
            parser_.Fail(entity_.place, what + " is declared already");
        }
    }
}

/// The head is known; what stands in the entity is gone through for attributes and comments.
void ArchitectureReader::ReadEntity() {
    while (!parser_.Accept(Keyword::Is)) {
        parser_.Next();
    }
    if (parser_.GetKeyword() == Keyword::Generic) {
        parser_.Next();
        SkipParentheses();
        parser_.Expect(';');
    }
    if (parser_.GetKeyword() == Keyword::Port) {
        parser_.Next();
        ReadPortNames();
        parser_.Expect(';');
    }
    notes_.TakeInside();
    notes_.Drop();
    while (parser_.GetKeyword() != Keyword::End) {
        if (parser_.GetKeyword() == Keyword::Attribute) {
            attributes_.Read(expressions_.GetResolve());
        } else if (parser_.GetKeyword() == Keyword::Use) {
            parser_.SkipStatement();
        } else {
            Refuse();
        }
    }
    notes_.TakeInside();
    CheckEnd(entity_.name);
}

/// Reads on from "end" to the semicolon. A name between them is that of the unit.
void ArchitectureReader::CheckEnd(const std::string& unit) {
    for (; !parser_.IsSign(';') && !parser_.IsEnd(); parser_.Next()) {
        if (parser_.IsName() && parser_.GetKeyword() == Keyword::None &&
            !IsSameName(parser_.Get().text, unit, true)) {
            parser_.Fail("the end of " + Quoted(unit) + " has another name");
        }
    }
}

void ArchitectureReader::SkipParentheses() {
    std::size_t depth = 0;
    do {
        depth += parser_.IsSign('(') ? 1 : 0;
        depth -= parser_.IsSign(')') ? 1 : 0;
        parser_.Next();
    } while (depth > 0);
}

/// Gives the comments in front of ports to them.
void ArchitectureReader::ReadPortNames() {
    std::size_t depth = 0;
    bool isName = true;
    do {
        depth += parser_.IsSign('(') ? 1 : 0;
        depth -= parser_.IsSign(')') ? 1 : 0;
        if (parser_.IsSign(':')) {
            isName = false;
            notes_.TakeInside();
        } else if (depth == 1 && parser_.IsSign(';')) {
            isName = true;
            notes_.Drop();
        } else if (isName && parser_.IsName()) {
            name_ = parser_.Get().text;
            notes_.TakeBefore();
            if (Signal* const port = maker_.FindSignal(name_)) {
                notes_.GiveTo(*port);
            }
        }
        parser_.Next();
    } while (depth > 0);
}

void ArchitectureReader::ReadDeclaration() {
    switch (parser_.GetKeyword()) {
    case Keyword::Signal:
        ReadSignals();
        break;
    case Keyword::Component:
        ReadComponent();
        break;
    case Keyword::Attribute:
        attributes_.Read(expressions_.GetResolve());
        break;
    case Keyword::Constant:
        parser_.Next();
        expressions_.ReadConstant();
        break;
    case Keyword::Alias:
        parser_.Next();
        expressions_.ReadAlias();
        break;
    case Keyword::Use:
    case Keyword::Group:
        parser_.SkipStatement();
        break;
    case Keyword::For:
        ReadBinding();
        break;
    case Keyword::Subtype:
        ReadSubtype();
        break;
    case Keyword::Type:
        parser_.Fail("the declaration of a " + parser_.Show() +
                     ": a model has bits and vectors of bits alone");
    case Keyword::None:
    case Keyword::End:
        if (parser_.IsEnd()) {
            parser_.Fail(architecture_.place, "\"begin\" does not follow this");
        }
        parser_.FailExpected("a declaration or \"begin\"");
    default:
        Refuse();
    }
}

void ArchitectureReader::Refuse() {
    parser_.Fail(parser_.Show() + std::string(SynthesiseFirst));
}

/// "signal A, B : std_logic;"
void ArchitectureReader::ReadSignals() {
    parser_.Next();
    std::vector<std::pair<std::string, Place>> names;
    do {
        const Place place = parser_.Get().place;
        parser_.TakeName(name_, "name of a signal");
        names.emplace_back(name_, place);
    } while (parser_.Accept(','));
    parser_.Expect(':');
    const Place typePlace = parser_.Get().place;
    const SignalType type = ReadSignalType(parser_, expressions_.GetResolve(), &subtypes_);
    if (!type.problem.empty()) {
        parser_.Fail(typePlace, type.problem);
    }
    for (const auto& [name, place] : names) {
        maker_.SetPlace(place);
        Signal* const signal =
            expressions_.IsDeclared(name) ? nullptr : maker_.DeclareSignal(name, type.range);
        if (signal == nullptr) {
            parser_.Fail(place, Quoted(name) + " is declared already");
        }
        notes_.GiveTo(*signal);
    }
    if (parser_.IsSign(Becomes)) {
        parser_.Fail("an initial value, which a model's signals do not have: assign it in a "
                     "statement, or leave it out");
    }
    parser_.Expect(';');
}

/// "subtype NAME is std_logic_vector(3 downto 0);" What is no type of signals matters only where it
/// is used.
void ArchitectureReader::ReadSubtype() {
    parser_.Next();
    parser_.TakeName(name_, "name of a subtype");
    const std::string key = KeyOf(name_);
    parser_.Expect(Keyword::Is, "is");
    SignalType type = ReadSignalType(parser_, expressions_.GetResolve(), &subtypes_);
    subtypes_[key] = std::move(type);
    parser_.SkipStatement();
}

/// The component is known; comments in front of it belong to it.
void ArchitectureReader::ReadComponent() {
    const Place place = parser_.Get().place;
    parser_.Next();
    parser_.TakeName(name_, "name of a component");
    const ModuleHead* const head = architecture_.components.Find(name_);
    if (head != nullptr && maker_.GetSink() != nullptr) {
        maker_.GetSink()->TakeComponent(*head, place);
    }
    if (head != nullptr && head->component != nullptr) {
        notes_.GiveTo(*head->component);
    }
    while (parser_.GetKeyword() != Keyword::End) {
        parser_.Next();
    }
    parser_.SkipStatement();
}

/// "for all : COMPONENT use entity WORK.COMPONENT;"
void ArchitectureReader::ReadBinding() {
    Place place;
    const std::string problem = Vhdl::ReadBinding(parser_, place);
    if (!problem.empty()) {
        parser_.Fail(place, problem);
    }
}

void ArchitectureReader::ReadStatement() {
    const Place place = parser_.Get().place;
    if (parser_.IsEnd()) {
        parser_.Fail(architecture_.place, "\"end\" does not follow this");
    }
    if (parser_.IsSign('(')) {
        ReadAssignment();
        return;
    }
    if (parser_.GetKeyword() != Keyword::None) {
        Refuse();
    }
    if (!parser_.IsName()) {
        parser_.FailExpected("an instance or an assignment");
    }
    parser_.TakeName(name_, "label or name of a signal");
    if (parser_.Accept(':')) {
        const std::string label = std::move(name_);
        ReadLabelled(label, place);
    } else {
        ReadNamedAssignment(name_, place);
    }
}

/// Reads what follows a label and a colon.
void ArchitectureReader::ReadLabelled(const std::string& label, const Place& place) {
    const Keyword keyword = parser_.GetKeyword();
    if (keyword == Keyword::Component || keyword == Keyword::Entity ||
        keyword == Keyword::Configuration) {
        instances_.Read(label, place);
        return;
    }
    if (parser_.IsSign('(')) {
        ReadAssignment();
        return;
    }
    if (keyword == Keyword::If || keyword == Keyword::For || keyword == Keyword::Case) {
        parser_.Fail("a generate statement: a model has no copies that depend on a value; "
                     "synthesise the design first");
    }
    if (keyword == Keyword::Block) {
        parser_.Fail("a block, which is a level of its own: a model has one level; flatten the "
                     "design first");
    }
    if (keyword != Keyword::None || !parser_.IsName()) {
        Refuse();
    }
    const Place namePlace = parser_.Get().place;
    std::string name;
    parser_.TakeName(name, "name of a component or a signal");
    while (parser_.Accept('.')) {
        parser_.TakeName(name, "name of a component");
    }
    if (parser_.IsSign(';') || parser_.GetKeyword() == Keyword::Port ||
        parser_.GetKeyword() == Keyword::Generic) {
        instances_.ReadBehind(label, place, name, namePlace);
    } else {
        ReadNamedAssignment(name, namePlace);
    }
}

/// Reads an assignment to an aggregate.
void ArchitectureReader::ReadAssignment() {
    expressions_.Read(target_, nullptr);
    FinishAssignment();
}

/// Reads the rest of an assignment to a signal whose name is read.
void ArchitectureReader::ReadNamedAssignment(const std::string& name, const Place& place) {
    std::optional<ExpressionReader::Selection> selection;
    const bool isDeclared = maker_.FindSignal(name) != nullptr || expressions_.IsDeclared(name);
    if (!isDeclared && !parser_.IsSign(LeftArrow)) {
        parser_.Fail(place, "the procedure " + Quoted(name) + std::string(SynthesiseFirst));
    }
    if (parser_.IsSign('(')) {
        selection = expressions_.ReadSelection();
        if (!selection) {
            expressions_.RefuseIndex(name, place);
        }
    }
    expressions_.ReadBehind(target_, name, selection ? &*selection : nullptr, place);
    FinishAssignment();
}

/// Reads the arrow of an assignment and what follows it.
void ArchitectureReader::FinishAssignment() {
    for (const Piece& piece : target_.pieces) {
        if (piece.signal == nullptr) {
            parser_.Fail(target_.place, "a constant on the left of an assignment");
        }
    }
    if (target_.pieces.empty()) {
        parser_.Fail(target_.place, "an assignment to nothing");
    }
    parser_.Expect(LeftArrow);
    const Keyword keyword = parser_.GetKeyword();
    if (keyword == Keyword::Behaviour) {
        Refuse();
    }
    const Shape shape = ExpressionReader::GetShape(target_);
    expressions_.Read(value_, &shape);
    if (parser_.GetKeyword() == Keyword::After || parser_.IsSign(',')) {
        parser_.Fail("a delay of an assignment: a model has none");
    }
    if (target_.width != value_.width || target_.isVector != value_.isVector) {
        const auto describe = [](const Expression& expression) {
            return expression.isVector ? "a vector of " + std::to_string(expression.width) +
                                             (expression.width == 1 ? " bit" : " bits")
                                       : std::string("a bit");
        };
        parser_.Fail(value_.place, describe(value_) + " is assigned to " + describe(target_));
    }
    Assign();
}

void ArchitectureReader::Assign() {
    if (NetlistSink* const sink = maker_.GetSink()) {
        const Members target = maker_.GetMembers(target_.pieces);
        if (!value_.IsConstant()) {
            sink->Assign(target, maker_.GetMembers(value_.pieces), target_.place);
            return;
        }
        std::string bits;
        for (const Piece& piece : value_.pieces) {
            bits += piece.bits;
        }
        sink->Tie(target, bits, target_.place);
        return;
    }
    Signal& signal = *maker_.GetSignal(target_.pieces);
    if (value_.IsConstant()) {
        if (!std::string_view(signal.GetConstantValue().GetValue()).empty()) {
            parser_.Fail(value_.place, Quoted(signal.GetNameView()) +
                                           " has a constant already, and a model has one");
        }
        signal.AssignConstantValue(value_.GetConstant().c_str());
        return;
    }
    Signal& source = *maker_.GetSignal(value_.pieces);
    if (&signal == &source) {
        parser_.Fail(value_.place, Quoted(signal.GetNameView()) + " is assigned to itself");
    }
    signal.Connect(&source);
}

} // namespace Orn_Hdl::Readers::Vhdl
