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

#include <memory>

namespace Orn_Hdl {

class Model;

/// Holds named designs (models) and runs text commands and command files on them. Names of models
/// ignore letter case; a null text reads as "" everywhere. A model bears the name of its netlist,
/// so SET NETLIST NAME renames it: keep the pointer, not the name, of a model whose commands do so.
///
/// Engines are independent of one another; one engine and its models belong to one thread at a
/// time.
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

    /// Makes a model; it does not become the current one.
    /// \param sourceFile remembered with the model.
    /// \return false, nothing changed, when a model of that name exists.
    bool CreateAndAddModel(const char* name, const char* sourceFile);
    /// Makes a model the current one. \return false when there is none of that name.
    bool UseModel(const char* name);
    /// Deletes a model. One that is carrying out a command, which may be the caller, is no longer
    /// the engine's from here on, and ends when the outermost line or file that it carries out is
    /// through.
    /// \return false when there is none of that name.
    bool RemoveModel(const char* name);
    /// The model of that name, null when there is none. The engine owns it.
    Model* GetModel(const char* name) const;

    /// Runs one command line on the current model, or on a named one.
    /// \throws Exception when the line fails; "Missing Model.\n" when there is no such model.
    void Execute(const char* text);
    void Execute(const char* modelName, const char* text);
    /// Replays a command file on a named model, which is made when it does not exist.
    /// \return false when the file cannot be opened.
    /// \throws Exception when a line fails; the lines before it stay done.
    bool ReadCommandFile(const char* modelName, const char* fileName);
    /// Clears the model's modified flag. No file is written.
    /// \return false when there is no model of that name.
    bool WriteCommandFile(const char* modelName, const char* fileName);

    /// Whether a word is reserved in VHDL (IEEE 1076-1993, 13.9), in any letter case.
    static bool IsVhdlKeyword(const char* word);
    /// Whether a word is reserved in Verilog (IEEE 1364-1995, annex B; without "force"), in this
    /// letter case.
    static bool IsVerilogKeyword(const char* word);
    /// Writes a file that holds only the header banner. Null texts are read as "". Nothing tells
    /// whether the file could be written: `NetlistHeader` on a stream of one's own does.
    /// \param vhdlComments true for VHDL comments, false for Verilog's.
    static void WriteHalvexHeader(const char* application, const char* command,
                                  const char* designName, const char* device, const char* purpose,
                                  const char* reference, bool vhdlComments, const char* fileName);

private:
    struct Implementation;
    std::unique_ptr<Implementation> implementation_;
};

} // namespace Orn_Hdl
