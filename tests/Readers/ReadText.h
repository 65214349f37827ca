/// \file
/// Verilog texts read into models, and what becomes of them.
#pragma once

#include "Orn_Hdl/Orn_Hdl.h"
#include "Support/EngineScript.h"
#include "Support/TemporaryFolder.h"

#include <string>

namespace Support {

/// Modules that the texts of the tests instantiate.
inline constexpr const char* Cells = R"(
module INV(input I, output O); endmodule
module AND2(I0, I1, O);
  input I0, I1;
  output O;
endmodule
module REG #(parameter W = 4, parameter [7:0] INIT = 8'h00, NAME = "none") (
  input C, input [3:0] D, output reg [3:0] Q);
endmodule
module UP(input [0:3] A, inout P);
endmodule
)";

/// A model that is filled from texts, with the cells as a library.
class TextReader {
public:
    TextReader() : model(&factory_) {
        WriteWholeFile(folder_ / "cells.v", Cells);
        reader.AddLibrary((folder_ / "cells.v").c_str());
    }

    /// Reads a text as the file "top.v".
    void Read(const std::string& text) {
        WriteWholeFile(GetFileName(), text);
        reader.Read(GetFileName().c_str(), model);
    }
    /// What reading fails with, the folder left out; empty when it does not fail.
    std::string GetFailure(const std::string& text) {
        std::string message = FailureOf([this, &text] { Read(text); });
        const std::string folder = folder_.GetPath() + "/";
        for (std::size_t at = message.find(folder); at != std::string::npos;
             at = message.find(folder)) {
            message.erase(at, folder.size());
        }
        return message;
    }
    /// The model as Verilog, without the lines in front of the module.
    std::string Write() {
        model.GetOptions()->writeHeader = false;
        model.GetOptions()->onePortPerLine = false;
        Orn_Hdl::TextMemOutStream stream;
        Orn_Hdl::VerilogNetlister(stream).WriteNetlist(model.GetNetlist(), *model.GetOptions());
        const std::string text(stream.GetValue().GetView());
        return text.substr(text.find("module "));
    }
    /// Another file beside the one that is read.
    void Put(const char* name, const std::string& text) { WriteWholeFile(folder_ / name, text); }
    std::string GetFileName() const { return folder_ / "top.v"; }
    std::string GetFolder() const { return folder_.GetPath(); }

private:
    TemporaryFolder folder_;
    Orn_Hdl::CommandFactory factory_;

public:
    Orn_Hdl::VerilogReader reader;
    Orn_Hdl::Model model;
};

} // namespace Support
