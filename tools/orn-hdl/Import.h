// `orn-hdl import`: converts a netlist to a command file or to a netlist in another language.
#pragma once

#include "Output.h"
#include "Tool.h"
#include "diagnostics/Reporter.h"
#include "import/ImportRules.h"
#include "import/NameRules.h"

#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace Orn_Hdl {
class LegalNetlist;
class Model;
} // namespace Orn_Hdl

namespace Tool {

/// What a netlist is written in.
enum class ImportFormat { Json, Verilog, Vhdl };

struct ImportOptions {
    /// The netlist; "-" is standard input, which only a JSON netlist can come from.
    std::string file;
    /// What the netlist is written in; without a value, its extension tells.
    std::optional<ImportFormat> format;
    /// The module to import; empty for the one marked as top in JSON, and for the only one that no
    /// other instantiates in the languages.
    std::string top;
    /// The modules to import, in place of the top module and those that it uses.
    std::vector<std::string> modules;
    /// The command file to write; empty for none. A folder gets one file a module.
    std::string commandFile;
    Outputs outputs;
    /// The replacement of x and z: "0", "1", or "-" for don't cares; empty to reject them.
    std::string unknownAs;
    /// The cell libraries.
    std::vector<std::string> libraries;
    /// The folders in which included files are looked for.
    std::vector<std::string> includeFolders;
    /// Macros, each NAME or NAME=TEXT.
    std::vector<std::string> macros;
    /// The languages in which names must be legal; without one, those of the netlists.
    std::optional<Import::NameLanguages> names;
    /// Reject a design whose ports cannot keep their names.
    bool keepPorts = false;
    /// The clauses that VHDL gets, for JSON.
    Import::VhdlClauses vhdl;
    /// Import the attributes of cells and nets.
    bool attributes = false;
    /// Import the comments of objects.
    bool comments = false;
    /// The file for the table of old and new names; empty for none.
    std::string nameMap;
    /// The file for the simulation models of cells; empty for none.
    std::string cellModels;
    /// Give registers the first values of their nets, for the models of cells in VHDL.
    bool initialValues = false;
    /// Write legal netlists, or nothing.
    bool legal = false;
    /// Read each netlist back and compare it with the design before it replaces its file.
    bool verify = false;
    /// How many threads may work together; 0 is what the system gives.
    unsigned threads = 0;
    /// The file for the certificate of the netlists; empty for none.
    std::string certificate;
    ReportOptions report;
};

/// Imports a file. If no output is given, the file is only checked.
Status ImportDesign(const ImportOptions& options);

/// The languages in which the names of an import must be legal: those asked for, or else those of
/// the netlists. A command file can be written in both.
Import::NameLanguages GetNameLanguages(const ImportOptions& options);
/// Whether each module gets a command file of its own.
bool HasCommandFolder(const ImportOptions& options);
/// The command files of modules, in a folder that is made if need be; a single empty name for no
/// command file.
std::vector<std::string> MakeCommandFiles(const ImportOptions& options,
                                          const std::vector<std::string>& modules);
/// Writes the list of command files, if there is to be one.
Status WriteCommandList(const ImportOptions& options, const std::vector<std::string>& files);
/// Reports what keeps a netlist from being legal. \return whether anything does.
bool TellWhyNotLegal(const Orn_Hdl::LegalNetlist& legal, const std::string& file,
                     Reporter& reporter);
/// Writes the netlists of a model, each compared with the design first if the options ask for it.
/// \param legal writes the netlists legally; null for none.
Status WriteNetlists(Orn_Hdl::Model& model, const ImportOptions& options,
                     Orn_Hdl::LegalNetlist* legal, Reporter& reporter);
/// Writes the netlists of several models, legally if the options ask for it.
/// \param models in the order of compilation.
Status WriteNetlists(const std::vector<Orn_Hdl::Model*>& models, const ImportOptions& options,
                     Reporter& reporter);
/// What a file that is no JSON is, by its beginning; empty if that is not known, or if it may be
/// JSON.
std::string DescribeOtherFile(const std::string& beginning);
/// Whether a file's name ends so, letter case ignored.
bool HasExtension(std::string_view file, std::string_view extension) noexcept;
/// A message about a file as a whole.
Diagnostic MakeFileDiagnostic(const std::string& file, Severity severity, std::string message);

} // namespace Tool
