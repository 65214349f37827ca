// The lines of netlists. What reads them here understands just enough of a netlist that the
// library's readers have accepted.
#include "diff/NetlistTokens.h"
#include "diff/PlaceFinder.h"

#include "Port/Ascii.h"

#include <string>
#include <utility>
#include <vector>

namespace Tool::Diff {

namespace {

using What = PlaceFinder::What;

bool IsWord(const NetlistToken& token, std::string_view word) {
    return token.IsName() && !token.isEscaped && Port::EqualIgnoringCase(token.text, word);
}

bool IsAnyWord(const NetlistToken& token, std::initializer_list<std::string_view> words) {
    for (const std::string_view word : words) {
        if (IsWord(token, word)) {
            return true;
        }
    }
    return false;
}

/// What both languages have in common: statements, and lists in parentheses.
class Reading {
public:
    Reading(const char* systemName, NetlistTokens::Language language, PlaceFinder& finder)
        : tokens_(systemName, language), finder_(finder) {}

protected:
    /// Makes the next word the present one, and counts parentheses.
    bool Next() {
        std::swap(beforeLast_, last_);
        std::swap(last_, token_);
        if (!tokens_.Next(token_)) {
            return false;
        }
        depth_ += token_.IsSign('(') ? 1 : token_.IsSign(')') && depth_ > 0 ? -1 : 0;
        return true;
    }
    void Found(What what, std::string_view first, std::string_view second,
               std::uint64_t line) const {
        if (what == What::Module || finder_.Wants(first)) {
            finder_.Found(what, first, second, line);
        }
    }
    bool IsDesign(const NetlistToken& token) const {
        return Port::EqualIgnoringCase(token.text, finder_.GetDesign());
    }

    NetlistTokens tokens_;
    PlaceFinder& finder_;
    NetlistToken token_;
    NetlistToken last_;
    NetlistToken beforeLast_;
    int depth_ = 0;
};

class VerilogReading : public Reading {
public:
    VerilogReading(const char* systemName, PlaceFinder& finder)
        : Reading(systemName, NetlistTokens::Language::Verilog, finder) {}

    void Run() {
        while (Next()) {
            if (IsAnyWord(last_, {"module", "macromodule"}) && token_.IsName()) {
                BeginModule();
            } else if (IsWord(token_, "endmodule")) {
                module_.clear();
            } else if (!module_.empty()) {
                Take();
            }
        }
    }

private:
    void BeginModule() {
        module_ = token_.text;
        isDesign_ = IsDesign(token_);
        isDeclaration_ = isAssignment_ = false;
        instance_.clear();
        depth_ = 0;
        Found(isDesign_ ? What::Module : What::Component, isDesign_ ? "" : token_.text, "",
              token_.line);
    }

    void Take() {
        if (token_.IsSign(';')) {
            isDeclaration_ = isAssignment_ = false;
            instance_.clear();
            depth_ = 0;
        } else if (IsAnyWord(token_, {"input", "output", "inout", "wire", "tri", "supply0",
                                      "supply1", "logic", "reg"})) {
            isDeclaration_ = true;
        } else if (IsWord(token_, "assign")) {
            isAssignment_ = true;
        } else if (token_.IsSign('=')) {
            isAssignment_ = false;
        } else if (token_.IsSign('(') && isDesign_ && !isDeclaration_ && depth_ == 1) {
            TakeInstance();
        } else if (token_.IsName() && isDeclaration_ && !last_.IsSign('[')) {
            Found(isDesign_ ? What::Signal : What::Pin, isDesign_ ? token_.text : module_,
                  isDesign_ ? "" : token_.text, token_.line);
        } else if (token_.IsName() && isAssignment_) {
            Found(What::Assignment, token_.text, "", token_.line);
        } else if (token_.IsName() && last_.IsSign('.') && depth_ == 1 && !instance_.empty()) {
            Found(What::Connection, instance_, token_.text, token_.line);
        }
    }

    /// "INV U1 (", or ") U1 (" behind parameters.
    void TakeInstance() {
        if (last_.IsName() &&
            (beforeLast_.IsName() || beforeLast_.IsSign(')') || beforeLast_.IsSign(','))) {
            instance_ = last_.text;
            Found(What::Instance, instance_, "", last_.line);
        }
    }

    std::string module_;
    std::string instance_;
    bool isDesign_ = false;
    bool isDeclaration_ = false;
    bool isAssignment_ = false;
};

class VhdlReading : public Reading {
public:
    VhdlReading(const char* systemName, PlaceFinder& finder)
        : Reading(systemName, NetlistTokens::Language::Vhdl, finder) {}

    void Run() {
        while (Next()) {
            if (token_.IsSign(';') && depth_ == 0) {
                isSignal_ = false;
                instance_.clear();
                names_.clear();
            } else if (!TakeUnit()) {
                Take();
            }
        }
    }

private:
    enum class Part { Other, Entity, Component, Declarations, Statements };

