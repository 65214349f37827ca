/// \file
/// `Engine`, the front door of the library.
///
/// A short tour:
/// \code
/// #include <Orn_Hdl/Orn_Hdl.h>
///
/// int main() {
///     Orn_Hdl::Engine engine;
///     engine.CreateAndAddModel("top", "");
///     engine.UseModel("top");
///     engine.Execute("ADD COMPONENT INV");
///     engine.Execute("ADD PIN INV I input");
///     engine.Execute("ADD PIN INV O output");
///     engine.Execute("ADD PORT A input");
///     engine.Execute("ADD PORT Y output");
///     engine.Execute("ADD INSTANCE INV U1");
///     engine.Execute("CONNECT SIGNAL A U1.I");
///     engine.Execute("CONNECT SIGNAL Y U1.O");
///     engine.Execute("WRITE VERILOG -NOHEADER top.v");
/// }
/// \endcode
#pragma once

#include "Port/Export.h"
#include "Port/TextArgument.h"

#include <memory>

namespace Orn_Hdl {

class Model;

/// Holds named designs (models) and runs text commands and command files on them. The names of
/// models are case-insensitive; a null text is read as "" everywhere. The name of a model is that
/// of its netlist, so SET NETLIST NAME renames it: keep the pointer of such a model, not its name.
///
/// Engines are independent of one another. One engine and its models belong to one thread at a
/// time; while nobody changes them, any number of threads may call their const operations, and
/// those of all that they hold.
class ORN_HDL_API Engine {
public:
    /// An engine without models.
    Engine();
    Engine(const Engine&) = delete;
    Engine& operator=(const Engine&) = delete;
    /// Takes over the models of another engine, which then has none. Pointers to the models stay
    /// valid.
    /// \throws std::bad_alloc, nothing changed, when allocation fails.
    Engine(Engine&& other); // NOLINT(performance-noexcept-move-constructor)
    /// Deletes the models of this engine and takes over those of another one, which then has none.
    /// \throws std::bad_alloc, nothing changed, when allocation fails.
    Engine& operator=(Engine&& other); // NOLINT(performance-noexcept-move-constructor)
    /// Deletes every model, the last one first. A command of a model may destroy the engine; see
    /// `Model::~Model`.
    ~Engine();

    /// Makes a model, which does not become the current one.
    /// \param sourceFile the source file to record in the model.
    /// \return false, without a change, if a model of that name exists.
    bool CreateAndAddModel(const Port::TextArgument& name, const Port::TextArgument& sourceFile);
    /// Makes a model the current one. \return false if there is none of that name.
    bool UseModel(const Port::TextArgument& name);
    /// Deletes a model. If the model is executing a command, which may be the caller, the engine
    /// gives it up at once, and the model is destroyed when its outermost line or file is done.
    /// \return false if there is none of that name.
    bool RemoveModel(const Port::TextArgument& name);
    /// The model of that name, owned by the engine; null if there is none.
    Model* GetModel(const Port::TextArgument& name) const;

    /// Sets `HdlOptions::threads` of all models, and of those that are made later.
    /// \param threads how many threads may write a netlist or read a command file together: 1, the
    /// default, for the caller's alone, 0 for as many as the system gives, at most 8.
    void SetThreads(unsigned threads) noexcept;
    /// The number of threads that `SetThreads` has set.
    unsigned GetThreads() const noexcept;

    /// Runs one command line on the current model.
    /// \throws Exception if the line fails; "Missing Model.\n" if there is no current model.
    void Execute(const Port::TextArgument& text);
    /// Runs one command line on a named model.
    /// \throws Exception if the line fails; "Missing Model.\n" if there is no such model.
    void Execute(const Port::TextArgument& modelName, const Port::TextArgument& text);
    /// Replays a command file on a named model, which is created if it does not exist.
    /// \return false if the file cannot be opened.
    /// \throws Exception if a line fails; earlier lines keep their effect.
    bool ReadCommandFile(const Port::TextArgument& modelName, const Port::TextArgument& fileName);
    /// Clears the model's modified flag. No file is written.
    /// \return false if there is no model of that name.
    bool WriteCommandFile(const Port::TextArgument& modelName, const Port::TextArgument& fileName);

    /// Whether a word is reserved in VHDL (IEEE 1076-1993, 13.9), in any letter case.
    static bool IsVhdlKeyword(const Port::TextArgument& word);
    /// Whether a word is reserved in Verilog (IEEE 1364-1995, annex B; without "force"), in this
    /// letter case.
    static bool IsVerilogKeyword(const Port::TextArgument& word);
    /// Writes a file that holds only the header banner. Null texts are read as "". A failure to
    /// write the file is not reported: to detect it, write a `NetlistHeader` to a stream of your
    /// own. \param vhdlComments true for VHDL comments, false for Verilog's.
    static void
    WriteHalvexHeader(const Port::TextArgument& application, const Port::TextArgument& command,
                      const Port::TextArgument& designName, const Port::TextArgument& device,
                      const Port::TextArgument& purpose, const Port::TextArgument& reference,
                      bool vhdlComments, const Port::TextArgument& fileName);

private:
    struct Implementation;
    std::unique_ptr<Implementation> implementation_;
};

} // namespace Orn_Hdl
