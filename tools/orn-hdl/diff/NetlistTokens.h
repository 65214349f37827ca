// The words of a netlist in Verilog, VHDL or JSON, for what needs no more than to find names in it.
#pragma once

#include "Port/File.h"

#include <cstddef>
#include <cstdint>
#include <string>

namespace Tool::Diff {

/// One word of a netlist.
struct NetlistToken {
    enum class Kind : std::uint8_t { End, Name, String, Sign };

    Kind kind = Kind::End;
    /// The name without an escape, the contents of the string, or the sign, one character.
    std::string text;
    /// Whether the name is escaped, and so is no keyword.
    bool isEscaped = false;
    std::uint64_t line = 0;

    bool IsName() const noexcept { return kind == Kind::Name; }
    bool IsSign(char sign) const noexcept {
        return kind == Kind::Sign && text.size() == 1 && text.front() == sign;
    }
};

/// Splits a file into words, piece by piece. Comments are passed over; numbers are names here.
class NetlistTokens {
public:
    enum class Language : std::uint8_t { Verilog, Vhdl, Json };

    NetlistTokens(const char* systemName, Language language);

    /// Reads the next word. \return false at the end of the file.
    bool Next(NetlistToken& token);

private:
    int Get();
    int Peek();
    bool Fill();
    void SkipLine();
    void SkipBlock();
    bool SkipComment(int c);
    void ReadString(NetlistToken& token);
    void ReadEscaped(NetlistToken& token);

    Port::File file_;
    const Language language_;
    std::string piece_;
    std::size_t at_ = 0;
    std::uint64_t line_ = 1;
    bool isOpen_ = false;
};

} // namespace Tool::Diff
