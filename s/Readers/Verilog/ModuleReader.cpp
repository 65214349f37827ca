#include "Readers/Verilog/ModuleReader.h"

#include <utility>

namespace Orn_Hdl::Readers {

namespace {

constexpr const char* Seen = "SYN";
constexpr const char* Hidden = "NOSYN";
constexpr std::string_view InitName = "INIT";
/// How many parameters may be left out of instances: a short text can ask for any number.
constexpr std::size_t MostLeftOut = std::size_t(1) << 20;

} // namespace

bool IsVerilogKeyword(std::string_view name) {
    return FindKeyword(name) != Keyword::None;
}

ModuleReader::ModuleReader(Scanner& scanner, Heads& heads, const ModuleHead& head,
                           NetlistMaker& maker, const VerilogSetup& setup)
    : parser_(scanner), scanner_(scanner), heads_(heads), head_(head), maker_(maker),
      attributes_(parser_, scanner, maker, setup), expressions_(parser_, scanner, maker, head) {}

void ModuleReader::Read() {
    SkipToModule();
    attributes_.GiveNotes();
    scanner_.SetInModule(true);
    maker_.SetPlace(head_.place);
    maker_.SetName(head_.name);
    MakeComponents();
    DeclarePorts();
    ReadHead();
    ReadBody();
    SetEarlyOverrides();
    LeaveOutAssumed();
}

/// Skips to the name of the module that is read.
void ModuleReader::SkipToModule() {
    parser_.Next();
    for (;;) {
        attributes_.BeginStatement();
        attributes_.ReadAttributes();
        const Place begin = parser_.Get().place;
        const Keyword keyword = parser_.GetKeyword();
        if (keyword == Keyword::Module) {
            parser_.Next();
            if (parser_.IsName() && parser_.Get().text == head_.name) {
                parser_.Next();
                return;
            }
            attributes_.SkipBehind("endmodule", begin);
        } else if (keyword == Keyword::Primitive) {
            attributes_.SkipBehind("endprimitive", begin);
        } else if (parser_.IsWord("config")) {
            attributes_.SkipBehind("endconfig", begin);
        } else if (!parser_.Accept(';')) {
            parser_.FailExpected("a module");
        }
    }
}

/// Makes the components before anything else, so that their names stay what they are.
void ModuleReader::MakeComponents() {
    for (const ModuleHead::Use& use : head_.uses) {
        ModuleHead* const head = heads_.Find(use.name);
        if (head == nullptr) {
            continue;
        }
        const std::string problem = maker_.MakeComponent(*head);
        if (!problem.empty()) {
            parser_.Fail(use.place,
                         "the module " + Quoted(use.name) + " cannot be a component: " + problem);
        }
        headsOfComponents_[head->component] = head;
    }
}

void ModuleReader::DeclarePorts() {
    for (const PortHead& port : head_.ports) {
        const std::string what = "the port " + Quoted(port.name);
        if (!port.problem.empty()) {
            parser_.Fail(head_.place, what + ": " + port.problem);
        }
        if (!Polarity::IsValidValue(port.direction)) {
            parser_.Fail(head_.place, what + " has no direction");
        }
        for (const std::string& name : port.parameters) {
            if (!head_.FindParameter(name)->isLocal) {
                parser_.Fail(head_.place, what + " depends on the parameter " + Quoted(name) +
                                              ", which a model cannot say: make it a localparam");
            }
        }
        if (maker_.DeclarePort(port) == nullptr) {
            parser_.Fail(head_.place, what + " is declared already");
        }
    }
}

/// The head is known; what stands in it is gone through for attributes and comments.
void ModuleReader::ReadHead() {
    while (!parser_.IsSign(';')) {
        if (parser_.Get().kind == TokenKind::End) {
            parser_.FailExpected("\";\"");
        }
        if (parser_.Accept('#')) {
            ReadParametersInHead();
        } else if (parser_.Accept('(')) {
            ReadPortsInHead();
        } else {
            parser_.FailExpected("a list of ports");
        }
    }
    attributes_.EndStatement();
    parser_.Next();
}

void ModuleReader::ReadParametersInHead() {
    std::size_t depth = 0;
    parser_.Expect('(');
    for (; depth > 0 || !parser_.IsSign(')'); parser_.Next()) {
        if (parser_.Get().kind == TokenKind::End) {
            parser_.FailExpected("\")\"");
        }
        if (parser_.IsName() && depth == 0 && parser_.GetKeyword() == Keyword::None) {
            name_ = parser_.Get().text;
            GiveParameter(parser_.Get().place);
            parser_.Next();
            parser_.SkipTo(',', ')');
            if (parser_.IsSign(')')) {
                break;
            }
            continue;
        }
        depth += parser_.IsSign('(') || parser_.IsSign('[') ? 1 : 0;
        depth -= parser_.IsSign(')') || parser_.IsSign(']') ? 1 : 0;
    }
    parser_.Next();
}

void ModuleReader::ReadPortsInHead() {
    std::size_t depth = 0;
    attributes_.BeginStatement();
    for (; depth > 0 || !parser_.IsSign(')'); parser_.Next()) {
        if (parser_.Get().kind == TokenKind::AttributesBegin || IsDirection(parser_.GetKeyword())) {
            attributes_.BeginStatement();
            attributes_.ReadAttributes();
        }
        if (parser_.Get().kind == TokenKind::End || parser_.IsSign(';')) {
            parser_.FailExpected("\")\"");
        }
        if (depth > 0 || !parser_.IsName()) {
            depth += parser_.IsSign('(') || parser_.IsSign('[') ? 1 : 0;
            depth -= parser_.IsSign(')') || parser_.IsSign(']') ? 1 : 0;
            continue;
        }
        name_ = parser_.Get().text;
        if (Signal* const port = maker_.FindSignal(name_)) {
            attributes_.TakeCommentsBefore();
            attributes_.GiveTo({port, port});
        }
    }
    parser_.Next();
}

void ModuleReader::ReadBody() {
    for (;;) {
        attributes_.BeginStatement();
        attributes_.ReadAttributes();
        attributes_.TakeCommentsBefore();
        const Keyword keyword = parser_.GetKeyword();
        // A sink is not told of this, which is so in no written netlist.
        if (maker_.GetSink() != nullptr && attributes_.IsHidden() &&
            keyword != Keyword::Parameter && keyword != Keyword::Defparam) {
            parser_.Fail("this is hidden from synthesis");
        }
        if (keyword == Keyword::Endmodule) {
            return;
        }
        maker_.SetPlace(parser_.Get().place);
        ReadStatement();
    }
}

void ModuleReader::ReadStatement() {
    const Keyword keyword = parser_.GetKeyword();
    switch (keyword) {
    case Keyword::None:
        if (parser_.IsName()) {
            ReadInstances();
            return;
        }
        if (parser_.IsSign(';')) {
            break;
        }
        if (parser_.Get().kind == TokenKind::End) {
            parser_.Fail(head_.place, "\"endmodule\" does not follow this");
        }
        parser_.FailExpected("a declaration, an assignment or an instance");
    case Keyword::Input:
    case Keyword::Output:
    case Keyword::Inout:
        ReadPortDeclaration();
        break;
    case Keyword::Wire:
    case Keyword::Logic:
        ReadNetDeclaration(NetKind::Wire);
        break;
    case Keyword::Supply0:
        ReadNetDeclaration(NetKind::Supply0);
        break;
    case Keyword::Supply1:
        ReadNetDeclaration(NetKind::Supply1);
        break;
    case Keyword::Parameter:
    case Keyword::Localparam:
        ReadParameters(keyword == Keyword::Localparam);
        break;
    case Keyword::Assign:
        ReadAssignments();
        break;
    case Keyword::Defparam:
        ReadDefparams();
        break;
    case Keyword::Specify:
        attributes_.SkipBehind("endspecify", parser_.Get().place);
        return;
    case Keyword::Specparam:
        scanner_.SkipToSemicolon();
        break;
    case Keyword::Generate:
    case Keyword::Endgenerate:
        // What could vary inside is refused where it stands.
        parser_.Next();
        attributes_.Drop();
        return;
    default:
        RefuseStatement(keyword);
    }
    attributes_.EndStatement();
    parser_.Expect(';');
}

void ModuleReader::RefuseStatement(Keyword keyword) {
    const std::string word = parser_.Show();
    switch (keyword) {
    case Keyword::Gate:
        parser_.Fail("the gate " + word +
                     ": a model's instances are of modules with named ports; map gates to cells of "
                     "a library first");
    case Keyword::OtherNet:
        parser_.Fail("nets of the kind " + word + ": a model has wires alone");
    case Keyword::Module:
    case Keyword::Primitive:
        parser_.Fail("\"endmodule\" is expected before this");
    default:
        parser_.Fail(word + " describes behaviour: synthesise the design first");
    }
}

/// Declares the ports' direction once more; the head is known.
void ModuleReader::ReadPortDeclaration() {
    parser_.Next();
    for (Keyword keyword = parser_.GetKeyword();
         keyword == Keyword::Wire || keyword == Keyword::Logic || keyword == Keyword::Signed ||
         keyword == Keyword::Vectored;
         keyword = parser_.GetKeyword()) {
        parser_.Next();
    }
    if (parser_.GetKeyword() != Keyword::None) {
        RefuseStatement(parser_.GetKeyword());
    }
    expressions_.ReadRange();
    do {
        const Place place = parser_.Get().place;
        parser_.TakeName(name_, "name of a port");
        Signal* const port = maker_.FindSignal(name_);
        if (port == nullptr || !port->IsPort()) {
            parser_.Fail(place, Quoted(name_) + " is not in the list of ports");
        }
        attributes_.GiveTo({port, port});
    } while (parser_.Accept(','));
}

void ModuleReader::RefuseStrengthOrDelay(std::string_view what) {
    if (parser_.IsSign('#')) {
        parser_.Fail("a delay of " + std::string(what) + ": a model has none");
    }
    if (parser_.IsSign('(')) {
        parser_.Fail("a strength of " + std::string(what) + ": a model has none");
    }
}

void ModuleReader::ReadNetDeclaration(NetKind kind) {
    parser_.Next();
    for (Keyword keyword = parser_.GetKeyword();
         keyword == Keyword::Signed || keyword == Keyword::Vectored || keyword == Keyword::Logic;
         keyword = parser_.GetKeyword()) {
        parser_.Next();
    }
    RefuseStrengthOrDelay("a net");
    const std::optional<Range> range = expressions_.ReadRange();
    RefuseStrengthOrDelay("a net");
    do {
        ReadOneNet(kind, range);
    } while (parser_.Accept(','));
}

void ModuleReader::ReadOneNet(NetKind kind, const std::optional<Range>& range) {
    const Place place = parser_.Get().place;
    parser_.TakeName(name_, "name of a net");
    if (parser_.IsSign('[')) {
        parser_.Fail(place, "the array " + Quoted(name_) + ": a model has nets and buses alone");
    }
    Signal* const signal = DeclareNet(range, place);
    attributes_.GiveTo({signal, signal});
    target_.Clear(place);
    Piece piece;
    piece.signal = signal;
    target_.pieces.push_back(piece);
    target_.width = static_cast<std::uint64_t>(signal->GetWidth());
    if (kind != NetKind::Wire) {
        value_.Clear(place);
        value_.number = Number::Read(kind == NetKind::Supply1 ? "'1" : "'0");
        Assign(target_, value_);
    }
    if (parser_.Accept('=')) {
        expressions_.Read(value_, ExpressionReader::Undeclared::Refuse);
        Assign(target_, value_);
    }
}

/// Declares the net `name_`. A port may be declared as a net once more.
Signal* ModuleReader::DeclareNet(const std::optional<Range>& range, const Place& place) {
    maker_.SetPlace(place);
    if (Signal* const signal = maker_.DeclareSignal(name_, range)) {
        return signal;
    }
    Signal* const present = maker_.FindSignal(name_);
    if (present == nullptr || !present->IsPort()) {
        parser_.Fail(place, Quoted(name_) + " is declared already" +
                                (present == nullptr ? ", as an instance" : ""));
    }
    const bool isBus = present->GetSignalType() == SignalTypeBus;
    if (isBus != range.has_value() ||
        (isBus && !(NetlistMaker::GetRange(static_cast<const Bus&>(*present)) == *range))) {
        parser_.Fail(place, Quoted(name_) + " is a port of another range");
    }
    return present;
}

void ModuleReader::ReadParameters(bool isLocal) {
    parser_.Next();
    while (parser_.GetKeyword() == Keyword::Signed || parser_.GetKeyword() == Keyword::Type) {
        parser_.Next();
    }
    expressions_.ReadRange();
    do {
        const Place place = parser_.Get().place;
        parser_.TakeName(name_, "name of a parameter");
        if (!isLocal) {
            GiveParameter(place);
        }
        parser_.SkipTo(',', ',');
    } while (parser_.Accept(','));
}

/// Makes the module's parameter `name_` an attribute of the netlist.
void ModuleReader::GiveParameter(const Place& place) {
    const ParameterHead* const parameter = head_.FindParameter(name_);
    if (parameter == nullptr || parameter->isLocal) {
        return;
    }
    if (!parameter->value) {
        parser_.Fail(place, "the value of the parameter " + Quoted(name_) + " is no literal");
    }
    if (NetlistSink* const sink = maker_.GetSink()) {
        sink->TakeParameter({}, name_, *parameter->value, attributes_.IsHidden(), place);
        return;
    }
    const std::string problem = SetAttribute(maker_.GetNetlist(), name_, *parameter->value,
                                             attributes_.IsHidden() ? Hidden : Seen, nullptr);
    if (!problem.empty()) {
        parser_.Fail(place, "the parameter " + Quoted(name_) + ": " + problem);
    }
}

void ModuleReader::ReadAssignments() {
    parser_.Next();
    RefuseStrengthOrDelay("an assignment");
    do {
        expressions_.Read(target_, ExpressionReader::Undeclared::Declare);
        for (const Piece& piece : target_.pieces) {
            if (piece.signal == nullptr) {
                parser_.Fail(target_.place, "a constant on the left of an assignment");
            }
        }
        if (target_.number) {
            parser_.Fail(target_.place, "a constant on the left of an assignment");
        }
        parser_.Expect('=');
        expressions_.Read(value_, ExpressionReader::Undeclared::Refuse);
        Assign(target_, value_);
    } while (parser_.Accept(','));
}

void ModuleReader::Assign(const Expression& target, const Expression& value) {
    NetlistSink* const sink = maker_.GetSink();
    if (value.IsConstant() && sink != nullptr) {
        sink->Tie(maker_.GetMembers(target.pieces), expressions_.GetBits(value, target.width),
                  target.place);
        return;
    }
    if (value.IsConstant()) {
        Tie(*maker_.GetSignal(target.pieces), value);
        return;
    }
    if (sink != nullptr) {
        const Members members = maker_.GetMembers(target.pieces);
        sink->Assign(members, maker_.GetMembers(value.pieces), target.place);
        return;
    }
    if (target.width != value.width) {
        parser_.Fail(value.place, std::to_string(value.width) + " bits are assigned to " +
                                      std::to_string(target.width));
    }
    Signal& signal = *maker_.GetSignal(target.pieces);
    Signal& source = *maker_.GetSignal(value.pieces);
    if (&signal == &source) {
        parser_.Fail(value.place, Quoted(signal.GetNameView()) + " is assigned to itself");
    }
    signal.Connect(&source);
}

void ModuleReader::Tie(Signal& signal, const Expression& value) {
    if (!std::string_view(signal.GetConstantValue().GetValue()).empty()) {
        parser_.Fail(value.place,
                     Quoted(signal.GetNameView()) + " has a constant already, and a model has one");
    }
    const int type = signal.GetSignalType();
    const bool isBare = type == SignalTypeScalar || type == SignalTypeBusIndex;
    const std::string constant =
        expressions_.MakeConstant(value, static_cast<std::uint64_t>(signal.GetWidth()), isBare);
    signal.AssignConstantValue(constant.c_str());
}

/// "defparam U1.INIT = 1, U2.INIT = 2"
void ModuleReader::ReadDefparams() {
    parser_.Next();
    do {
        EarlyOverride early;
        early.override.place = parser_.Get().place;
        parser_.TakeName(early.instance, "name of an instance");
        parser_.Expect('.');
        parser_.TakeName(early.override.name, "name of a parameter");
        if (parser_.IsSign('.')) {
            parser_.Fail(early.override.place,
                         "a name of another level of the design: a model has one level");
        }
        parser_.Expect('=');
        early.override.value = ReadValue(early.override.name);
        early.isHidden = attributes_.IsHidden();
        Instance* const instance = maker_.FindInstance(early.instance);
        if (instance == nullptr) {
            earlyOverrides_.push_back(std::move(early));
        } else {
            SetParameter(*instance, *FindHead(*instance), early.override, early.isHidden);
        }
    } while (parser_.Accept(','));
}

void ModuleReader::SetEarlyOverrides() {
    for (const EarlyOverride& early : earlyOverrides_) {
        Instance* const instance = maker_.FindInstance(early.instance);
        if (instance == nullptr) {
            parser_.Fail(early.override.place,
                         "the instance " + Quoted(early.instance) + " is not declared");
        }
        SetParameter(*instance, *FindHead(*instance), early.override, early.isHidden);
    }
}

ModuleHead* ModuleReader::FindHead(const Instance& instance) const {
    return headsOfComponents_.at(instance.GetComponent());
}

/// Reads the value of an instance's parameter.
Value ModuleReader::ReadValue(std::string_view parameter) {
    const Place place = parser_.Get().place;
    const bool isInParentheses = parser_.Accept('(');
    const bool isNegative = parser_.Accept('-');
    Value value;
    try {
        if (parser_.Get().kind == TokenKind::Number) {
            value = ValueOf(Number::Read(parser_.Get().text), isNegative);
            parser_.Next();
        } else if (isNegative) {
            parser_.FailExpected("a number");
        } else if (parser_.Get().kind == TokenKind::String) {
            value = ValueOfString(parser_.Get().text);
            parser_.Next();
        } else if (parser_.IsSign('{')) {
            value = ReadBitsValue();
        } else if (parser_.IsName()) {
            value = ReadNamedValue(parameter);
        } else {
            parser_.FailExpected("a number or a string");
        }
    } catch (const LiteralProblem& problem) {
        parser_.Fail(place, problem.text);
    }
    if (isInParentheses) {
        parser_.Expect(')');
    }
    return value;
}

/// The value of a localparam, or the parameter INIT of the module itself, which the Verilog writer
/// passes on in modules of certain names.
Value ModuleReader::ReadNamedValue(std::string_view parameter) {
    const Place place = parser_.Get().place;
    parser_.TakeName(name_, "name of a parameter");
    const ParameterHead* const own = head_.FindParameter(name_);
    if (own == nullptr) {
        parser_.Fail(place, "the parameter " + Quoted(name_) + " is not declared");
    }
    if (!own->value) {
        parser_.Fail(place, "the value of the parameter " + Quoted(name_) + " is no literal");
    }
    if (!own->isLocal) {
        const bool isMacro = head_.name.find("MHALVEX") != std::string::npos ||
                             head_.name.find("HHALVEX") != std::string::npos;
        if (!isMacro || name_ != InitName || parameter != InitName) {
            parser_.Fail(place, "the parameter " + Quoted(name_) +
                                    " as a value: a model passes no parameter on but INIT in a "
                                    "module with MHALVEX or HHALVEX in its name");
        }
    }
    return *own->value;
}

Value ModuleReader::ReadBitsValue() {
    expressions_.Read(value_, ExpressionReader::Undeclared::Refuse);
    if (!value_.IsConstant()) {
        parser_.Fail(value_.place, "a net as the value of a parameter");
    }
    std::string bits;
    for (const Piece& piece : value_.pieces) {
        bits += piece.bits;
    }
    return Value::OfBits(bits);
}

void ModuleReader::SetParameter(Instance& instance, const ModuleHead& head,
                                const Override& override, bool isHidden) {
    const ParameterHead* const parameter = head.FindParameter(override.name);
    if (head.hasParameters && (parameter == nullptr || parameter->isLocal)) {
        parser_.Fail(override.place, "the module " + Quoted(head.name) + " has no parameter " +
                                         Quoted(override.name));
    }
    for (const PortHead& port : head.ports) {
        for (const std::string& name : port.parameters) {
            if (name == override.name) {
                parser_.Fail(override.place,
                             "the port " + Quoted(port.name) + " of " + Quoted(head.name) +
                                 " depends on this parameter, and a model's components have pins "
                                 "of fixed ranges");
            }
        }
    }
    if (NetlistSink* const sink = maker_.GetSink()) {
        sink->TakeParameter(maker_.GetOwner(instance), override.name, override.value, isHidden,
                            override.place);
        return;
    }
    const std::string problem =
        SetAttribute(instance, override.name, override.value, isHidden ? Hidden : Seen, nullptr);
    if (!problem.empty()) {
        parser_.Fail(override.place, "the parameter " + Quoted(override.name) + ": " + problem);
    }
    if (parameter != nullptr && parameter->value) {
        DeclareGeneric(head, override.name, *parameter->value, isHidden);
    } else if (!head.hasParameters) {
        const Value value = override.value.GetZero();
        if (DeclareGeneric(head, override.name, value, isHidden)) {
            assumed_[head.component].push_back({override.name, value});
        }
    }
}

/// Gives the component a parameter that one of its instances sets, with the value that it has in
/// the others: a VHDL component has to declare its generics. \return whether it did not have it.
bool ModuleReader::DeclareGeneric(const ModuleHead& head, const std::string& name,
                                  const Value& value, bool isHidden) {
    if (head.component->GetAttr(name.c_str()) != nullptr) {
        return false;
    }
    SetAttribute(*head.component, name, value, isHidden ? Hidden : Seen, nullptr);
    return true;
}

/// Keeps instances that do not set a parameter from being written with a default that is not known:
/// an attribute of an instance hides that of its component, and without an option it is not
/// written.
void ModuleReader::LeaveOutAssumed() {
    if (assumed_.empty()) {
        return;
    }
    std::size_t leftOut = 0;
    for (Instance* instance : maker_.GetNetlist().GetInstanceIterator()) {
        const auto found = assumed_.find(instance->GetComponent());
        if (found == assumed_.end()) {
            continue;
        }
        for (const Assumed& assumed : found->second) {
            if (instance->GetAttr(assumed.name.c_str()) == nullptr) {
                if (++leftOut > MostLeftOut) {
                    const ModuleHead& head = *FindHead(*instance);
                    parser_.Fail(head.place, "too many instances of " + Quoted(head.name) +
                                                 " leave out parameters whose default values are "
                                                 "not known: a library file has to declare them");
                }
                SetAttribute(*instance, assumed.name, assumed.value, nullptr, nullptr);
            }
        }
    }
}

/// "TYPE #(1) U1 (...), U2 (...);"
void ModuleReader::ReadInstances() {
    const Place place = parser_.Get().place;
    // Most instances are of the same few modules.
    if (lastHead_ == nullptr || parser_.Get().text != lastHead_->name) {
        typeName_ = parser_.Get().text;
        lastHead_ = heads_.Find(typeName_);
    }
    ModuleHead* const head = lastHead_;
    parser_.Next();
    if (head == nullptr) {
        parser_.Fail(place, "the module " + Quoted(typeName_) +
                                " is not declared: a library file has to say which ports it has");
    }
    overrides_.clear();
    if (parser_.Accept('#')) {
        ReadOverrides(*head);
    }
    do {
        ReadOneInstance(*head);
    } while (parser_.Accept(','));
    attributes_.EndStatement();
    parser_.Expect(';');
}

/// "#(1, 2)" or "#(.A(1), .B(2))", the number sign being read.
void ModuleReader::ReadOverrides(const ModuleHead& head) {
    if (!parser_.Accept('(')) {
        parser_.FailExpected("\"(\"");
    }
    std::size_t position = 0;
    while (!parser_.Accept(')')) {
        Override override;
        override.place = parser_.Get().place;
        if (parser_.Accept('.')) {
            parser_.TakeName(override.name, "name of a parameter");
            parser_.Expect('(');
            if (!parser_.IsSign(')')) {
                override.value = ReadValue(override.name);
                overrides_.push_back(override);
            }
            parser_.Expect(')');
        } else {
            while (position < head.parameters.size() && head.parameters[position].isLocal) {
                ++position;
            }
            if (position == head.parameters.size()) {
                parser_.Fail("the module " + Quoted(head.name) +
                             " has no further parameter that this could be the value of");
            }
            override.name = head.parameters[position++].name;
            override.value = ReadValue(override.name);
            overrides_.push_back(override);
        }
        if (!parser_.IsSign(')')) {
            parser_.Expect(',');
        }
    }
}

void ModuleReader::ReadOneInstance(ModuleHead& head) {
    const Place place = parser_.Get().place;
    if (parser_.IsSign('(')) {
        parser_.Fail("an instance of " + Quoted(head.name) + " without a name");
    }
    parser_.TakeName(name_, "name of an instance");
    if (parser_.IsSign('[')) {
        parser_.Fail(place,
                     "the array of instances " + Quoted(name_) + ": a model has single instances");
    }
    maker_.SetPlace(place);
    Instance* const instance = maker_.AddInstance(name_, head);
    if (instance == nullptr) {
        parser_.Fail(place, Quoted(name_) + " is declared already");
    }
    attributes_.GiveTo({instance, instance});
    parser_.Expect('(');
    ReadConnections(head, *instance);
    for (const Override& override : overrides_) {
        SetParameter(*instance, head, override, attributes_.IsHidden());
    }
}

/// The connections behind the parenthesis, and the one that closes them.
void ModuleReader::ReadConnections(const ModuleHead& head, Instance& instance) {
    pins_.clear();
    for (Pin* pin : instance.GetPinIterator()) {
        pins_.push_back(pin);
    }
    isConnected_.assign(head.ports.size(), false);
    if (parser_.Accept(')')) {
        return;
    }
    std::size_t port = 0;
    bool hasNames = false;
    for (bool isFirst = true;; isFirst = false) {
        parser_.SkipAttributes();
        if (isFirst) {
            hasNames = parser_.IsSign('.');
        }
        if (parser_.IsSign('.') != hasNames) {
            parser_.Fail("connections by name and by position in one instance");
        }
        if (hasNames) {
            ReadNamedConnection(head, instance, port);
        } else {
            if (port >= head.ports.size()) {
                parser_.Fail("the module " + Quoted(head.name) + " has " +
                             std::to_string(head.ports.size()) + " ports and no further one");
            }
            if (!parser_.IsSign(',') && !parser_.IsSign(')')) {
                expressions_.Read(value_, ExpressionReader::Undeclared::Declare);
                Connect(head, instance, port);
            }
        }
        ++port;
        if (!parser_.Accept(',')) {
            break;
        }
    }
    parser_.Expect(')');
}

/// The index of a port; `hint` is tried first. Long lists get an index.
std::size_t ModuleReader::FindPort(const ModuleHead& head, std::string_view name,
                                   std::size_t hint) {
    constexpr std::size_t Few = 16;
    const bool isAtHint = hint < head.ports.size() && head.ports[hint].name == name;
    if (isAtHint || head.ports.size() <= Few) {
        return head.FindPort(name, hint);
    }
    std::unordered_map<std::string_view, std::size_t>& places = portPlaces_[&head];
    if (places.empty()) {
        for (std::size_t i = 0; i < head.ports.size(); ++i) {
            places.emplace(head.ports[i].name, i);
        }
    }
    const auto found = places.find(name);
    return found == places.end() ? head.ports.size() : found->second;
}

/// ".PORT(expression)". \param port where the port is looked for first; becomes where it is.
void ModuleReader::ReadNamedConnection(const ModuleHead& head, const Instance& instance,
                                       std::size_t& port) {
    parser_.Next();
    const Place place = parser_.Get().place;
    // "*" and the parenthesis behind it are one token.
    if (parser_.IsSign('*') || parser_.Get().kind == TokenKind::AttributesEnd) {
        parser_.Fail("the connection \".*\": write the connections one by one");
    }
    if (!parser_.IsName()) {
        parser_.FailExpected("the name of a port");
    }
    port = FindPort(head, parser_.Get().text, port);
    if (port >= head.ports.size()) {
        parser_.Fail("the module " + Quoted(head.name) + " has no port " + parser_.Show());
    }
    if (isConnected_[port]) {
        parser_.Fail("the port " + parser_.Show() + " is connected already");
    }
    isConnected_[port] = true;
    parser_.Next();
    if (!parser_.IsSign('(')) {
        ReadImplicitConnection(head, instance, port);
        return;
    }
    parser_.Next();
    if (!parser_.IsSign(')')) {
        expressions_.Read(value_, ExpressionReader::Undeclared::Declare);
        value_.place = value_.pieces.empty() ? value_.place : place;
        Connect(head, instance, port);
    }
    parser_.Expect(')');
}

/// ".PORT" alone connects the net of that name (IEEE 1800).
void ModuleReader::ReadImplicitConnection(const ModuleHead& head, const Instance& instance,
                                          std::size_t port) {
    name_ = head.ports[port].name;
    Signal* const signal = maker_.FindSignal(name_);
    if (signal == nullptr) {
        parser_.Fail("the net " + Quoted(name_) + " is not declared");
    }
    value_.Clear(parser_.Get().place);
    Piece piece;
    piece.signal = signal;
    value_.pieces.push_back(piece);
    value_.width = static_cast<std::uint64_t>(signal->GetWidth());
    Connect(head, instance, port);
}

/// Connects what was read to a pin.
void ModuleReader::Connect(const ModuleHead& head, const Instance& instance, std::size_t port) {
    NetlistSink* const sink = maker_.GetSink();
    const std::uint64_t width = head.ports[port].GetWidth();
    if (value_.IsConstant() && sink != nullptr) {
        sink->ConnectConstant(head.ports[port], value_.place);
        return;
    }
    if (value_.IsConstant()) {
        Pin& pin = *pins_[port];
        const bool isBare = pin.GetPinType() != PinTypeBus;
        maker_.ConnectConstant(instance, pin, expressions_.MakeConstant(value_, width, isBare));
        return;
    }
    if (value_.width != width) {
        parser_.Fail(value_.place,
                     "the port " + Quoted(head.ports[port].name) + " of " + Quoted(head.name) +
                         " has " + std::to_string(width) + (width == 1 ? " bit" : " bits") +
                         (head.isDeclared ? "" : " in an earlier connection") + ", and " +
                         std::to_string(value_.width) + " are connected to it");
    }
    if (sink != nullptr) {
        sink->Connect(head.ports[port], maker_.GetMembers(value_.pieces), value_.place);
        return;
    }
    Signal* const signal = maker_.GetSignal(value_.pieces);
    if (NetlistMaker::IsOpenWord(signal->GetNameView())) {
        parser_.Fail(value_.place, "a net of this name, which stands for an open pin in a model");
    }
    signal->Connect(pins_[port]);
}

} // namespace Orn_Hdl::Readers
