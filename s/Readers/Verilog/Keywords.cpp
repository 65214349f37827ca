#include "Readers/Verilog/Keywords.h"

#include "Readers/WordTable.h"

#include <cstddef>
#include <iterator>

namespace Orn_Hdl::Readers {

namespace {

struct Entry {
    std::string_view word;
    Keyword keyword;
};

/// IEEE 1364-2005, annex B ("int", "logic", "var" and the procedures of IEEE
/// 1800 among them).
constexpr Entry Entries[] = {
    {"always", Keyword::Behaviour},
    {"always_comb", Keyword::Behaviour},
    {"always_ff", Keyword::Behaviour},
    {"always_latch", Keyword::Behaviour},
    {"and", Keyword::Gate},
    {"assign", Keyword::Assign},
    {"automatic", Keyword::Other},
    {"begin", Keyword::Behaviour},
    {"buf", Keyword::Gate},
    {"bufif0", Keyword::Gate},
    {"bufif1", Keyword::Gate},
    {"case", Keyword::Behaviour},
    {"casex", Keyword::Behaviour},
    {"casez", Keyword::Behaviour},
    {"cell", Keyword::Other},
    {"cmos", Keyword::Gate},
    {"config", Keyword::Other},
    {"deassign", Keyword::Behaviour},
    {"default", Keyword::Other},
    {"defparam", Keyword::Defparam},
    {"design", Keyword::Other},
    {"disable", Keyword::Behaviour},
    {"edge", Keyword::Other},
    {"else", Keyword::Behaviour},
    {"end", Keyword::Behaviour},
    {"endcase", Keyword::Behaviour},
    {"endconfig", Keyword::Other},
    {"endfunction", Keyword::Other},
    {"endgenerate", Keyword::Endgenerate},
    {"endmodule", Keyword::Endmodule},
    {"endprimitive", Keyword::Other},
    {"endspecify", Keyword::Other},
    {"endtable", Keyword::Other},
    {"endtask", Keyword::Other},
    {"event", Keyword::Behaviour},
    {"for", Keyword::Behaviour},
    {"force", Keyword::Behaviour},
    {"forever", Keyword::Behaviour},
    {"fork", Keyword::Behaviour},
    {"function", Keyword::Function},
    {"generate", Keyword::Generate},
    {"genvar", Keyword::Behaviour},
    {"highz0", Keyword::Other},
    {"highz1", Keyword::Other},
    {"if", Keyword::Behaviour},
    {"ifnone", Keyword::Other},
    {"incdir", Keyword::Other},
    {"include", Keyword::Other},
    {"initial", Keyword::Behaviour},
    {"inout", Keyword::Inout},
    {"input", Keyword::Input},
    {"instance", Keyword::Other},
    {"int", Keyword::Type},
    {"integer", Keyword::Type},
    {"join", Keyword::Behaviour},
    {"large", Keyword::Other},
    {"liblist", Keyword::Other},
    {"library", Keyword::Other},
    {"localparam", Keyword::Localparam},
    {"logic", Keyword::Logic},
    {"macromodule", Keyword::Module},
    {"medium", Keyword::Other},
    {"module", Keyword::Module},
    {"nand", Keyword::Gate},
    {"negedge", Keyword::Other},
    {"nmos", Keyword::Gate},
    {"nor", Keyword::Gate},
    {"noshowcancelled", Keyword::Other},
    {"not", Keyword::Gate},
    {"notif0", Keyword::Gate},
    {"notif1", Keyword::Gate},
    {"or", Keyword::Gate},
    {"output", Keyword::Output},
    {"parameter", Keyword::Parameter},
    {"pmos", Keyword::Gate},
    {"posedge", Keyword::Other},
    {"primitive", Keyword::Primitive},
    {"pull0", Keyword::Other},
    {"pull1", Keyword::Other},
    {"pulldown", Keyword::Gate},
    {"pullup", Keyword::Gate},
    {"pulsestyle_ondetect", Keyword::Other},
    {"pulsestyle_onevent", Keyword::Other},
    {"rcmos", Keyword::Gate},
    {"real", Keyword::Type},
    {"realtime", Keyword::Type},
    {"reg", Keyword::Reg},
    {"release", Keyword::Behaviour},
    {"repeat", Keyword::Behaviour},
    {"rnmos", Keyword::Gate},
    {"rpmos", Keyword::Gate},
    {"rtran", Keyword::Gate},
    {"rtranif0", Keyword::Gate},
    {"rtranif1", Keyword::Gate},
    {"scalared", Keyword::Vectored},
    {"showcancelled", Keyword::Other},
    {"signed", Keyword::Signed},
    {"small", Keyword::Other},
    {"specify", Keyword::Specify},
    {"specparam", Keyword::Specparam},
    {"string", Keyword::Type},
    {"strong0", Keyword::Other},
    {"strong1", Keyword::Other},
    {"supply0", Keyword::Supply0},
    {"supply1", Keyword::Supply1},
    {"table", Keyword::Other},
    {"task", Keyword::Task},
    {"time", Keyword::Type},
    {"tran", Keyword::Gate},
    {"tranif0", Keyword::Gate},
    {"tranif1", Keyword::Gate},
    {"tri", Keyword::Wire},
    {"tri0", Keyword::OtherNet},
    {"tri1", Keyword::OtherNet},
    {"triand", Keyword::OtherNet},
    {"trior", Keyword::OtherNet},
    {"trireg", Keyword::OtherNet},
    {"unsigned", Keyword::Signed},
    {"use", Keyword::Other},
    {"uwire", Keyword::Wire},
    {"var", Keyword::Logic},
    {"vectored", Keyword::Vectored},
    {"wait", Keyword::Behaviour},
    {"wand", Keyword::OtherNet},
    {"weak0", Keyword::Other},
    {"weak1", Keyword::Other},
    {"while", Keyword::Behaviour},
    {"wire", Keyword::Wire},
    {"wor", Keyword::OtherNet},
    {"xnor", Keyword::Gate},
    {"xor", Keyword::Gate},
};

constexpr std::size_t Count = std::size(Entries);
constexpr WordTable<Count> Table(Entries);

} // namespace

Keyword FindKeyword(std::string_view word) noexcept {
    const std::size_t found =
        Table.Find(word, [word](std::size_t index) { return Entries[index].word == word; });
    return found == Count ? Keyword::None : Entries[found].keyword;
}

bool IsDirection(Keyword keyword) noexcept {
    return keyword == Keyword::Input || keyword == Keyword::Output || keyword == Keyword::Inout;
}

} // namespace Orn_Hdl::Readers
