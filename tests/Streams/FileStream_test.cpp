#include "Orn_Hdl/Streams.h"

#include "Port/File.h"
#include "Support/TemporaryFolder.h"

#include <gtest/gtest.h>

#include <cerrno>
#include <climits>
#include <cstddef>
#include <filesystem>
#include <functional>
#include <string>
#include <string_view>

namespace {

using Orn_Hdl::OutStream;
using Orn_Hdl::TextFileOutStream;
using Support::TemporaryFolder;

/// What a file holds after `write` and the end of the stream.
std::string Written(const std::function<void(TextFileOutStream&)>& write) {
    const TemporaryFolder folder;
    const std::string name = folder / "text";
    {
        TextFileOutStream out(name.c_str(), false);
        EXPECT_TRUE(out.IsOpen());
        write(out);
    }
    return Support::ReadWholeFile(name);
}

TEST(FileStream, IndentsByThreeBlanksALevel) {
    EXPECT_EQ(Written([](TextFileOutStream& out) {
                  out.Indent();
                  out.Indent();
                  out << "a" << OutStream::NewLine;
              }),
              "      a\n");
}

TEST(FileStream, UnindentAtLevelZeroStaysAtZero) {
    EXPECT_EQ(Written([](TextFileOutStream& out) {
                  out.Unindent();
                  out.Unindent();
                  out.Indent();
                  out << "a" << OutStream::NewLine;
                  out.Unindent();
                  out << "b" << OutStream::NewLine;
              }),
              "   a\nb\n");
}

TEST(FileStream, ALineTakesTheIndentationOfItsStart) {
    EXPECT_EQ(Written([](TextFileOutStream& out) {
                  out << "a";
                  out.Indent();
                  out << "b" << OutStream::NewLine << "c";
                  out.Unindent();
                  out << "d" << OutStream::NewLine;
              }),
              "ab\n   cd\n");
}

TEST(FileStream, ATextOfSeveralLinesIsIndentedLineByLine) {
    EXPECT_EQ(Written([](TextFileOutStream& out) {
                  out.Indent();
                  out << "a\nb\n\nc" << OutStream::NewLine;
              }),
              "   a\n   b\n   \n   c\n");
}

TEST(FileStream, ALineEndAloneConsistsOfTheIndentation) {
    EXPECT_EQ(Written([](TextFileOutStream& out) {
                  out.Indent();
                  out << OutStream::NewLine;
              }),
              "   \n");
}

TEST(FileStream, AnEmptyLineHoldsNoBlanks) {
    EXPECT_EQ(Written([](TextFileOutStream& out) {
                  out.Indent();
                  out.Indent();
                  out << "a" << OutStream::NewLine;
                  out.WriteEmptyLine();
                  out << "b" << OutStream::NewLine;
              }),
              "      a\n\n      b\n");
}

TEST(FileStream, NullAndEmptyTextsWriteNothing) {
    EXPECT_EQ(Written([](TextFileOutStream& out) {
                  out.Indent();
                  out << static_cast<const char*>(nullptr) << "" << Port::String();
              }),
              "");
}

TEST(FileStream, BreaksAtTheLastBlankBeforeThePieceThatIsTooMuch) {
    // Sixteen words and blanks of five characters fill a line of eighty.
    EXPECT_EQ(Written([](TextFileOutStream& out) {
                  for (int i = 0; i < 17; ++i) {
                      out << "word"
                          << " ";
                  }
                  out << OutStream::NewLine;
              }),
              "word word word word word word word word word word word word word word word word \n"
              "      word \n");
}

TEST(FileStream, ALineMayBeEightyCharactersLong) {
    const std::string first(40, 'a');
    const std::string second(39, 'b');
    EXPECT_EQ(Written([&](TextFileOutStream& out) {
                  out << first.c_str() << " " << second.c_str();
                  out << OutStream::NewLine;
              }),
              first + " " + second + "\n");
    EXPECT_EQ(Written([&](TextFileOutStream& out) {
                  out << first.c_str() << " " << (second + "b").c_str();
                  out << OutStream::NewLine;
              }),
              first + " \n      " + second + "b\n");
}

TEST(FileStream, AContinuationLineStartsWithTheIndentationAndSixBlanks) {
    const std::string word(50, 'x');
    EXPECT_EQ(Written([&](TextFileOutStream& out) {
                  out.Indent();
                  out << word.c_str() << " " << word.c_str() << OutStream::NewLine;
              }),
              "   " + word + " \n         " + word + "\n");
}

TEST(FileStream, APortListBreaksBehindTheBlankAfterAComma) {
    std::string text;
    for (int i = 0; i < 12; ++i) {
        text += i == 0 ? "" : ", ";
        text += "PORT_" + std::to_string(100 + i);
    }
    EXPECT_EQ(Written([](TextFileOutStream& out) {
                  for (int i = 0; i < 12; ++i) {
                      out << (i == 0 ? "" : ", ") << "PORT_" << 100 + i;
                  }
                  out << ")" << OutStream::NewLine;
              }),
              text.substr(0, 80) + "\n      " + text.substr(80) + ")\n");
}

TEST(FileStream, BreaksAtTheLastCommaWhenThereIsNoBlank) {
    const std::string name(30, 'n');
    EXPECT_EQ(Written([&](TextFileOutStream& out) {
                  out << name.c_str() << "," << name.c_str() << "," << name.c_str() << ";\n";
              }),
              name + "," + name + ",\n      " + name + ";\n");
}

TEST(FileStream, BreaksAtTheEndWhenThereIsNeitherBlankNorComma) {
    const std::string name(60, 'n');
    EXPECT_EQ(Written([&](TextFileOutStream& out) { out << name.c_str() << name.c_str(); }),
              name + "\n      " + name + "\n");
}

TEST(FileStream, ABreakOfAnEmptyLineWritesALineEnd) {
    const std::string name(81, 'n');
    EXPECT_EQ(Written([&](TextFileOutStream& out) { out << name.c_str(); }),
              "\n      " + name + "\n");
}

TEST(FileStream, APieceLongerThanALineIsWrittenWhole) {
    const std::string name(200, 'n');
    EXPECT_EQ(Written([&](TextFileOutStream& out) { out << "a " << name.c_str() << "\n"; }),
              "a \n      " + name + "\n");
    EXPECT_EQ(Written([&](TextFileOutStream& out) {
                  out << name.c_str() << " b"
                      << " c\n";
              }),
              "\n      \n      " + name + " b c\n")
        << "the blanks of a continuation line are blanks, too";
}

TEST(FileStream, ATextThatEndsInALineFeedIsNeverBroken) {
    const std::string line = "a b " + std::string(200, 'n') + " c d\n";
    EXPECT_EQ(Written([&](TextFileOutStream& out) { out << "x " << line.c_str(); }), "x " + line);
}

TEST(FileStream, ACommentIsNeverBroken) {
    for (const char* opening : {"//", "--", "/*"}) {
        std::string expected = opening;
        const std::string text = Written([&](TextFileOutStream& out) {
            out << opening;
            for (int i = 0; i < 60; ++i) {
                out << " word," << i;
                expected += " word," + std::to_string(i);
            }
        });
        EXPECT_EQ(text, expected + "\n");
    }
}

TEST(FileStream, ACommentMayBeginInTwoPieces) {
    const std::string name(76, 'n');
    EXPECT_EQ(Written([&](TextFileOutStream& out) {
                  out << "a " << name.c_str() << "-"
                      << "-"
                      << " more words"
                      << " and more";
              }),
              "a " + name + "-- more words and more\n");
}

TEST(FileStream, ABreakNeverFallsInsideALiteral) {
    const std::string name(60, 'n');
    EXPECT_EQ(Written([&](TextFileOutStream& out) {
                  out << "x \"a b, c d\"" << name.c_str() << name.c_str() << OutStream::NewLine;
              }),
              "x \n      \"a b, c d\"" + name + name + "\n");
    EXPECT_EQ(Written([&](TextFileOutStream& out) {
                  out << "x,\"a b, c d\"" << name.c_str() << name.c_str() << OutStream::NewLine;
              }),
              "x,\n      \"a b, c d\"" + name + name + "\n");
    EXPECT_EQ(Written([&](TextFileOutStream& out) {
                  out << "\"a b, c d\"" << name.c_str() << name.c_str() << OutStream::NewLine;
              }),
              "\"a b, c d\"" + name + "\n      " + name + "\n");
}

TEST(FileStream, ABreakNeverFallsInsideALiteralThatIsStillOpen) {
    const std::string half(45, 'n');
    EXPECT_EQ(Written([&](TextFileOutStream& out) {
                  out << "x "
                      << "\"" << half.c_str() << " " << half.c_str() << "\";\n";
              }),
              "x \n      \"" + half + " " + half + "\";\n");
    EXPECT_EQ(Written([&](TextFileOutStream& out) {
                  out << "\"" << half.c_str() << " " << half.c_str() << "\""
                      << ";\n";
              }),
              "\"" + half + " " + half + "\";\n");
}

TEST(FileStream, ABreakNeverFallsInsideALiteralThatHoldsAnEscapedQuote) {
    const std::string half(45, 'n');
    EXPECT_EQ(Written([&](TextFileOutStream& out) {
                  out << "x \"a \\\" b, " << half.c_str() << "\"" << half.c_str() << ";\n";
              }),
              "x \n      \"a \\\" b, " + half + "\"" + half + ";\n");
    // An escaped backslash escapes nothing.
    EXPECT_EQ(Written([&](TextFileOutStream& out) {
                  out << "x \"a \\\\\" b, " << half.c_str() << half.c_str() << ";\n";
              }),
              "x \"a \\\\\" b, \n      " + half + half + ";\n");
}

TEST(FileStream, FlushEndsTheLine) {
    const TemporaryFolder folder;
    const std::string name = folder / "text";
    TextFileOutStream out(name.c_str(), false);
    out.Indent();
    out << "a";
    EXPECT_EQ(Support::ReadWholeFile(name), "");
    out << OutStream::Flush;
    EXPECT_EQ(Support::ReadWholeFile(name), "   a\n");
    out << OutStream::Flush << OutStream::Flush;
    EXPECT_EQ(Support::ReadWholeFile(name), "   a\n") << "blanks left by a flush are nothing";
    out.Close();
    EXPECT_EQ(Support::ReadWholeFile(name), "   a\n");
}

TEST(FileStream, AfterAFlushALineStartsAsAnyOther) {
    EXPECT_EQ(Written([](TextFileOutStream& out) {
                  out.Indent();
                  out << "a" << OutStream::Flush << "b" << OutStream::NewLine;
                  out << OutStream::Flush << "c" << OutStream::NewLine;
              }),
              "   a\n   b\n   c\n");
}

TEST(FileStream, FlushOfNothingWritesNothing) {
    EXPECT_EQ(Written([](TextFileOutStream& out) { out << OutStream::Flush; }), "");
}

TEST(FileStream, TheEndOfTheStreamEndsTheLastLine) {
    EXPECT_EQ(Written([](TextFileOutStream& out) { out << "a"; }), "a\n");
    EXPECT_EQ(Written([](TextFileOutStream& out) { out << "a\n"; }), "a\n");
}

TEST(FileStream, WritesNumbers) {
    EXPECT_EQ(Written([](TextFileOutStream& out) {
                  out << 0 << " " << -2147483647 - 1 << OutStream::NewLine;
              }),
              "0 -2147483648\n");
}

TEST(FileStream, ANumberThatIsTooMuchBreaksTheLine) {
    const std::string name(78, 'n');
    EXPECT_EQ(Written([&](TextFileOutStream& out) { out << name.c_str() << " " << 12; }),
              name + " \n      12\n");
}

TEST(FileStream, OverwritesOrAppends) {
    const TemporaryFolder folder;
    const std::string name = folder / "text";
    Support::WriteWholeFile(name, "old");
    TextFileOutStream(name.c_str(), true) << " and new\n";
    EXPECT_EQ(Support::ReadWholeFile(name), "old and new\n");
    TextFileOutStream(name.c_str(), false) << "fresh\n";
    EXPECT_EQ(Support::ReadWholeFile(name), "fresh\n");
    TextFileOutStream((folder / "second").c_str(), true) << "made\n";
    EXPECT_EQ(Support::ReadWholeFile(folder / "second"), "made\n");
}

TEST(FileStream, RemembersTheNameOfItsConstructor) {
    const TemporaryFolder folder;
    const std::string first = folder / "first";
    TextFileOutStream out(first.c_str(), false);
    out << "one";
    EXPECT_TRUE(out.Open((folder / "second").c_str(), false));
    out << "two";
    out.Close();
    EXPECT_EQ(out.GetFileName(), first.c_str());
    EXPECT_EQ(Support::ReadWholeFile(first), "one\n");
    EXPECT_EQ(Support::ReadWholeFile(folder / "second"), "two\n");
}

TEST(FileStream, ReplacesAFileAsAWholeWhenItIsClosed) {
    const TemporaryFolder folder;
    const std::string name = folder / "text";
    Support::WriteWholeFile(name, "former\n");
    {
        TextFileOutStream out(name.c_str(), TextFileOutStream::Replace);
        out << "new";
        EXPECT_EQ(Support::ReadWholeFile(name), "former\n");
        out.Close();
        EXPECT_EQ(out.GetError(), 0);
    }
    EXPECT_EQ(Support::ReadWholeFile(name), "new\n");
}

TEST(FileStream, ThatIsToReplaceAFileButIsNotClosedDropsItsText) {
    const TemporaryFolder folder;
    const std::string name = folder / "text";
    Support::WriteWholeFile(name, "former\n");
    TextFileOutStream(name.c_str(), TextFileOutStream::Replace) << "new\n";
    EXPECT_EQ(Support::ReadWholeFile(name), "former\n");
    for (const auto& entry : std::filesystem::directory_iterator(folder.GetPath())) {
        EXPECT_EQ(entry.path().filename(), "text");
    }
}

TEST(FileStream, OverwritesOrAppendsByMode) {
    const TemporaryFolder folder;
    const std::string name = folder / "text";
    Support::WriteWholeFile(name, "former\n");
    TextFileOutStream(name.c_str(), TextFileOutStream::Append) << "more\n";
    EXPECT_EQ(Support::ReadWholeFile(name), "former\nmore\n");
    TextFileOutStream(name.c_str(), TextFileOutStream::Overwrite) << "new\n";
    EXPECT_EQ(Support::ReadWholeFile(name), "new\n");
}

TEST(FileStream, OpensByMode) {
    const TemporaryFolder folder;
    const std::string name = folder / "text";
    Support::WriteWholeFile(name, "former\n");
    TextFileOutStream out;
    EXPECT_TRUE(out.Open(name.c_str(), TextFileOutStream::Replace));
    out << "new\n";
    EXPECT_EQ(Support::ReadWholeFile(name), "former\n");
    out.Close();
    EXPECT_EQ(Support::ReadWholeFile(name), "new\n");
    EXPECT_TRUE(out.Open(name.c_str(), TextFileOutStream::Append));
    out << "more\n";
    EXPECT_TRUE(out.Open(name.c_str(), TextFileOutStream::Overwrite));
    EXPECT_EQ(Support::ReadWholeFile(name), "");
}

template <class Name, class Mode>
concept Opens = requires(TextFileOutStream out, Name name, Mode mode) {
    out.Open(name, mode);
    TextFileOutStream(name, mode);
};
template <class Name>
constexpr bool OpensByNothingElse =
    Opens<Name, bool>&& Opens<Name, TextFileOutStream::Mode> && !Opens<Name, int> &&
    !Opens<Name, OutStream::Operand> && !Opens<Name, Port::File::Mode> && !Opens<Name, void*> &&
    !Opens<Name, double> && !Opens<Name, std::nullptr_t>;

TEST(FileStream, OnlyABoolAndItsOwnModeSayHowAFileIsOpened) {
    static_assert(OpensByNothingElse<const char*>);
    static_assert(OpensByNothingElse<std::nullptr_t>);
    static_assert(OpensByNothingElse<std::string>);
    static_assert(OpensByNothingElse<std::string_view>);
    static_assert(OpensByNothingElse<Port::String>);
}

TEST(FileStream, TakesNamesInEveryForm) {
    const TemporaryFolder folder;
    const std::string name = folder / "text";
    TextFileOutStream(name, false) << "a\n";
    TextFileOutStream(Port::String(name), TextFileOutStream::Append) << "b\n";
    TextFileOutStream out(std::string_view(name), true);
    EXPECT_EQ(out.GetFileName(), name);
    out << "c\n";
    EXPECT_TRUE(out.Open(Port::String(name), true));
    out << "d\n";
    EXPECT_TRUE(out.Open(name, TextFileOutStream::Append));
    out << "e\n";
    out.Close();
    EXPECT_EQ(Support::ReadWholeFile(name), "a\nb\nc\nd\ne\n");
}

template <class T>
concept Writable = requires(OutStream& out, T value) {
    out << value;
};

TEST(OutStream, RefusesWhatItWouldWriteAsAnotherNumber) {
    static_assert(!Writable<char> && !Writable<signed char> && !Writable<unsigned char>);
    static_assert(!Writable<wchar_t> && !Writable<char16_t> && !Writable<char32_t>);
    static_assert(!Writable<bool> && !Writable<float> && !Writable<double>);
    static_assert(Writable<int> && Writable<const char*> && Writable<std::nullptr_t>);
    static_assert(Writable<std::string> && Writable<std::string_view> && Writable<Port::String>);
}

TEST(OutStream, WritesIntegersOfEverySize) {
    const auto write = [](OutStream& out) {
        out << short(-1) << " " << static_cast<unsigned short>(65535) << " " << UINT_MAX << " "
            << LONG_MIN << " " << ULLONG_MAX << " " << LLONG_MIN << "\n";
    };
    Orn_Hdl::TextMemOutStream memory;
    write(memory);
    EXPECT_EQ(memory.GetValue(), "-1 65535 4294967295 " + std::to_string(LONG_MIN) +
                                     " 18446744073709551615 -9223372036854775808\n");
    EXPECT_EQ(Written(write), "-1 65535 4294967295 -9223372036854775808 18446744073709551615 \n"
                              "      -9223372036854775808\n");
}

TEST(FileStream, WithoutAFileDropsEverything) {
    TextFileOutStream none;
    EXPECT_FALSE(none.IsOpen());
    none << "a" << 1 << OutStream::NewLine << OutStream::Flush;
    none.Close();
    EXPECT_EQ(none.GetFileName(), "");
    TextFileOutStream null(nullptr, false);
    EXPECT_FALSE(null.IsOpen());
    EXPECT_EQ(null.GetFileName(), "");
}

TEST(FileStream, WhatWasDroppedDoesNotComeBack) {
    const TemporaryFolder folder;
    TextFileOutStream out;
    out << "lost";
    EXPECT_TRUE(out.Open((folder / "text").c_str(), false));
    out << "kept\n";
    out.Close();
    out << "lost too";
    out.Close();
    EXPECT_EQ(Support::ReadWholeFile(folder / "text"), "kept\n");
}

TEST(FileStream, ReopensTheSameFile) {
    const TemporaryFolder folder;
    const std::string name = folder / "text";
    TextFileOutStream out(name.c_str(), false);
    out << "one";
    EXPECT_TRUE(out.Open(name.c_str(), true));
    out << "two";
    out.Close();
    EXPECT_EQ(Support::ReadWholeFile(name), "one\ntwo\n");
}

TEST(FileStream, AFileThatCannotBeOpenedLeavesTheStreamClosed) {
    const TemporaryFolder folder;
    const std::string name = folder / "no/such/folder";
    TextFileOutStream out(name.c_str(), false);
    EXPECT_FALSE(out.IsOpen());
    EXPECT_EQ(out.GetError(), ENOENT);
    EXPECT_EQ(out.GetFileName(), name.c_str());
    EXPECT_FALSE(out.Open(folder.GetPath().c_str(), false)) << "it is a folder";
    EXPECT_FALSE(out.IsOpen());
    EXPECT_NE(out.GetError(), 0);
    EXPECT_FALSE(out.Open(nullptr, false));
    EXPECT_TRUE(out.Open((folder / "text").c_str(), false));
    EXPECT_EQ(out.GetError(), 0);
}

TEST(FileStream, AFailedOpenClosesTheFormerFile) {
    const TemporaryFolder folder;
    TextFileOutStream out((folder / "text").c_str(), false);
    out << "one";
    EXPECT_FALSE(out.Open((folder / "no/such/folder").c_str(), false));
    EXPECT_FALSE(out.IsOpen());
    out << "two\n";
    EXPECT_EQ(Support::ReadWholeFile(folder / "text"), "one\n");
}

TEST(FileStream, TellsThatADeviceIsFull) {
    TextFileOutStream out("/dev/full", false);
    ASSERT_TRUE(out.IsOpen());
    out << "text";
    out.Close();
    EXPECT_EQ(out.GetError(), ENOSPC);
}

TEST(FileStream, HasOneFileOpenUntilItEnds) {
    const TemporaryFolder folder;
    const int before = Support::CountOpenFiles();
    {
        TextFileOutStream out((folder / "a").c_str(), false);
        out.Open((folder / "b").c_str(), false);
        out.Open((folder / "c").c_str(), true);
        EXPECT_EQ(Support::CountOpenFiles(), before + 1);
    }
    EXPECT_EQ(Support::CountOpenFiles(), before);
}

TEST(FileStream, WritesMegabytes) {
    const std::string line(99, 'x');
    const std::string text = Written([&](TextFileOutStream& out) {
        for (int i = 0; i < 100000; ++i) {
            out << (line + "\n").c_str();
        }
    });
    ASSERT_EQ(text.size(), 10000000u);
    EXPECT_EQ(text.find_first_not_of("x\n"), std::string::npos);
}

TEST(FileStream, KeepsEveryCharacterWhereverTheBufferEnds) {
    // Numbered lines, moved on by one character at a time, and lines that outgrow the buffer.
    for (std::size_t shift = 0; shift < 12; ++shift) {
        std::string expected(shift, ' ');
        const std::string text = Written([&](TextFileOutStream& out) {
            out << expected.c_str();
            for (int i = 0; i < 40000; ++i) {
                expected += "line " + std::to_string(i) + "\n";
                out << "line " << i << "\n";
            }
            for (int i = 0; i < 40000; ++i) {
                expected += "//" + std::to_string(i);
                out << "//" << i;
            }
            expected += "\n";
        });
        ASSERT_TRUE(text == expected) << "shifted by " << shift;
    }
}

TEST(FileStream, WritesTextsOfMegabytesInTheirPlace) {
    const std::string large(3000000, 'x');
    const std::string text = Written([&](TextFileOutStream& out) {
        out.Indent();
        out << large + "\n";
        out << "a ";
        out << large + "\n" + large + "\nb";
        out << large;
        out << "\n";
        out << "c" << OutStream::NewLine;
    });
    // The last of them does not end its line, which is broken before it, at its only blanks.
    EXPECT_TRUE(text == "   " + large + "\n   a " + large + "\n   " + large + "\n   \n         b" +
                            large + "\n   c\n");
}

TEST(FileStream, TakesALineOfAMillionPiecesInReasonableTime) {
    const std::string text = Written([](TextFileOutStream& out) {
        out << "// ";
        for (int i = 0; i < 1000000; ++i) {
            out << "x ";
        }
    });
    EXPECT_EQ(text.size(), 2000004u);
}

TEST(FileStream, UserTextIsNoFormat) {
    EXPECT_EQ(Written([](TextFileOutStream& out) { out << "%s%n%d\n"; }), "%s%n%d\n");
}

} // namespace
