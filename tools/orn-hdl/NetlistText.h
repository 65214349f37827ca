// The text of a netlist, and where it goes.
#pragma once

#include "Orn_Hdl/Language.h"
#include "Orn_Hdl/Proof.h"
#include "Tool.h"

#include <cstdio>
#include <memory>
#include <string>

namespace Orn_Hdl {
class LegalNetlist;
class Model;
class OutStream;
} // namespace Orn_Hdl

namespace Tool {

/// Writes the netlist of a model. \param legal writes it legally; null for the design as it stands.
void WriteNetlist(Orn_Hdl::Model& model, Orn_Hdl::LegalNetlist* legal, Orn_Hdl::Language language,
                  Orn_Hdl::OutStream& out);

/// What was written of a model.
Orn_Hdl::Proof::Written GetWritten(Orn_Hdl::Model& model, const Orn_Hdl::LegalNetlist* legal);

/// A file without a name, which is removed at the end.
class TemporaryFile {
public:
    /// Prints a message if there can be none.
    TemporaryFile();

    /// Whether there is a file.
    bool IsOpen() const noexcept { return file_ != nullptr; }
    /// The name under which the system opens the file.
    const std::string& GetName() const noexcept { return name_; }
    std::FILE* Get() const noexcept { return file_.get(); }
    /// Copies the file from its start to standard output.
    Status Print() const;

private:
    const std::unique_ptr<std::FILE, int (*)(std::FILE*)> file_;
    std::string name_;
};

} // namespace Tool
