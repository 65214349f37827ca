// Makes a model of a file of any format: commands, Verilog or VHDL, or JSON as Yosys writes it.
#pragma once

#include "Orn_Hdl/Engine.h"
#include "Orn_Hdl/Model.h"
#include "Orn_Hdl/Readers.h"
#include "Tool.h"
#include "diagnostics/Reporter.h"
#include "load/RereadableFile.h"

#include <memory>
#include <optional>
#include <string>
#include <vector>

namespace Tool {

enum class DesignFormat { Commands, Verilog, Vhdl, Json };

/// The format that the extension of a file tells; that of commands for any other one.
DesignFormat GetFormatOf(const std::string& name);

/// A file with a design.
struct DesignFile {
    /// "-" is standard input.
    std::string name;
    /// The format; that of the extension if it is not given.
    std::optional<DesignFormat> format;

    DesignFormat GetFormat() const { return format ? *format : GetFormatOf(name); }
};

/// What a netlist needs besides its own file.
struct Libraries {
    /// Files that declare components: Verilog, VHDL, JSON or Liberty. JSON netlists take nothing of
    /// VHDL files.
    std::vector<std::string> files;
    /// A design with components that no file declares; null for none.
    const Orn_Hdl::Netlist* components = nullptr;
};

/// A design that was read from a file.
class LoadedDesign {
public:
    explicit LoadedDesign(const DesignFile& file);
    LoadedDesign(const LoadedDesign&) = delete;
    LoadedDesign& operator=(const LoadedDesign&) = delete;

    /// Reads the file. Commands are replayed, but for WRITE commands. The design of a command file
    /// is sorted, as writing it would do.
    /// \param quiet shows no progress.
    Status Load(const Libraries& libraries, Reporter& reporter, bool quiet);

    const DesignFile& GetFile() const noexcept { return file_; }
    DesignFormat GetFormat() const { return file_.GetFormat(); }
    Orn_Hdl::Model& GetModel() noexcept { return *model_; }
    const Orn_Hdl::Netlist& GetNetlist() const noexcept { return *model_->GetNetlist(); }
    /// Whether the file names the design. One in a command file may be named by the file's name.
    bool HasName() const noexcept { return hasName_; }
    /// The name under which the system opens the file once more.
    const char* GetSystemName() const noexcept { return source_.GetName(); }
    /// The names that the file has otherwise than the design.
    const std::vector<Orn_Hdl::ReaderRenaming>& GetRenamings() const noexcept { return renamings_; }

private:
    Status Replay(Reporter& reporter, bool quiet);
    Status ReadOtherLibraries(const Libraries& libraries, Orn_Hdl::Netlist& components,
                              Reporter& reporter) const;
    template <class Reader> Status ReadNetlist(const Libraries& libraries, Reporter& reporter);
    Status ReadJson(const Libraries& libraries, Reporter& reporter);
    void ReportReadError(std::string text, Reporter& reporter) const;

    const DesignFile file_;
    const RereadableFile source_;
    Orn_Hdl::Engine engine_;
    Orn_Hdl::Model* model_ = nullptr;
    bool hasName_ = true;
    std::vector<Orn_Hdl::ReaderRenaming> renamings_;
};

} // namespace Tool
