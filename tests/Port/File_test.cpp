#include "Port/File.h"

#include "Support/TemporaryFolder.h"

#include <gtest/gtest.h>
#include <rapidcheck/gtest.h>

#include <algorithm>
#include <cerrno>
#include <cstring>
#include <filesystem>
#include <string>
#include <string_view>
#include <vector>

namespace {

using Port::File;

std::vector<std::string> LinesOf(const std::string& fileName) {
    File file;
    std::vector<std::string> lines;
    std::string_view line;
    EXPECT_TRUE(file.open(fileName.c_str(), File::Read, true));
    while (file.NextLine(line)) {
        lines.emplace_back(line);
    }
    return lines;
}

TEST(File, OverwritesAndAppends) {
    const Support::TemporaryFolder folder;
    const std::string name = folder / "text";
    Support::WriteWholeFile(name, "something long");
    {
        File file;
        ASSERT_TRUE(file.open(name.c_str(), File::Overwrite, true));
        EXPECT_TRUE(file.IsOpen());
        EXPECT_TRUE(file.write("ab", 2));
        EXPECT_TRUE(file.close());
        EXPECT_FALSE(file.IsOpen());
    }
    EXPECT_EQ(Support::ReadWholeFile(name), "ab");
    {
        File file;
        ASSERT_TRUE(file.open(name.c_str(), File::Append, false));
        EXPECT_TRUE(file.write("cd", 2));
    }
    EXPECT_EQ(Support::ReadWholeFile(name), "abcd");
}

TEST(File, AppendingMakesAFileThatIsMissing) {
    const Support::TemporaryFolder folder;
    File file;
    ASSERT_TRUE(file.open((folder / "new").c_str(), File::Append, false));
    EXPECT_TRUE(file.write("x", 1));
    EXPECT_TRUE(file.close());
    EXPECT_EQ(Support::ReadWholeFile(folder / "new"), "x");
}

template <class Mode>
concept IsFileMode = requires(File file, Mode mode) {
    file.open("name", mode, false);
};

TEST(File, TakesItsModeAsANumber) {
    const Support::TemporaryFolder folder;
    const std::string name = folder / "text";
    const auto write = [&name](int mode, bool fromStart, const char* text) {
        File file;
        return file.open(name.c_str(), mode, fromStart) && file.write(text, 1) && file.close();
    };
    EXPECT_TRUE(write(2, true, "a"));
    EXPECT_TRUE(write(6, false, "b"));
    EXPECT_EQ(Support::ReadWholeFile(name), "ab");
    EXPECT_TRUE(write(10, true, "c"));
    EXPECT_EQ(Support::ReadWholeFile(name), "c");
    for (const int unknown : {-1, 0, 3, 7, 11}) {
        File file;
        EXPECT_FALSE(file.open(name.c_str(), unknown, true));
        EXPECT_FALSE(file.IsOpen());
        EXPECT_EQ(file.GetError(), EINVAL);
    }
    EXPECT_EQ(Support::ReadWholeFile(name), "c");
    enum OtherMode { Overwriting };
    static_assert(IsFileMode<File::Mode> && IsFileMode<int> && !IsFileMode<OtherMode>);
}

TEST(File, ReadsTheBytesOfAFile) {
    const Support::TemporaryFolder folder;
    const std::string bytes("a\0\r\n\xFF", 5);
    Support::WriteWholeFile(folder / "bytes", bytes);
    File file;
    ASSERT_TRUE(file.open((folder / "bytes").c_str(), File::Read, true));
    char buffer[16] = {};
    EXPECT_EQ(file.read(buffer, sizeof buffer), 5u);
    EXPECT_EQ(std::string(buffer, 5), bytes);
    EXPECT_EQ(file.read(buffer, sizeof buffer), 0u);
    EXPECT_EQ(file.GetError(), 0);
}

TEST(File, ADirectoryNeverOpens) {
    const Support::TemporaryFolder folder;
    const int before = Support::CountOpenFiles();
    for (const File::Mode mode : {File::Read, File::Overwrite, File::Append}) {
        File file;
        EXPECT_FALSE(file.open(folder.GetPath().c_str(), mode, mode != File::Append)) << mode;
        EXPECT_FALSE(file.IsOpen());
        EXPECT_NE(file.GetError(), 0);
    }
    EXPECT_EQ(Support::CountOpenFiles(), before);
}

TEST(File, TellsWhyItCannotBeOpened) {
    const Support::TemporaryFolder folder;
    File file;
    EXPECT_FALSE(file.open((folder / "missing").c_str(), File::Read, true));
    EXPECT_EQ(file.GetError(), ENOENT);
    EXPECT_FALSE(file.open((folder / "no/such/file").c_str(), File::Overwrite, true));
    EXPECT_EQ(file.GetError(), ENOENT);
    EXPECT_FALSE(file.open("", File::Read, true));
    EXPECT_NE(file.GetError(), 0);
    EXPECT_FALSE(file.open(nullptr, File::Read, true));
}

TEST(File, OpeningForgetsAFormerFailure) {
    const Support::TemporaryFolder folder;
    File file;
    EXPECT_FALSE(file.open((folder / "missing").c_str(), File::Read, true));
    EXPECT_TRUE(file.open((folder / "new").c_str(), File::Overwrite, true));
    EXPECT_EQ(file.GetError(), 0);
}

TEST(File, OpeningClosesTheFileThatWasOpen) {
    const Support::TemporaryFolder folder;
    const int before = Support::CountOpenFiles();
    {
        File file;
        ASSERT_TRUE(file.open((folder / "a").c_str(), File::Overwrite, true));
        ASSERT_TRUE(file.open((folder / "b").c_str(), File::Overwrite, true));
        EXPECT_EQ(Support::CountOpenFiles(), before + 1);
    }
    EXPECT_EQ(Support::CountOpenFiles(), before);
}

TEST(File, AFullDeviceIsAFailureThatIsKept) {
    File file;
    ASSERT_TRUE(file.open("/dev/full", File::Overwrite, true));
    const std::string text(1 << 20, 'x');
    EXPECT_FALSE(file.write(text.data(), text.size()));
    EXPECT_EQ(file.GetError(), ENOSPC);
}

TEST(File, AClosedFileReadsAndWritesNothing) {
    File file;
    char buffer[4];
    std::string_view line;
    EXPECT_FALSE(file.IsOpen());
    EXPECT_EQ(file.read(buffer, sizeof buffer), 0u);
    EXPECT_FALSE(file.write("x", 1));
    EXPECT_FALSE(file.NextLine(line));
}

TEST(File, AnEmptyFileHasNoLine) {
    const Support::TemporaryFolder folder;
    Support::WriteWholeFile(folder / "empty", "");
    EXPECT_EQ(LinesOf(folder / "empty"), std::vector<std::string>());
}

TEST(File, LinesStartAnewWithTheNextFile) {
    const Support::TemporaryFolder folder;
    Support::WriteWholeFile(folder / "a", "a1\na2\na3\n");
    Support::WriteWholeFile(folder / "b", "b1\n");
    File file;
    std::string_view line;
    ASSERT_TRUE(file.open((folder / "a").c_str(), File::Read, true));
    ASSERT_TRUE(file.NextLine(line));
    ASSERT_TRUE(file.open((folder / "b").c_str(), File::Read, true));
    ASSERT_TRUE(file.NextLine(line));
    EXPECT_EQ(line, "b1");
    EXPECT_FALSE(file.NextLine(line));
}

RC_GTEST_PROP(FileLines, AreThePiecesBetweenLineFeedsLessOneCarriageReturn, ()) {
    const auto text =
        *rc::gen::container<std::string>(rc::gen::elementOf(std::string("ab\r\r\n\n") + '\0'));
    std::vector<std::string> expected;
    std::string line;
    const auto endLine = [&] {
        if (!line.empty() && line.back() == '\r') {
            line.pop_back();
        }
        expected.push_back(line);
        line.clear();
    };
    for (const char c : text) {
        if (c == '\n') {
            endLine();
        } else {
            line += c;
        }
    }
    if (!text.empty() && text.back() != '\n') {
        endLine();
    }
    const Support::TemporaryFolder folder;
    Support::WriteWholeFile(folder / "text", text);
    RC_ASSERT(LinesOf(folder / "text") == expected);
}

TEST(Stream, HandsOverTextsOfAnySize) {
    const Support::TemporaryFolder folder;
    std::string expected;
    {
        File file;
        ASSERT_TRUE(file.open((folder / "text").c_str(), File::Overwrite, true));
        Port::Stream stream(file);
        for (std::size_t size : {1u, 262143u, 262144u, 262145u, 7u, 1000000u, 0u, 3u}) {
            const std::string piece(size, static_cast<char>('a' + size % 26));
            stream << piece;
            expected += piece;
        }
        EXPECT_TRUE(stream.flush());
        EXPECT_TRUE(stream.flush());
    }
    EXPECT_TRUE(Support::ReadWholeFile(folder / "text") == expected);
}

TEST(Stream, KeepsEveryCharacterWhereverItsBufferEnds) {
    constexpr std::size_t BufferSize = 262144;
    const Support::TemporaryFolder folder;
    std::string text;
    for (std::size_t i = 0; i < 2 * BufferSize + 100; ++i) {
        // 89 divides no buffer, so that no part looks like another.
        text += static_cast<char>(' ' + i % 89);
    }
    for (std::size_t first = BufferSize - 4; first <= BufferSize + 4; ++first) {
        for (const std::size_t size : {1u, 2u, 3u}) {
            File file;
            ASSERT_TRUE(file.open((folder / "text").c_str(), File::Overwrite, true));
            Port::Stream stream(file);
            std::string_view rest(text);
            stream << rest.substr(0, first);
            for (rest.remove_prefix(first); !rest.empty();
                 rest.remove_prefix(std::min(size, rest.size()))) {
                stream << rest.substr(0, size);
            }
            EXPECT_TRUE(stream.flush());
            EXPECT_TRUE(file.close());
            ASSERT_TRUE(Support::ReadWholeFile(folder / "text") == text) << first << ", " << size;
        }
    }
}

TEST(Stream, ANullTextWritesNothing) {
    const Support::TemporaryFolder folder;
    File file;
    ASSERT_TRUE(file.open((folder / "text").c_str(), File::Overwrite, true));
    Port::Stream stream(file);
    stream << static_cast<const char*>(nullptr) << "a" << nullptr << std::string("b")
           << Port::String("c");
    EXPECT_TRUE(stream.flush());
    EXPECT_EQ(Support::ReadWholeFile(folder / "text"), "abc");
}

TEST(Stream, AFailedWriteShowsAtEveryFlush) {
    File file;
    ASSERT_TRUE(file.open("/dev/full", File::Overwrite, true));
    Port::Stream stream(file);
    stream << "text";
    EXPECT_FALSE(stream.flush());
    EXPECT_FALSE(stream.flush());
    EXPECT_EQ(file.GetError(), ENOSPC);
}

TEST(FileName, TailIsWhatFollowsTheLastSlash) {
    EXPECT_EQ(Port::FileName("a/b/c.v").GetTail(), "c.v");
    EXPECT_EQ(Port::FileName("c.v").GetTail(), "c.v");
    EXPECT_EQ(Port::FileName("a/").GetTail(), "");
    EXPECT_EQ(Port::FileName("").GetTail(), "");
    EXPECT_EQ(Port::FileName(nullptr).GetTail(), "");
}

TEST(FileName, StemIsTheTailWithoutItsExtension) {
    EXPECT_EQ(Port::FileName("a.b/top.cmd").GetStem(), "top");
    EXPECT_EQ(Port::FileName("top.tar.gz").GetStem(), "top.tar");
    EXPECT_EQ(Port::FileName("a.b/top").GetStem(), "top");
    EXPECT_EQ(Port::FileName("a/.hidden").GetStem(), ".hidden");
    EXPECT_EQ(Port::FileName("top.").GetStem(), "top");
}

TEST(ErrorText, IsTheSystems) {
    EXPECT_EQ(Port::ErrorText(ENOENT), std::strerror(ENOENT));
    EXPECT_EQ(Port::ErrorText(ENOSPC), std::strerror(ENOSPC));
}

} // namespace