    /// Whether the word begins or ends an entity, an architecture or a component.
    bool TakeUnit() {
        if (IsWord(last_, "end")) {
            part_ = part_ == Part::Component ? Part::Declarations : Part::Other;
            return true;
        }
        if (IsWord(last_, "entity") && part_ == Part::Other && token_.IsName()) {
            part_ = IsDesign(token_) ? Part::Entity : Part::Other;
            if (part_ == Part::Entity) {
                Found(What::Module, "", "", token_.line);
            }
            return true;
        }
        if (IsWord(last_, "of") && IsWord(architecture_, "architecture")) {
            part_ = IsDesign(token_) ? Part::Declarations : Part::Other;
            architecture_.text.clear();
            return true;
        }
        if (IsWord(last_, "architecture") && part_ == Part::Other) {
            architecture_ = last_;
            return true;
        }
        if (IsWord(last_, "component") && part_ == Part::Declarations && token_.IsName()) {
            part_ = Part::Component;
            owner_ = token_.text;
            Found(What::Component, owner_, "", token_.line);
            return true;
        }
        if (IsWord(token_, "begin") && part_ == Part::Declarations) {
            part_ = Part::Statements;
            return true;
        }
        return false;
    }

    void Take() {
        if (part_ == Part::Statements) {
            TakeStatement();
        } else if (part_ == Part::Declarations) {
            isSignal_ = isSignal_ || IsWord(token_, "signal");
            TakeDeclared(isSignal_);
        } else if (part_ == Part::Entity || part_ == Part::Component) {
            TakeDeclared(depth_ == 1);
        }
    }

    /// Names with commas between them, in front of a colon.
    void TakeDeclared(bool isList) {
        if (isList && token_.IsName()) {
            names_.emplace_back(token_.text, token_.line);
        } else if (isList && token_.IsSign(':')) {
            for (const auto& [name, line] : names_) {
                Found(part_ == Part::Component ? What::Pin : What::Signal,
                      part_ == Part::Component ? owner_ : name,
                      part_ == Part::Component ? name : "", line);
            }
            names_.clear();
            isSignal_ = false;
        } else if (!isList || !token_.IsSign(',')) {
            names_.clear();
        }
    }

    void TakeStatement() {
        if (token_.IsSign(':') && last_.IsName() && depth_ == 0) {
            instance_ = last_.text;
            Found(What::Instance, instance_, "", last_.line);
        } else if (!instance_.empty() && depth_ == 1 && token_.IsName() &&
                   (last_.IsSign('(') || last_.IsSign(','))) {
            Found(What::Connection, instance_, token_.text, token_.line);
        } else if (instance_.empty() && token_.IsName() && depth_ == 0 &&
                   (last_.IsSign(';') || IsWord(last_, "begin"))) {
            Found(What::Assignment, token_.text, "", token_.line);
        }
    }

    Part part_ = Part::Other;
    NetlistToken architecture_;
    std::string owner_;
    std::string instance_;
    std::vector<std::pair<std::string, std::uint64_t>> names_;
    bool isSignal_ = false;
};

/// The members of objects in objects: "modules", a module, "cells", a cell, "connections", a pin.
class JsonReading {
public:
    JsonReading(const char* systemName, PlaceFinder& finder)
        : tokens_(systemName, NetlistTokens::Language::Json), finder_(finder) {}

    void Run() {
        NetlistToken token;
        NetlistToken last;
        while (tokens_.Next(token)) {
            if (token.IsSign('{') || token.IsSign('[')) {
                path_.emplace_back();
            } else if ((token.IsSign('}') || token.IsSign(']')) && !path_.empty()) {
                path_.pop_back();
            } else if (token.IsSign(':') && last.kind == NetlistToken::Kind::String &&
                       !path_.empty()) {
                path_.back() = last.text;
                Take(last.line);
            }
            std::swap(last, token);
        }
    }

private:
    void Take(std::uint64_t line) {
        if (path_.size() < 2 || path_[0] != "modules") {
            return;
        }
        const bool isDesign = path_[1] == finder_.GetDesign();
        const std::string& name = path_.back();
        if (path_.size() == 2) {
            finder_.Found(isDesign ? What::Module : What::Component, isDesign ? "" : name, "",
                          line);
        } else if (path_.size() == 4 && path_[2] == "ports") {
            finder_.Found(isDesign ? What::Signal : What::Pin, isDesign ? name : path_[1],
                          isDesign ? "" : name, line);
        } else if (isDesign && path_.size() == 4 && finder_.Wants(name)) {
            finder_.Found(path_[2] == "cells" ? What::Instance : What::Signal, name, "", line);
        } else if (isDesign && path_.size() == 6 && path_[2] == "cells" &&
                   path_[4] == "connections" && finder_.Wants(path_[3])) {
            finder_.Found(What::Connection, path_[3], name, line);
        }
    }

    NetlistTokens tokens_;
    PlaceFinder& finder_;
    std::vector<std::string> path_;
};

} // namespace

void FindVerilogPlaces(const char* systemName, PlaceFinder& finder) {
    VerilogReading(systemName, finder).Run();
}

void FindVhdlPlaces(const char* systemName, PlaceFinder& finder) {
    VhdlReading(systemName, finder).Run();
}

void FindJsonPlaces(const char* systemName, PlaceFinder& finder) {
    JsonReading(systemName, finder).Run();
}

} // namespace Tool::Diff
