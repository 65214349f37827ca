#include "Orn_Hdl/Writers/NetlistHeader.h"

#include "Options/LanguageTraits.h"
#include "Orn_Hdl/Containers/StringArray.h"
#include "Orn_Hdl/Options.h"
#include "Writers/OneLine.h"
#include "Writers/Text.h"

#include <array>
#include <cstddef>

namespace Orn_Hdl {

using Writers::OneLine;
using Writers::Put;
using Writers::PutLine;

namespace {

constexpr const char* TextIndentation = "    ";
constexpr int FirstTextColumn = 6;
constexpr std::size_t LastTextColumn = 79;
constexpr int DividerPrefixes = 40;

constexpr std::array<std::string_view, 9> Emblem = {
    R"(     _____)",        //
    R"(    |     '.)",      //
    R"(====|       \    )", //
    R"(    |        |   )", //
    R"(    |        o== )", //
    R"(    |        |   )", //
    R"(====|       /    )", //
    R"(    |_____.')",      //
    R"(   O r n _ H d l)",  //
};
/// The line of the emblem, counted from 0, beside which the first label is written.
constexpr std::size_t FirstLabelLine = 2;

} // namespace

NetlistHeader::NetlistHeader(
    const Port::StringBase<char>& application, const Port::StringBase<char>& fileName,
    const Port::StringBase<char>& command, const Port::StringBase<char>& designName,
    const Port::StringBase<char>& device, const Port::StringBase<char>& purpose,
    const Port::StringBase<char>& reference, Language language, OutStream& out)
    : application_(application), fileName_(fileName), command_(command), designName_(designName),
      device_(device), purpose_(purpose), reference_(reference),
      prefix_(TraitsOf(language).commentPrefix), out_(out) {}

NetlistHeader::NetlistHeader(
    const Port::StringBase<char>& application, const Port::StringBase<char>& fileName,
    const Port::StringBase<char>& command, const Port::StringBase<char>& designName,
    const Port::StringBase<char>& device, const Port::StringBase<char>& purpose,
    const Port::StringBase<char>& reference, bool vhdlComments, OutStream& out)
    : NetlistHeader(application, fileName, command, designName, device, purpose, reference,
                    WithComments(vhdlComments), out) {}

void NetlistHeader::Write() {
    WriteDivider();
    WriteCopyright();
    WriteDivider();
    WriteLogo();
    WriteCommand();
    WriteDesignName();
    WriteDevice();
    WritePurpose();
    WriteReference();
}

void NetlistHeader::WriteDivider() {
    for (int i = 0; i < DividerPrefixes; ++i) {
        Put(out_, prefix_);
    }
    PutLine(out_);
}

void NetlistHeader::WriteCopyright() {
    PutLine(out_, prefix_, " ", "Copyright (c) 2026 the Orn_Hdl authors.");
}

void NetlistHeader::WriteLogo() {
    const std::array<Port::String, 5> labels = {
        "Vendor: Halvex",
        Port::String("Version : ") + HdlUtilities::GetVersion(),
        Port::String("Application : ") + OneLine(application_).GetView(),
        Port::String("Filename : ") + OneLine(fileName_).GetView(),
        Port::String("Timestamp : ") + HdlUtilities::CurrentTimeString(),
    };
    for (std::size_t line = 0; line < Emblem.size(); ++line) {
        Put(out_, prefix_, Emblem[line]);
        if (line >= FirstLabelLine && line < FirstLabelLine + labels.size()) {
            Put(out_, labels[line - FirstLabelLine]);
        }
        PutLine(out_);
    }
}

void NetlistHeader::WriteCommand() {
    WriteLine("Command: ", command_);
}

void NetlistHeader::WriteDesignName() {
    WriteLine("Design Name: ", designName_);
}

void NetlistHeader::WriteDevice() {
    WriteLine("Device: ", device_);
}

void NetlistHeader::WritePurpose() {
    PutLine(out_, prefix_, "Purpose:");
    WriteSentences(purpose_);
}

void NetlistHeader::WriteReference() {
    PutLine(out_, prefix_, "Reference");
    WriteSentences(reference_);
}

void NetlistHeader::WriteLine(const char* label, const Port::StringBase<char>& text) {
    PutLine(out_, prefix_, label, OneLine(text).GetView());
}

void NetlistHeader::WriteSentences(const Port::StringBase<char>& text) {
    int column = 0;
    BeginSentence(column);
    const StringArray words(text.CStr(), " ", true, nullptr);
    for (int i = 0; i < words.GetSize(); ++i) {
        const std::string_view word = words.GetView(i);
        if (word.size() + static_cast<std::size_t>(column) + 1 > LastTextColumn) {
            PutLine(out_);
            BeginSentence(column);
        }
        WriteWord(word, column);
    }
    PutLine(out_);
}

void NetlistHeader::WriteWord(std::string_view word, int& column) {
    const auto writePiece = [this, &column](std::string_view piece) {
        Put(out_, OneLine(piece).GetView(), " ");
        column += static_cast<int>(piece.size()) + 1;
    };
    if (word.find('\n') == std::string_view::npos) {
        writePiece(word);
        return;
    }
    StringArray pieces;
    pieces.Parse(word, "\n", true, std::string_view());
    PutLine(out_, OneLine(pieces.GetView(0)).GetView());
    BeginSentence(column);
    for (int i = 1; i < pieces.GetSize(); ++i) {
        if (i > 1) {
            PutLine(out_);
            BeginSentence(column);
        }
        writePiece(pieces.GetView(i));
    }
}

void NetlistHeader::BeginSentence(int& column) {
    Put(out_, prefix_, TextIndentation);
    column = FirstTextColumn;
}

} // namespace Orn_Hdl
