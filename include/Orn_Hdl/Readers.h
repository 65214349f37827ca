/// \file
/// `VerilogReader` and `VhdlReader`, which read structural netlists into models.
#pragma once

#include "Port/Export.h"

#include <functional>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

namespace Orn_Hdl {

class Model;
class Netlist;

/// What becomes of a name that is not a letter or "_" followed by letters, digits and "_".
enum class ReaderNames {
    /// It is replaced by one that is, as far as possible the same.
    Simple,
    /// It stays, an escaped name without its backslashes, as long as a model can hold it. No model
    /// can hold brackets, "-", "," and "\" in a name, and in the name of a bus nothing but letters,
    /// digits and "_".
    Literal
};

/// What becomes of an instance of a module that no file declares.
enum class ReaderUndeclared {
    /// It is an error.
    Refuse,
    /// The module gets the ports that its instances connect by name, as wide as what is connected
    /// to them. A net that has a driver makes a port an input; a net that has none, and that
    /// something reads, makes the only port of unknown direction an output. It is an error when
    /// directions are left, or contradict each other: the message lists the modules that a library
    /// has to declare.
    Infer
};

/// A name of a file that the model does not have.
struct ReaderRenaming {
    /// What has the name. A port is a signal.
    enum class Kind { Module, Component, Pin, Signal, Instance };

    /// The name in the file.
    std::string name;
    /// The name in the model.
    std::string newName;
    /// What has the name.
    Kind kind = Kind::Signal;
    /// Of a pin, the name of its component in the model.
    std::string component = {};
};

/// Reads one module of a structural Verilog netlist (IEEE 1364-2005, and what of IEEE 1800 appears
/// in netlists) into a model.
///
/// The module's ports, nets, assignments and instances become the model's design. The other modules
/// of the file, the library files and black boxes say which pins the components have. Behavioural
/// text, and what a model cannot hold, is an error; so is a name that is used but declared nowhere.
///
/// \code
/// VerilogReader reader;
/// reader.AddLibrary("cells.v");
/// reader.Read("top.v", model);
/// \endcode
///
/// An error throws an `Exception` whose text is `FILE:LINE:COLUMN: error: TEXT`, then the line of
/// the file and a line with a caret below the place. A file is read twice, piece by piece, so it
/// has to be one that can be opened again.
class ORN_HDL_API VerilogReader {
public:
    /// What becomes of an `include directive.
    enum class Includes {
        /// The file is read where the directive stands.
        Follow,
        /// The file is not opened. Its name is added to the include files of the model's options,
        /// which the Verilog writer names in the same directive; the directive has to stand outside
        /// of modules.
        Keep
    };
    /// What becomes of names that are not simple. With `ReaderNames::Simple`, "$" stays in names
    /// that have no range.
    using Names = ReaderNames;
    /// A name of the file that the model does not have, without the backslash of an escaped one.
    using Renaming = ReaderRenaming;
    /// What becomes of instances of modules that no file declares.
    using Undeclared = ReaderUndeclared;

    /// A reader that reads the only module that is not instantiated, keeps attributes and no
    /// comments, follows include directives, makes names simple and refuses undeclared modules.
    VerilogReader();
    VerilogReader(const VerilogReader&) = delete;
    VerilogReader& operator=(const VerilogReader&) = delete;
    ~VerilogReader();

    /// Chooses the module to read.
    /// \param name null and "" choose the only module of the file that no other one instantiates.
    void SetTop(const char* name);
    /// Adds a file whose modules are components. A module of the netlist's own file, and of a file
    /// added before, takes precedence. What their bodies do is passed over.
    /// \param fileName opened by `Read`.
    void AddLibrary(const char* fileName);
    /// Adds the components of a netlist. A module of a file takes precedence.
    /// \param netlist its components' names and pins are copied.
    void AddLibrary(const Netlist& netlist);
    /// Adds a folder in which included files are looked for, after the folder of the file that
    /// includes them.
    void AddIncludeFolder(const char* folder);
    /// Defines a macro without arguments, as a `define directive in front of each file would do.
    void Define(const char* name, const char* text);
    /// Sets what becomes of include directives.
    void SetIncludes(Includes includes) noexcept;
    /// Sets what becomes of names that are not simple.
    void SetNames(Names names) noexcept;
    /// Sets which simple names stay; the others are replaced too, by names with a number, so that a
    /// design can keep clear of the reserved words of another language.
    /// \param keeps called with names of modules, ports, nets and instances; empty for all.
    void SetKeptNames(std::function<bool(std::string_view name)> keeps);
    /// Sets what becomes of instances of modules that no file declares.
    void SetUndeclared(Undeclared undeclared) noexcept;
    /// Whether comments in front of the module, a declaration or an instance become comments of the
    /// objects.
    void KeepComments(bool keep) noexcept;
    /// Whether attributes become attributes of the objects: (* *) attributes, and those that are
    /// comments in the dialect of a synthesis tool.
    void KeepAttributes(bool keep) noexcept;
    /// Whether bits x of constants become don't cares, digits "-" in the model. The model's option
    /// `HdlOptions::dontCares` is set when there are any. Otherwise they are errors.
    void KeepDontCares(bool keep) noexcept;

