// The input chooses what is written into a file and into memory: pieces of any length, numbers,
// line ends, indentation and flushes.

#include "Orn_Hdl/Streams.h"
#include "Bytes.h"
#include "Check.h"
#include "MemoryFiles.h"
#include "Writes.h"

namespace {

using Fuzz::Check;
using Orn_Hdl::OutStream;
using Orn_Hdl::TextFileOutStream;
using Orn_Hdl::TextMemOutStream;

constexpr const char* Pieces[] = {
    " ", ", ", ",", ";",    "\"", "//",   "--", "/*",
    "-", "/",  "a", "word", "\n", "a\nb", "  ", "name_of_some_length_in_a_list"};

std::string MakePiece(Fuzz::Bytes& bytes) {
    switch (bytes.Choose(4)) {
    case 0:
        return bytes.Text(100);
    case 1:
        return std::string(static_cast<std::size_t>(bytes.Choose(256)), 'x');
    default:
        return bytes.Pick(Pieces);
    }
}

void Step(Fuzz::Bytes& bytes, OutStream& file, OutStream& memory) {
    switch (bytes.Choose(8)) {
    case 0:
        file << OutStream::NewLine;
        memory << OutStream::NewLine;
        break;
    case 1:
        file.Indent();
        break;
    case 2:
        file.Unindent();
        break;
    case 3:
        file << OutStream::Flush;
        memory << OutStream::Flush;
        break;
    case 4: {
        const int number = bytes.Choose(256) * 8000001 - 1000000000;
        file << number;
        memory << number;
        break;
    }
    default: {
        const std::string piece = MakePiece(bytes);
        file << std::string_view(piece);
        memory << std::string_view(piece);
        break;
    }
    }
}

constexpr std::string_view Former = "former\n";

const std::string& TextOf(const Fuzz::MemoryFiles& files) {
    const std::string* const text = files.Find("file");
    Check(text != nullptr, "the file exists");
    return *text;
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    Fuzz::Bytes bytes(data, size);
    Fuzz::MemoryFiles files;
    files.Put("file", Former);
    const auto mode = static_cast<TextFileOutStream::Mode>(bytes.Choose(3));
    const bool isClosed = bytes.Choose(4) != 0;
    TextMemOutStream memory(mode == TextFileOutStream::Append ? "former\n" : "");
    {
        TextFileOutStream file("file", mode);
        Check(file.IsOpen(), "the file is open");
        while (!bytes.IsAtEnd()) {
            Step(bytes, file, memory);
            if (mode == TextFileOutStream::Replace) {
                Check(TextOf(files) == Former, "the former file is unchanged");
            }
        }
        if (isClosed) {
            file.Close();
        }
        Check(file.GetError() == 0, "nothing failed");
    }
    Check(!files.HasOpenFiles() && files.CountNames() == 1, "no other file is left");
    if (mode == TextFileOutStream::Replace && !isClosed) {
        Check(TextOf(files) == Former, "a stream that is not closed replaces nothing");
    } else {
        Fuzz::CheckSameButForBreaks(TextOf(files), memory.GetValue().GetView());
    }
    return 0;
}
