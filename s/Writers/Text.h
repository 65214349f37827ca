// Names and plain text, for both writers.
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

/// Whether a name means no signal: the empty name and "open".
inline bool IsOpen(std::string_view name) noexcept {
    return name.empty() || Names::IsNamed(name, "open");
}

/// The base name of a pin (`Pin::GetBaseName`) without a copy.
std::string_view GetBaseName(const Pin& pin);

/// The text of an attribute's value without the quotes around it, on one line.
Port::String GetUnquotedValue(const Attribute& attribute);

/// Writes the text of an attribute's value on one line and in double quotes, which replace the
/// quotes around the value, if any.
void WriteQuotedValue(OutStream& out, const Attribute& attribute);

/// The value of a constant for a signal of one bit: "0" if the last digit is 0, otherwise "1".
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
/// Writes texts and numbers as separate pieces: lines are only broken between pieces.
template <class... Pieces> void Put(OutStream& out, const Pieces&... pieces) {
    out.WritePieces({ToPiece(pieces)...});
}
/// Writes texts and numbers as separate pieces, and a line end.
template <class... Pieces> void PutLine(OutStream& out, const Pieces&... pieces) {
    out.WritePieces({ToPiece(pieces)...});
    out << OutStream::NewLine;
}

/// A text of blanks.
class Blanks {
public:
    explicit Blanks(std::size_t count);
    Blanks(const Blanks&) = delete;
    Blanks& operator=(const Blanks&) = delete;

    std::string_view GetView() const noexcept { return view_; }

private:
    std::string_view view_;
    /// Holds the text if it is unusually long.
    std::string long_;
};

/// Writes blanks as one piece of text, which is never broken.
void WriteBlanks(OutStream& out, std::size_t count);

/// A text as one line of comment.
std::string InComment(Language language, std::string_view text);

/// Calls `write` between two comments that hide its output from synthesis.
template <class Write> void WriteHidden(OutStream& out, Language language, const Write& write) {
    PutLine(out, InComment(language, "synopsys translate_off"));
    write();
    PutLine(out, InComment(language, "synopsys translate_on"));
}

/// Writes each line of the object's comment as a comment line; empty lines are omitted.
void WriteComment(OutStream& out, Language language, const Object& object);

} // namespace Orn_Hdl::Writers
