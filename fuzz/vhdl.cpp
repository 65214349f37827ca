// The input is a VHDL netlist behind two bytes of options. It is refused with a message that names
// a place, or becomes a consistent netlist; what is written of that can be read again, and is the
// same when it is written once more.

#include "Bytes.h"
#include "Check.h"
#include "Consistency.h"
#include "MemoryFiles.h"
#include "Orn_Hdl/Orn_Hdl.h"
#include "Reading.h"

#include <string>
#include <string_view>

namespace {

using Fuzz::Check;
using namespace Orn_Hdl;

constexpr std::string_view Cells =
    "package cells is\n"
    "component INV port (I : in bit; O : out bit); end component;\n"
    "component REG generic (W : integer := 4; INIT : bit_vector(7 downto 0) := X\"00\";\n"
    "  NAME : string := \"none\"); port (C : in bit; D : in bit_vector(3 downto 0);\n"
    "  Q : out bit_vector(3 downto 0)); end component;\n"
    "end cells;\n"
    "entity UP is port (A : in bit_vector(0 to 3); P : inout bit); end UP;\n";

std::string WriteVhdl(Model& model) {
    model.GetOptions()->writeHeader = false;
    TextMemOutStream stream;
    VhdlNetlister(stream).WriteNetlist(model.GetNetlist(), model.GetOptions());
    return std::string(stream.GetValue().GetView());
}

/// What strings, extended identifiers and the texts of other types hold is written as it is; VHDL
/// may read it otherwise, or not at all. Words of later standards and of the library are names that
/// the text may declare again.
bool IsPlain(std::string_view text) {
    return text.find_first_of("\"\\") == std::string_view::npos &&
           text.find("generic") == std::string_view::npos &&
           text.find("attribute") == std::string_view::npos &&
           text.find("use") == std::string_view::npos &&
           text.find("library") == std::string_view::npos;
}

bool HasPort(const Netlist& netlist) {
    for (const Signal* signal : netlist.GetSignalIterator()) {
        if (signal->IsPort()) {
            return true;
        }
    }
    return false;
}

/// The whole netlist is written; a second write puts dummy signals in their places.
void CheckReadBack(Model& model) {
    // VHDL has no empty list of ports, which is written nevertheless.
    if (!HasPort(*model.GetNetlist())) {
        return;
    }
    Fuzz::MemoryFiles files;
    WriteVhdl(model);
    const std::string first = WriteVhdl(model);
    files.Put("back.vhd", first);
    CommandFactory factory;
    Model back(&factory);
    *back.GetOptions() = *model.GetOptions();
    VhdlReader reader;
    reader.AddLibrary(*model.GetNetlist());
    reader.SetNames(VhdlReader::Names::Literal);
    reader.KeepDontCares(true);
    reader.Read("back.vhd", back);
    Fuzz::CheckNetlist(*back.GetNetlist());
    const std::string second = WriteVhdl(back);
    CommandFactory otherFactory;
    Model again(&otherFactory);
    *again.GetOptions() = *back.GetOptions();
    files.Put("again.vhd", second);
    reader.Read("again.vhd", again);
    Check(WriteVhdl(again) == second, "what is read back is written in the same way");
}

void Run(Fuzz::Bytes bytes) {
    VhdlReader reader;
    const bool keepsAll = bytes.Choose(2) == 0;
    reader.KeepComments(keepsAll);
    reader.KeepDontCares(keepsAll);
    const bool isLiteral = bytes.Choose(2) == 1;
    reader.SetNames(isLiteral ? VhdlReader::Names::Literal : VhdlReader::Names::Simple);
    reader.AddLibrary("cells.vhd");
    Fuzz::MemoryFiles files;
    files.Put("cells.vhd", Cells);
    files.Put("top.vhd", bytes.Rest());
    CommandFactory factory;
    Model model(&factory);
    const bool isRead = Fuzz::ReadWithChecks(reader, "top.vhd", files, model);
    if (isRead && !isLiteral && IsPlain(bytes.Rest())) {
        CheckReadBack(model);
    }
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    Run(Fuzz::Bytes(data, size));
    return 0;
}
