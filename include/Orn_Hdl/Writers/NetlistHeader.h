/// \file
/// `NetlistHeader`, the comment banner that opens a netlist.
#pragma once

#include "Orn_Hdl/Language.h"
#include "Orn_Hdl/Streams.h"
#include "Port/Export.h"
#include "Port/String.h"

#include <string_view>

namespace Orn_Hdl {

/// Writes the banner: the application, the file, the time, the command, the design, the device, the
/// purpose and the reference.
class ORN_HDL_API NetlistHeader {
public:
    /// A banner in the comments of a language.
    /// \param out not owned; it must outlive the header.
    NetlistHeader(const Port::StringBase<char>& application, const Port::StringBase<char>& fileName,
                  const Port::StringBase<char>& command, const Port::StringBase<char>& designName,
                  const Port::StringBase<char>& device, const Port::StringBase<char>& purpose,
                  const Port::StringBase<char>& reference, Language language, OutStream& out);
    /// A banner in VHDL or Verilog comments.
    /// \param vhdlComments true for lines that begin with "--", false for "//".
    /// \param out not owned; it must outlive the header.
    NetlistHeader(const Port::StringBase<char>& application, const Port::StringBase<char>& fileName,
                  const Port::StringBase<char>& command, const Port::StringBase<char>& designName,
                  const Port::StringBase<char>& device, const Port::StringBase<char>& purpose,
                  const Port::StringBase<char>& reference, bool vhdlComments, OutStream& out);
    NetlistHeader(const NetlistHeader&) = default;

    /// Writes the banner.
    void Write();

private:
    void WriteDivider();
    void WriteCopyright();
    void WriteLogo();
    void WriteCommand();
    void WriteDesignName();
    void WriteDevice();
    void WritePurpose();
    void WriteReference();
    void WriteLine(const char* label, const Port::StringBase<char>& text);
    void WriteSentences(const Port::StringBase<char>& text);
    void WriteWord(std::string_view word, int& column);
    void BeginSentence(int& column);

    Port::StringBase<char> application_;
    Port::StringBase<char> fileName_;
    Port::StringBase<char> command_;
    Port::StringBase<char> designName_;
    Port::StringBase<char> device_;
    Port::StringBase<char> purpose_;
    Port::StringBase<char> reference_;
    const char* prefix_;
    OutStream& out_;
};

} // namespace Orn_Hdl
