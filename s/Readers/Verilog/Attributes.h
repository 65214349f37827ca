// Attributes and comments of a module's objects: those in "(*" and "*)", and those that are
// comments in the dialect of a synthesis tool.
#pragma once

#include "Readers/NetlistMaker.h"
#include "Readers/Verilog/Literals.h"
#include "Readers/Verilog/Parser.h"

#include <string>
#include <string_view>
#include <utility>
#include <vector>

namespace Orn_Hdl::Readers {

/// An object that can have attributes and a comment.
struct Target {
    AttributeHolder* holder = nullptr;
    Object* object = nullptr;
};

class AttributeReader {
public:
    AttributeReader(Parser& parser, Scanner& scanner, NetlistMaker& maker,
                    const VerilogSetup& setup);

    /// Reads attributes in "(*" and "*)", which belong to what follows them.
    void ReadAttributes();
    /// Takes the comments in front of a statement: dialects' attributes go to their objects, others
    /// are kept for the statement.
    void BeginStatement();
    /// Takes the comments in front of what the present statement declares next.
    void TakeCommentsBefore() { TakeComments(true); }
    /// Gives the attributes and comments in front of the module to the netlist, but for a banner.
    void GiveNotes();
    /// Gives the attributes and comments in front of a statement to an object that it declares.
    void GiveTo(const Target& target);
    /// Takes the comments inside of a statement, before its semicolon.
    void EndStatement();
    /// Drops what was read in front of a statement that declares nothing.
    void Drop();
    /// Skips to a word and over it, with everything that stands before the word.
    void SkipBehind(std::string_view word, const Place& begin);

    /// Whether what follows is hidden from synthesis ("translate_off").
    bool IsHidden() const noexcept { return isHidden_; }

private:
    void TakeComments(bool isBefore);
    bool TakeDialect(const Comment& comment);
    bool TakeNamed(std::string_view text, const std::vector<std::string_view>& words,
                   const Place& place);
    void TakeSynplicity(std::string_view text, const Place& place);
    void TakeSynopsys(std::string_view text, const Place& place);
    void SetOnTargets(std::string_view name, std::string_view value, const Place& place);
    void Set(const Target& target, const std::string& name, const Value& value, const Place& place);
    Target Find(const std::string& name) const;

    struct Read {
        std::string name;
        Value value;
        Place place;
    };

    Parser& parser_;
    Scanner& scanner_;
    NetlistMaker& maker_;
    const VerilogSetup& setup_;
    std::vector<Read> attributes_;
    /// The lines of comments in front of the statement.
    std::vector<std::string> lines_;
    /// What the present or last statement declares.
    std::vector<Target> targets_;
    bool isHidden_ = false;
};

} // namespace Orn_Hdl::Readers
