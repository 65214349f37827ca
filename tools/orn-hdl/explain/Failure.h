// A line that failed, and what is said about it.
#pragma once

#include "explain/Syntax.h"

#include "diagnostics/Diagnostic.h"
#include "diagnostics/SourceLines.h"
#include "diagnostics/WordPlaces.h"

#include "Orn_Hdl/Model.h"

#include <cstdint>
#include <functional>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace Tool::Explain {

/// A line that failed.
struct Failure {
    Orn_Hdl::Model& model;
    const Orn_Hdl::StringArray& words;
    /// The text of the exception, without a line end.
    std::string_view message;
    std::uint64_t line;
    /// Null if the line begins with no phrase.
    const Phrase* phrase;
    /// The lines of the file, for a search.
    SourceLines& lines;
    /// Whether all names of the design, and all lines of the file, may be looked at.
    bool maySearch;

    std::string_view GetWord(int index) const { return words.GetView(index); }
    /// The index of the first argument that is this name for the model; -1 if there is none.
    int FindArgument(std::string_view name) const;
};

/// What is said about it.
struct Explanation {
    /// The words concerned.
    std::optional<Mark> mark;
    std::vector<Note> notes;
    /// Notes about other lines, whose places are not made yet.
    struct Elsewhere {
        std::string text;
        std::uint64_t line = 0;
        Mark mark;
    };
    std::vector<Elsewhere> elsewhere;

    void Say(std::string text) { notes.push_back({std::move(text)}); }
    void SayAt(std::string text, std::uint64_t line, const Mark& at) {
        elsewhere.push_back({std::move(text), line, at});
    }
};

/// "Command not find."
void ExplainPhrase(const Failure& failure, Explanation& explanation);
/// "PHRASE: Invalid Arguments."
void ExplainArguments(const Failure& failure, Explanation& explanation);
/// A name that is taken.
void ExplainTaken(std::string_view name, const Failure& failure, Explanation& explanation);
/// A pin that a component has already.
void ExplainTakenPin(const Failure& failure, Explanation& explanation);
/// A component that does not exist.
void ExplainComponent(std::string_view name, const Failure& failure, Explanation& explanation);
/// A signal or an instance that does not exist, in a connection or a constant.
void ExplainSignal(std::string_view name, const Failure& failure, Explanation& explanation);
/// A pin that does not exist.
void ExplainPin(const Failure& failure, Explanation& explanation);
/// The owner of an attribute or comment, if it does not exist.
void ExplainOwner(std::string_view name, const Failure& failure, Explanation& explanation);
/// An attribute that does not exist.
void ExplainAttribute(std::string_view name, const Failure& failure, Explanation& explanation);
/// "Invalid attribute type."
void ExplainAttributeType(const Failure& failure, Explanation& explanation);
/// "Invalid generic value."
void ExplainAttributeOption(const Failure& failure, Explanation& explanation);
/// A file that cannot be written.
void ExplainFile(const Failure& failure, Explanation& explanation);

/// A name for a note: on one line, and not too long.
std::string Show(std::string_view name);
/// Adds "did you mean NAME?" unless the name is empty.
void Suggest(const std::string& meant, Explanation& explanation);

} // namespace Tool::Explain
