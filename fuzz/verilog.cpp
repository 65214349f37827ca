// The input is a Verilog netlist behind a byte of options. It is refused with a message that names
// a place, or becomes a consistent netlist; what is written of that can be read again.

#include "Bytes.h"
#include "Check.h"
#include "Consistency.h"
#include "MemoryFiles.h"
#include "Orn_Hdl/Orn_Hdl.h"
#include "Reading.h"

#include <string>
#include <string_view>

namespace {

using namespace Orn_Hdl;

constexpr std::string_view Cells =
    "module INV(input I, output O); endmodule\n"
    "module AND2(I0, I1, O); input I0, I1; output O; endmodule\n"
    "module REG #(parameter W = 4, parameter [7:0] INIT = 8'h00, NAME = \"none\") (\n"
    "  input C, input [3:0] D, output [3:0] Q); endmodule\n"
    "module UP(input [0:3] A, inout P); endmodule\n";

std::string WriteVerilog(Model& model) {
    model.GetOptions()->writeHeader = false;
    TextMemOutStream stream;
    VerilogNetlister(stream).WriteNetlist(model.GetNetlist(), *model.GetOptions());
    return std::string(stream.GetValue().GetView());
}

/// Strings, escaped names and the comments of dialects can hold what the writers cannot write.
bool IsPlain(std::string_view text) {
    return text.find_first_of("\"\\") == std::string_view::npos &&
           text.find("synopsys") == std::string_view::npos &&
           text.find("synthesis") == std::string_view::npos &&
           text.find("exemplar") == std::string_view::npos &&
           text.find("pragma") == std::string_view::npos;
}

void CheckReadBack(Model& model) {
    Fuzz::MemoryFiles files;
    files.Put("back.v", WriteVerilog(model));
    CommandFactory factory;
    Model back(&factory);
    VerilogReader reader;
    reader.AddLibrary(*model.GetNetlist());
    reader.SetNames(VerilogReader::Names::Literal);
    reader.KeepDontCares(true);
    reader.Read("back.v", back);
    Fuzz::CheckNetlist(*back.GetNetlist());
}

void Run(Fuzz::Bytes bytes) {
    VerilogReader reader;
    const bool keepsAll = bytes.Choose(2) == 0;
    reader.KeepComments(keepsAll);
    reader.KeepDontCares(keepsAll);
    const bool isLiteral = bytes.Choose(2) == 1;
    reader.SetNames(isLiteral ? VerilogReader::Names::Literal : VerilogReader::Names::Simple);
    reader.SetIncludes(bytes.Choose(2) == 0 ? VerilogReader::Includes::Follow
                                            : VerilogReader::Includes::Keep);
    reader.AddLibrary("cells.v");
    reader.Define("DEFINED", "1");
    Fuzz::MemoryFiles files;
    files.Put("cells.v", Cells);
    files.Put("top.v", bytes.Rest());
    CommandFactory factory;
    Model model(&factory);
    const bool isRead = Fuzz::ReadWithChecks(reader, "top.v", files, model);
    if (isRead && !isLiteral && IsPlain(bytes.Rest())) {
        CheckReadBack(model);
    }
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    Run(Fuzz::Bytes(data, size));
    return 0;
}