    /// Reads a file. What the model's netlist held before is destroyed. The model's name becomes
    /// the module's and its source file the file.
    /// \throws Exception, the model unchanged, when the file cannot be read or holds an error.
    void Read(const char* fileName, Model& model);
    /// The names that the last successful `Read` has replaced, in the order of their declarations.
    const std::vector<Renaming>& GetRenamings() const noexcept;

private:
    struct Implementation;

    std::unique_ptr<Implementation> implementation_;
};

/// Reads one architecture of a structural VHDL netlist (IEEE 1076-1993, and what of IEEE 1076-2008
/// appears in netlists) into a model.
///
/// The entity's ports, and the signals, assignments and instances of its architecture, become the
/// model's design. Component declarations, the other entities of the file, the library files and
/// black boxes say which pins the components have. Behavioural text, and what a model cannot hold,
/// is an error; so is a name that is used but declared nowhere. Names that differ in letter case
/// alone are the same, and the model has the one of the declaration.
///
/// \code
/// VhdlReader reader;
/// reader.AddLibrary("cells.vhd");
/// reader.Read("top.vhd", model);
/// \endcode
///
/// An error throws an `Exception` whose text is `FILE:LINE:COLUMN: error: TEXT`, then the line of
/// the file and a line with a caret below the place. A file is read twice, piece by piece, so it
/// has to be one that can be opened again.
class ORN_HDL_API VhdlReader {
public:
    /// What becomes of names that are not simple: those in backslashes.
    using Names = ReaderNames;
    /// A name of the file that the model does not have, with the backslashes around it.
    using Renaming = ReaderRenaming;

    /// A reader that reads the only entity that is not instantiated, keeps attributes and no
    /// comments, and makes names simple.
    VhdlReader();
    VhdlReader(const VhdlReader&) = delete;
    VhdlReader& operator=(const VhdlReader&) = delete;
    ~VhdlReader();

    /// Chooses the entity to read, and its architecture.
    /// \param name "ENTITY" or "ENTITY(ARCHITECTURE)". Without an architecture, the last one of the
    ///        file is read. Null and "" choose the only entity of the file that has an architecture
    ///        and that no other one instantiates.
    void SetTop(const char* name);
    /// Adds a file whose entities, and the component declarations in its packages, are components.
    /// An entity or component of the netlist's own file, and of a file added before, takes
    /// precedence. Architectures are passed over.
    /// \param fileName opened by `Read`.
    void AddLibrary(const char* fileName);
    /// Adds the components of a netlist. An entity or component of a file takes precedence.
    /// \param netlist its components' names, pins and the types of their generics are copied.
    void AddLibrary(const Netlist& netlist);
    /// Sets what becomes of names that are not simple.
    void SetNames(Names names) noexcept;
    /// Sets which simple names stay; the others are replaced too, by names with a number, so that a
    /// design can keep clear of the reserved words of another language.
    /// \param keeps called with names of entities, ports, signals and instances; empty for all.
    void SetKeptNames(std::function<bool(std::string_view name)> keeps);
    /// Whether comments in front of the entity, a declaration or an instance become comments of the
    /// objects.
    void KeepComments(bool keep) noexcept;
    /// Whether attribute specifications become attributes of the objects.
    void KeepAttributes(bool keep) noexcept;
    /// Whether bits 'X' and '-' of constants become don't cares, digits "-" in the model. The
    /// model's option `HdlOptions::dontCares` is set when there are any. Otherwise they are errors.
    void KeepDontCares(bool keep) noexcept;

    /// Adds the components that a file declares to a netlist, as a library for a reader: its
    /// entities, and the component declarations in its packages. What no netlist can have, and what
    /// the netlist has already, is left out.
    /// \throws Exception, the netlist unchanged, when the file cannot be read or holds an error.
    static void ReadComponents(const char* fileName, Netlist& netlist);
    /// Reads a file. What the model's netlist held before is destroyed. The model's name becomes
    /// the entity's and its source file the file. The VHDL options of the model become those with
    /// which the file could have been written: its library and use clauses, whether it declares
    /// components and a configuration, and whether attributes have types.
    /// \throws Exception, the model unchanged, when the file cannot be read or holds an error.
    void Read(const char* fileName, Model& model);
    /// The names that the last successful `Read` has replaced, in the order of their declarations.
    const std::vector<Renaming>& GetRenamings() const noexcept;

private:
    struct Implementation;

    std::unique_ptr<Implementation> implementation_;
};

} // namespace Orn_Hdl
