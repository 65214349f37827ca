// Names that are legal in the languages of a netlist.
#pragma once

#include <cstddef>
#include <string>
#include <string_view>

namespace Tool::Import {

/// The languages in which the names of an import must be legal.
enum class NameLanguages { Verilog, Vhdl, Both };

class NameRules {
public:
    /// \param forCommands whether the names must also be legal in a command file.
    NameRules(NameLanguages languages, bool forCommands) noexcept
        : languages_(languages), forCommands_(forCommands) {}

    /// Whether a name can be used unchanged for every object. It must be neither a reserved word
    /// nor a type that written VHDL mentions, and it must not end in a suffix of the names that
    /// the library generates. In VHDL it must be a basic identifier.
    bool IsLegal(std::string_view name) const;
    /// The end of a message about a name for which `IsLegal` is false.
    const char* GetComplaint() const noexcept;

    /// Whether names must be legal in VHDL.
    bool HasVhdl() const noexcept { return languages_ != NameLanguages::Verilog; }
    /// Whether names that are not legal may be escaped. Only Verilog has such names: an escaped
    /// name is the same identifier as the name itself, but the library takes it for another name.
    bool MayEscape() const noexcept { return languages_ == NameLanguages::Verilog; }
    /// Whether the library writes an escaped form of the name as it stands.
    bool IsEscapable(std::string_view name) const;
    static bool IsEscaped(std::string_view name) noexcept {
        return !name.empty() && name.front() == '\\';
    }
    /// \param blanks the number of blanks at the end; the library distinguishes names by it, while
    /// Verilog does not.
    static std::string Escape(std::string_view name, std::size_t blanks);
    /// The identifier that Verilog reads.
    static std::string_view WithoutEscape(std::string_view name) noexcept;

private:
    bool IsReserved(std::string_view name) const;

    NameLanguages languages_;
    bool forCommands_;
};

/// A basic identifier that resembles `name`: other characters become "_", never two in a row nor
/// one at either end. A name that a program generated is reduced to its meaningful parts.
/// \param initial the letter put before a name that would begin with a digit or be empty.
std::string MakeSimilarName(std::string_view name, char initial);

} // namespace Tool::Import
