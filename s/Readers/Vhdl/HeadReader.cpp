#include "Readers/Vhdl/HeadReader.h"

#include "Port/Ascii.h"
#include "Readers/Vhdl/Configurations.h"
#include "Readers/Vhdl/Types.h"

#include <memory>
#include <utility>

namespace Orn_Hdl::Readers::Vhdl {

namespace {

bool MayBeSwitch(std::string_view text) {
    return text.find("translate_o") != std::string_view::npos;
}

/// Whether "end" and this word close something that no plain "end" closes.
bool HasOwnEnd(Keyword keyword) {
    switch (keyword) {
    case Keyword::Block:
    case Keyword::Case:
    case Keyword::Component:
    case Keyword::For:
    case Keyword::Generate:
    case Keyword::If:
    case Keyword::Postponed:
    case Keyword::Process:
    case Keyword::Record:
    case Keyword::Units:
    case Keyword::Behaviour:
        return true;
    default:
        return false;
    }
}

int DirectionOf(Keyword keyword) {
    switch (keyword) {
    case Keyword::In:
        return Polarity::Input;
    case Keyword::Out:
    case Keyword::Buffer:
        return Polarity::Output;
    case Keyword::Inout:
    case Keyword::Linkage:
        return Polarity::BiDirectional;
    default:
        return Polarity::Invalid;
    }
}

} // namespace

void ReadClause(Parser& parser, Clauses& clauses) {
    const bool isLibrary = parser.GetKeyword() == Keyword::Library;
    parser.Next();
    do {
        std::string text = parser.TakeSource(',', ',');
        if (text.empty()) {
            parser.FailExpected("a name");
        }
        (isLibrary ? clauses.libraries : clauses.uses).push_back(std::move(text));
    } while (parser.Accept(','));
    parser.Expect(';');
}

HeadReader::HeadReader(Scanner& scanner, Design& design, bool isLibrary, NetlistSink* sink)
    : parser_(scanner), scanner_(scanner), design_(design), isLibrary_(isLibrary), sink_(sink) {
    scanner_.SetCommentFilter(MayBeSwitch);
}

void HeadReader::Read() {
    parser_.Next();
    while (!parser_.IsEnd()) {
        ReadUnit();
    }
}

void HeadReader::ReadUnit() {
    switch (parser_.GetKeyword()) {
    case Keyword::Library:
    case Keyword::Use:
        ReadClause(parser_, clauses_);
        return;
    case Keyword::Entity:
        ReadEntity();
        break;
    case Keyword::Architecture:
        ReadArchitecture();
        break;
    case Keyword::Package:
        ReadPackage();
        break;
    case Keyword::Configuration:
        TakeComments();
        design_.configurations.push_back(ReadConfiguration(parser_, sink_));
        design_.configurations.back().isHidden = isHidden_;
        break;
    default:
        if (!parser_.IsWord("context")) {
            parser_.FailExpected("a design unit");
        }
        ReadContextWord();
    }
    clauses_ = Clauses();
    clauses_.formerEnd = scanner_.GetFormerPlace();
}

/// A context declaration or reference (IEEE 1076-2008).
void HeadReader::ReadContextWord() {
    const Place begin = parser_.Get().place;
    parser_.Next();
    parser_.TakeSelectedName(name_, "name of a context");
    if (parser_.IsSign(';') || parser_.IsSign(',')) {
        if (isLibrary_) {
            parser_.SkipStatement();
            return;
        }
        parser_.Fail(begin, "a context reference: a model has library and use clauses; write them "
                            "here");
    }
    parser_.Expect(Keyword::Is, "is");
    SkipUnit(begin);
}

/// Skips to the plain "end" of a unit, and over it.
void HeadReader::SkipUnit(const Place& begin) {
    if (!ReadItems(nullptr)) {
        parser_.Fail(begin, "\"end\" does not follow this");
    }
}

ModuleHead& HeadReader::AddHead(Heads& heads, const std::string& name, const Place& place) {
    ModuleHead* const added = heads.Add(name, place);
    if (added != nullptr) {
        added->source = scanner_.Get().place.file;
        return *added;
    }
    if (!isLibrary_) {
        parser_.Fail(place, Quoted(name) + " is declared already, in " +
                                TextOf(scanner_.GetFiles(), heads.Find(name)->place));
    }
    ignored_ = ModuleHead();
    return ignored_;
}

void HeadReader::ReadEntity() {
    const Place begin = parser_.Get().place;
    parser_.Next();
    const Place place = parser_.Get().place;
    parser_.TakeName(name_, "name of an entity");
    ModuleHead& head = AddHead(design_.entities, name_, place);
    if (&head != &ignored_) {
        design_.clausesOfEntities[&head] = clauses_;
    }
    parser_.Expect(Keyword::Is, "is");
    if (parser_.GetKeyword() == Keyword::Generic) {
        ReadGenerics(head);
    }
    if (parser_.GetKeyword() == Keyword::Port) {
        ReadPorts(head);
    }
    SkipUnit(begin);
}

void HeadReader::ReadArchitecture() {
    parser_.Next();
    auto architecture = std::make_unique<Architecture>();
    architecture->place = parser_.Get().place;
    parser_.TakeName(architecture->name, "name of an architecture");
    parser_.Expect(Keyword::Of, "of");
    parser_.TakeSelectedName(architecture->entity, "name of an entity");
    architecture->clauses = clauses_;
    architecture_ = architecture.get();
    used_.clear();
    lastUsed_.clear();
    ModuleHead* const entity = design_.entities.Find(architecture->entity);
    if (!isLibrary_) {
        if (entity == nullptr || entity->source != architecture->place.file) {
            parser_.Fail(architecture->place, "the entity " + Quoted(architecture->entity) +
                                                  " of this architecture is not in front of it");
        }
        entity->canBeTop = true;
        design_.architectures.push_back(std::move(architecture));
    }
    parser_.Expect(Keyword::Is, "is");
    Heads ignored(true);
    if (!ReadItems(isLibrary_ ? &ignored : &architecture_->components) && !isLibrary_) {
        // Who reads the architecture finds the mistake at its own place.
        design_.unfinished = architecture_;
    }
    if (!isLibrary_) {
        for (const Architecture::Use& use : architecture_->uses) {
            entity->uses.push_back({use.name, use.place});
        }
    }
    architecture_ = nullptr;
}

void HeadReader::ReadPackage() {
    const Place begin = parser_.Get().place;
    parser_.Next();
    const bool isBody = parser_.Accept(Keyword::Body);
    parser_.TakeName(name_, "name of a package");
    parser_.Expect(Keyword::Is, "is");
    if (parser_.GetKeyword() == Keyword::New) {
        parser_.SkipStatement();
        return;
    }
    if (!ReadItems(isBody ? nullptr : &design_.components)) {
        parser_.Fail(begin, "\"end\" does not follow this");
    }
}

void HeadReader::ReadComponent(Heads& heads) {
    parser_.Next();
    const Place place = parser_.Get().place;
    std::string name;
    parser_.TakeName(name, "name of a component");
    ModuleHead& head = AddHead(heads, name, place);
    parser_.Accept(Keyword::Is);
    if (parser_.GetKeyword() == Keyword::Generic) {
        ReadGenerics(head);
    }
    if (parser_.GetKeyword() == Keyword::Port) {
        ReadPorts(head);
    }
    parser_.Expect(Keyword::End, "end");
    parser_.Expect(Keyword::Component, "component");
    parser_.SkipEnd(name);
}

/// Takes what hides text from synthesis off the comments.
void HeadReader::TakeComments() {
    for (const Comment& comment : scanner_.GetComments()) {
        TakeSwitch(comment.text, isHidden_, sink_ == nullptr);
    }
    scanner_.GetComments().clear();
}

void HeadReader::ReadGenerics(ModuleHead& head) {
    parser_.Next();
    parser_.Expect('(');
    do {
        ReadGeneric(head);
    } while (parser_.Accept(';'));
    parser_.Expect(')');
    parser_.Expect(';');
}

/// "A, B : integer := 1"
void HeadReader::ReadGeneric(ModuleHead& head) {
    TakeComments();
    const Keyword keyword = parser_.GetKeyword();
    if (keyword == Keyword::Type || keyword == Keyword::Function || keyword == Keyword::Procedure ||
        keyword == Keyword::Package) {
        // No instance can set what is no constant.
        head.hasParameters = head.hasParameters && head.parameters.empty();
        parser_.SkipTo(';', ')');
        return;
    }
    parser_.Accept(Keyword::Constant);
    const std::size_t first = head.parameters.size();
    do {
        ParameterHead parameter;
        const Place place = parser_.Get().place;
        parser_.TakeName(parameter.name, "name of a generic");
        if (head.FindParameter(parameter.name) != nullptr) {
            parser_.Fail(place, Quoted(parameter.name) + " is declared already");
        }
        parameter.isHidden = isHidden_;
        head.parameters.push_back(std::move(parameter));
    } while (parser_.Accept(','));
    parser_.Expect(':');
    parser_.Accept(Keyword::In);
    const std::string typeName = ReadTypeName(parser_, ')', ')');
    std::optional<Value> value;
    if (parser_.Accept(Becomes)) {
        try {
            value = ReadValue(parser_, typeName, ')', ')', [this, &head](std::string_view name) {
                return Resolve(head, name, nullptr);
            });
        } catch (const LiteralProblem&) {
            value.reset();
        }
    }
    for (std::size_t i = first; i < head.parameters.size(); ++i) {
        ParameterHead& parameter = head.parameters[i];
        parameter.typeName = typeName;
        parameter.value = value;
        if (value && value->type == Attribute::Integer) {
            parameter.number = std::stoll(value->text);
        }
    }
}

std::optional<std::int64_t> HeadReader::Resolve(const ModuleHead& head, std::string_view name,
                                                std::vector<std::string>* used) const {
    const ParameterHead* const parameter = head.FindParameter(name);
    if (parameter == nullptr) {
        return std::nullopt;
    }
    if (used != nullptr) {
        used->emplace_back(parameter->name);
    }
    return parameter->number;
}

void HeadReader::ReadPorts(ModuleHead& head) {
    parser_.Next();
    parser_.Expect('(');
    if (parser_.IsSign(')')) {
        parser_.Fail("an empty list of ports, which VHDL does not have: leave it out");
    }
    do {
        ReadPort(head);
    } while (parser_.Accept(';'));
    parser_.Expect(')');
    parser_.Expect(';');
}

/// "A, B : in std_logic_vector(7 downto 0) := X"00""
void HeadReader::ReadPort(ModuleHead& head) {
    parser_.Accept(Keyword::Signal);
    const std::size_t first = head.ports.size();
    do {
        PortHead port;
        const Place place = parser_.Get().place;
        parser_.TakeName(port.name, "name of a port");
        if (head.FindPort(port.name) != nullptr) {
            parser_.Fail(place, "the port " + Quoted(port.name) + " is declared already");
        }
        port.place = place;
        head.ports.push_back(std::move(port));
    } while (parser_.Accept(','));
    parser_.Expect(':');
    int direction = DirectionOf(parser_.GetKeyword());
    const bool isLinkage = parser_.GetKeyword() == Keyword::Linkage;
    if (direction == Polarity::Invalid) {
        direction = Polarity::Input;
    } else {
        parser_.Next();
    }
    std::vector<std::string> parameters;
    SignalType type = ReadSignalType(parser_, [this, &head, &parameters](std::string_view name) {
        return Resolve(head, name, &parameters);
    });
    if (isLinkage) {
        type.problem = "the mode linkage: a model has in, out and inout";
    }
    const bool hasDefault = parser_.Accept(Becomes) && SkipDefault();
    if (!parser_.IsSign(';') && !parser_.IsSign(')')) {
        parser_.FailExpected("\";\" or \")\"");
    }
    for (std::size_t i = first; i < head.ports.size(); ++i) {
        PortHead& port = head.ports[i];
        port.direction = direction;
        port.range = type.range;
        port.problem = type.problem;
        port.parameters = parameters;
        port.hasDefault = hasDefault;
    }
}

/// Skips the default value of a port. \return whether it is one: 'U', 'X', 'Z' and '-' say no more
/// than an open port does.
bool HeadReader::SkipDefault() {
    bool isValue = false;
    std::size_t depth = 0;
    for (; !parser_.IsEnd() && !parser_.IsSign(';'); parser_.Next()) {
        const Token& token = parser_.Get();
        if (depth == 0 && parser_.IsSign(')')) {
            break;
        }
        depth += parser_.IsSign('(') ? 1 : 0;
        depth -= depth > 0 && parser_.IsSign(')') ? 1 : 0;
        isValue = isValue ||
                  (token.kind == TokenKind::Name && parser_.GetKeyword() != Keyword::Others) ||
                  token.kind == TokenKind::BitString || token.kind == TokenKind::Number ||
                  ((token.kind == TokenKind::Character || token.kind == TokenKind::String) &&
                   token.text.find_first_of("01LHlh") != std::string_view::npos);
    }
    return isValue;
}

/// Reads declarations and statements up to the plain "end" of what they are in, and over it.
/// \param components where component declarations go to; null for nowhere.
/// \return false when the file ends before.
bool HeadReader::ReadItems(Heads* components) {
    subprograms_ = 0;
    generates_ = 0;
    for (;;) {
        switch (parser_.GetKeyword()) {
        case Keyword::End:
            if (ReadEnd()) {
                return true;
            }
            break;
        case Keyword::Component:
            if (components != nullptr && subprograms_ == 0) {
                ReadComponent(*components);
            } else {
                parser_.Next();
            }
            break;
        case Keyword::Function:
        case Keyword::Procedure:
            ReadSubprogram();
            break;
        case Keyword::Generate:
            ++generates_;
            parser_.Next();
            break;
        case Keyword::Use:
            if (architecture_ != nullptr && subprograms_ == 0 && generates_ == 0) {
                ReadClause(parser_, architecture_->clauses);
                break;
            }
            parser_.SkipStatement();
            break;
        case Keyword::Alias:
        case Keyword::Attribute:
        case Keyword::Constant:
        case Keyword::Signal:
            parser_.SkipStatement();
            break;
        case Keyword::None:
            if (parser_.IsEnd()) {
                return false;
            }
            if (parser_.IsName()) {
                ReadLabelled();
                break;
            }
            parser_.Next();
            break;
        default:
            parser_.Next();
            break;
        }
    }
}

/// Reads "end" and what follows it. \return whether it is the plain end of what is being read.
bool HeadReader::ReadEnd() {
    parser_.Next();
    const Keyword keyword = parser_.GetKeyword();
    const bool isGenerate = keyword == Keyword::Generate;
    const bool hasOwn = HasOwnEnd(keyword) || parser_.IsWord("protected");
    const bool isUnit = keyword == Keyword::Architecture || keyword == Keyword::Entity ||
                        keyword == Keyword::Package;
    scanner_.SkipToSemicolon();
    parser_.Accept(';');
    if (isUnit) {
        return true;
    }
    if (hasOwn) {
        generates_ -= isGenerate && generates_ > 0 ? 1 : 0;
        return false;
    }
    if (subprograms_ > 0) {
        --subprograms_;
        return false;
    }
    return generates_ == 0;
}

/// Reads a subprogram up to "is" or the semicolon that ends its declaration.
void HeadReader::ReadSubprogram() {
    std::size_t depth = 0;
    for (parser_.Next(); !parser_.IsEnd(); parser_.Next()) {
        depth += parser_.IsSign('(') ? 1 : 0;
        depth -= depth > 0 && parser_.IsSign(')') ? 1 : 0;
        if (depth == 0 && parser_.IsSign(';')) {
            return;
        }
        if (depth == 0 && parser_.Accept(Keyword::Is)) {
            subprograms_ += parser_.GetKeyword() == Keyword::New ? 0 : 1;
            return;
        }
    }
}

/// Reads what may be an instance: a label, a colon, and the name of what is instantiated.
void HeadReader::ReadLabelled() {
    parser_.Next();
    if (!parser_.Accept(':')) {
        scanner_.SkipToSemicolon();
        return;
    }
    const Place place = parser_.Get().place;
    const Keyword keyword = parser_.GetKeyword();
    const bool isEntity = keyword == Keyword::Entity;
    if (isEntity || keyword == Keyword::Component) {
        parser_.Next();
    } else if (keyword != Keyword::None || !parser_.IsName()) {
        return;
    }
    // Most instances are of the same few components.
    const bool isKnown = isEntity == wasEntity_ && parser_.Get().text == lastUsed_;
    if (isKnown) {
        scanner_.SkipToSemicolon();
        return;
    }
    parser_.TakeSelectedName(name_, "name of a component");
    if (isEntity || parser_.IsSign(';') || parser_.GetKeyword() == Keyword::Port ||
        parser_.GetKeyword() == Keyword::Generic) {
        AddUse(isEntity, place);
    }
    scanner_.SkipToSemicolon();
}

/// Adds the use of `name_`.
void HeadReader::AddUse(bool isEntity, const Place& place) {
    lastUsed_ = name_;
    wasEntity_ = isEntity;
    std::string key = isEntity ? "entity " : "";
    for (const char c : name_) {
        key += Port::ToLower(c);
    }
    if (architecture_ != nullptr && used_.insert(key).second) {
        architecture_->uses.push_back({name_, place, isEntity});
    }
}

} // namespace Orn_Hdl::Readers::Vhdl
