// What both writers do with names and plain text.
#pragma once

#include "HdlModel/Names/Names.h"
#include "Orn_Hdl/Attributes.h"
#include "Orn_Hdl/Language.h"
#include "Orn_Hdl/Model/Pins.h"
#include "Orn_Hdl/Streams.h"

#include <cstddef>
#include <string>
#include <string_view>

namespace Orn_Hdl::Writers {

/// Whether a signal of that name stands for no signal at all: the empty name and "open".
inline bool IsOpen(std::string_view name) noexcept {
    return name.empty() || Names::IsNamed(name, "open");
}

/// As `Pin::GetBaseName`, without a copy.
std::string_view GetBaseName(const Pin& pin);

/// The text of an attribute's value without the quotes around it, on one line.
Port::String GetUnquotedValue(const Attribute& attribute);

/// Writes the text of an attribute's value, on one line, between double quotes in place of those
/// that it may have.
void WriteQuotedValue(OutStream& out, const Attribute& attribute);

/// The bit that a constant gives to a signal of one bit: only a last digit 0 gives "0".
std::string_view GetSingleBit(const BitVectorValue& value);

inline std::string_view ToPiece(std::string_view text) {
    return text;
}
inline std::string_view ToPiece(const char* text) {
    return Port::ViewOf(text);
}
inline std::string ToPiece(int number) {
    return std::to_string(number);
}
/// Writes texts and numbers, each as a piece of its own: lines are broken between pieces only.
template <class... Pieces> void Put(OutStream& out, const Pieces&... pieces) {
    out.WritePieces({ToPiece(pieces)...});
}
/// The same, and the end of the line.
template <class... Pieces> void PutLine(OutStream& out, const Pieces&... pieces) {
    out.WritePieces({ToPiece(pieces)...});
    out << OutStream::NewLine;
}

/// Writes blanks as one piece of text, which no line break divides.
void WriteBlanks(OutStream& out, std::size_t count);

/// A text as one line of comment.
std::string InComment(Language language, std::string_view text);

/// Writes what `write` writes between two comments that hide it from synthesis.
template <class Write> void WriteHidden(OutStream& out, Language language, const Write& write) {
    PutLine(out, InComment(language, "synopsys translate_off"));
    write();
    PutLine(out, InComment(language, "synopsys translate_on"));
}

/// Writes each line of the object's comment as a line of comment; lines without any text are left
/// out.
void WriteComment(OutStream& out, Language language, const Object& object);

} // namespace Orn_Hdl::Writers
