#include "Check/ReservedWords.h"

#include "Port/Ascii.h"

#include <algorithm>
#include <string>
#include <unordered_map>

namespace Orn_Hdl::Checking {

namespace {

using Verdicts = Check::Verdicts;

/// Words that the same targets reserve, with one blank between neighbours.
struct Words {
    Verdicts verdicts;
    std::string_view words;
};

/// The words of IEEE 1364-1995, 1364-2005 and 1800-2017, and what of them each tool reserves when
/// it reads a file as Verilog. Verilator warns of the words of C++.
constexpr Words VerilogWords[] = {
    // Types of the package std, which cannot name an instance.
    {Verdicts("......w"), "mailbox process semaphore"},
    {Verdicts("rrr..rrr."),
     "always and assign begin buf bufif0 bufif1 case casex casez default defparam else "
     "end endcase endfunction endmodule endspecify endtask for function if initial "
     "inout input integer module nand negedge nor not notif0 notif1 or output "
     "parameter posedge real reg repeat specify specparam supply0 supply1 task tri "
     "triand trior wand while wire wor xnor xor"},
    {Verdicts("rrr..rr.."),
     "cmos deassign disable edge endprimitive endtable event force forever fork highz0 "
     "highz1 ifnone join large macromodule medium nmos pmos primitive pull0 pull1 "
     "pulldown pullup rcmos realtime release rnmos rpmos rtran rtranif0 rtranif1 "
     "scalared small strong0 strong1 table time tran tranif0 tranif1 tri0 tri1 trireg "
     "vectored wait weak0 weak1"},
    {Verdicts(".rr..rrr."), "automatic endgenerate generate genvar localparam signed"},
    {Verdicts(".rr..rr.."),
     "cell config design endconfig incdir include instance liblist library "
     "noshowcancelled pulsestyle_ondetect pulsestyle_onevent showcancelled unsigned "
     "use uwire"},
    {Verdicts("..r...r.."),
     "accept_on alias always_comb always_ff always_latch assert assume before bind "
     "bins binsof bit break byte chandle checker class clocking const constraint "
     "context continue cover covergroup coverpoint cross dist do endchecker endclass "
     "endclocking endgroup endinterface endpackage endprogram endproperty endsequence "
     "enum eventually expect export extends extern final first_match foreach forkjoin "
     "iff ignore_bins illegal_bins implements implies import inside int interconnect "
     "interface intersect join_any join_none let local longint matches modport nettype "
     "new nexttime null package packed priority program property protected pure rand "
     "randc randcase randsequence ref reject_on restrict return s_always s_eventually "
     "s_nexttime s_until s_until_with sequence shortint shortreal soft solve static "
     "string strong struct super sync_accept_on sync_reject_on tagged this throughout "
     "timeprecision timeunit type typedef union unique unique0 until until_with "
     "untyped var virtual void wait_order weak wildcard with within"},
    {Verdicts("..r......"), "global"},
    {Verdicts("..r..rr.."), "logic"},
    {Verdicts("......w.."),
     "alignas alignof and_eq asm atomic_cancel auto bitand bitor catch char char16_t "
     "char32_t compl concept const_cast constexpr decltype delete double dynamic_cast "
     "explicit false float friend goto inline mutable namespace noexcept not_eq "
     "nullptr operator or_eq override private public register requires short sizeof "
     "static_assert static_cast switch synchronized template thread_local throw true "
     "try typeid typename using volatile wchar_t xor_eq"},
    {Verdicts(".....rw.."), "bool"},
};

/// The words of IEEE 1076-1993 and 1076-2008.
constexpr Words VhdlWords[] = {
    {Verdicts("...rr...r"),
     "abs access after alias all and architecture array assert attribute begin block "
     "body buffer bus case component configuration constant disconnect downto else "
     "elsif end entity exit file for function generate generic group guarded if impure "
     "in inertial inout is label library linkage literal loop map mod nand new next "
     "nor not null of on open or others out package port postponed procedure process "
     "pure range record register reject rem report return rol ror select severity "
     "shared signal sla sll sra srl subtype then to transport type unaffected units "
     "until use variable wait when while with xnor xor"},
    {Verdicts("....r...r"),
     "assume context cover default force parameter property protected release restrict "
     "restrict_guarantee sequence vmode vprop vunit"},
    {Verdicts("....r...."), "assume_guarantee fairness strong"},
};

constexpr std::size_t LongestWord = 20;

using Table = std::unordered_map<std::string_view, Verdicts>;

template <std::size_t N> Table MakeTable(const Words (&groups)[N]) {
    Table table;
    for (const Words& group : groups) {
        for (std::string_view rest = group.words; !rest.empty();) {
            const std::size_t end = std::min(rest.find(' '), rest.size());
            table.emplace(rest.substr(0, end), group.verdicts);
            rest.remove_prefix(std::min(end + 1, rest.size()));
        }
    }
    return table;
}

/// Every word begins with two letters, and names such as U12, of which there are most, do not.
bool MayBeWord(std::string_view name) noexcept {
    return name.size() >= 2 && name.size() <= LongestWord && Port::IsLetter(name[0]) &&
           Port::IsLetter(name[1]);
}

Verdicts Find(const Table& table, std::string_view word) noexcept {
    const auto found = table.find(word);
    return found == table.end() ? Verdicts() : found->second;
}

} // namespace

Verdicts FindReserved(std::string_view verilogName, std::string_view vhdlName) {
    static const Table verilog = MakeTable(VerilogWords);
    static const Table vhdl = MakeTable(VhdlWords);
    Verdicts verdicts;
    if (MayBeWord(verilogName)) {
        verdicts = Find(verilog, verilogName);
    }
    if (MayBeWord(vhdlName)) {
        char small[LongestWord];
        std::transform(vhdlName.begin(), vhdlName.end(), small, Port::ToLower);
        verdicts.Worsen(Find(vhdl, std::string_view(small, vhdlName.size())));
    }
    return verdicts;
}

} // namespace Orn_Hdl::Checking
