/// \file
/// Netlists read into models from texts, and what becomes of them.
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

/// The cells in VHDL.
inline constexpr const char* VhdlCells = R"vhdl(
library ieee;
use ieee.std_logic_1164.all;
package cells is
  component INV port (I : in std_logic; O : out std_logic); end component;
  component REG is
    generic (W : integer := 4; INIT : bit_vector(7 downto 0) := X"00"; NAME : string := "none");
    port (C : in std_logic; D : in std_logic_vector(3 downto 0);
          Q : out std_logic_vector(3 downto 0));
  end component REG;
  component ONE port (I : in std_logic_vector(0 downto 0); O : out bit_vector(2 to 2)); end component;
  component TIED port (I, E : in std_logic := '1'; O : buffer std_ulogic); end component;
end package cells;
library ieee;
use ieee.std_logic_1164.all;
entity UP is
  port (A : in std_logic_vector(0 to 3); P : inout std_logic);
end entity UP;
)vhdl";

/// A text without the name of a folder.
inline std::string WithoutFolder(std::string text, const std::string& path) {
    const std::string folder = path + "/";
    for (std::size_t at = text.find(folder); at != std::string::npos; at = text.find(folder)) {
        text.erase(at, folder.size());
    }
    return text;
}

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
        return WithoutFolder(FailureOf([this, &text] { Read(text); }), folder_.GetPath());
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

/// A model that is filled from VHDL texts, with the cells as a library.
class VhdlTextReader {
public:
    VhdlTextReader() : model(&factory_) {
        WriteWholeFile(folder_ / "cells.vhd", VhdlCells);
        reader.AddLibrary((folder_ / "cells.vhd").c_str());
    }

    /// Reads a text as the file "top.vhd".
    void Read(const std::string& text) {
        WriteWholeFile(GetFileName(), text);
        reader.Read(GetFileName().c_str(), model);
    }
    /// What reading fails with, the folder left out; empty when it does not fail.
    std::string GetFailure(const std::string& text) {
        return WithoutFolder(FailureOf([this, &text] { Read(text); }), folder_.GetPath());
    }
    /// The model as VHDL, with the clauses and the configuration that its options ask for.
    std::string WriteAll() {
        model.GetOptions()->writeHeader = false;
        Orn_Hdl::TextMemOutStream stream;
        Orn_Hdl::VhdlNetlister(stream).WriteNetlist(model.GetNetlist(), model.GetOptions());
        return std::string(stream.GetValue().GetView());
    }
    /// The model as VHDL from its entity on.
    std::string Write() {
        const std::string text = WriteAll();
        return text.substr(text.find("entity "));
    }
    /// Another file beside the one that is read.
    void Put(const char* name, const std::string& text) { WriteWholeFile(folder_ / name, text); }
    std::string GetFileName() const { return folder_ / "top.vhd"; }
    std::string GetPath(const char* name) const { return folder_ / name; }

private:
    TemporaryFolder folder_;
    Orn_Hdl::CommandFactory factory_;

public:
    Orn_Hdl::VhdlReader reader;
    Orn_Hdl::Model model;
};

} // namespace Support
