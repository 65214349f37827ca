// Texts that go straight into a stream's line, in streams of all kinds.
#include "Streams/DirectText.h"

#include "Support/TemporaryFolder.h"

#include <gtest/gtest.h>

#include <memory>
#include <string>

namespace {

using Orn_Hdl::DirectText;
using Orn_Hdl::OutStream;
using Orn_Hdl::StreamBranch;
using Orn_Hdl::StreamDst;
using Orn_Hdl::TextFileOutStream;
using Orn_Hdl::TextMemOutStream;

/// Writes a line in all ways, at indent level 1, and half a line.
void WriteSome(OutStream& out) {
    out.Indent();
    DirectText text(out);
    text.Put("a", "", std::string("b"));
    text.EndLine(",");
    text.PutLine("c", " ", "d");
    text.EndLine();
    text.Put("e");
}

std::string TextOf(const TextMemOutStream& out) {
    return std::string(out.GetValue().GetView());
}

/// A destination of a program's own, with line ends of its own.
class OwnDst : public StreamDst {
public:
    explicit OwnDst(std::string& text) : text_(text) {}
    void WriteNewLine() override { text_ += "<end>"; }
    void Write(const char* text) override { text_.append(text); }
    void Write(int number) override { text_.append(std::to_string(number)); }

private:
    std::string& text_;
};

TEST(DirectText, IsIndentedInAFile) {
    const Support::TemporaryFolder folder;
    {
        TextFileOutStream out((folder / "text").c_str(), false);
        WriteSome(out);
    }
    EXPECT_EQ(Support::ReadWholeFile(folder / "text"), "   ab,\n   c d\n   \n   e\n");
}

TEST(DirectText, StaysAsItIsInMemory) {
    TextMemOutStream out;
    WriteSome(out);
    EXPECT_EQ(TextOf(out), "ab,\nc d\n\ne");
}

TEST(DirectText, StaysAsItIsInABranchOfMemory) {
    TextMemOutStream out;
    const std::unique_ptr<StreamBranch> branch = StreamBranch::Make(out);
    ASSERT_NE(branch, nullptr);
    branch->Begin(1000);
    WriteSome(branch->GetStream());
    EXPECT_TRUE(branch->EndItem());
    EXPECT_TRUE(branch->Join(out));
    EXPECT_EQ(TextOf(out), "ab,\nc d\n\ne");
}

TEST(DirectText, OfABranchEndsAtItsLimit) {
    const Support::TemporaryFolder folder;
    TextFileOutStream out((folder / "text").c_str(), false);
    const std::unique_ptr<StreamBranch> branch = StreamBranch::Make(out);
    ASSERT_NE(branch, nullptr);
    for (std::size_t limit = 0; limit < 300; ++limit) {
        branch->Begin(limit);
        DirectText text(branch->GetStream());
        std::size_t length = 0;
        do {
            text.PutLine("0123456", "89");
            length += 10;
        } while (branch->EndItem());
        EXPECT_EQ(length - 10, limit / 10 * 10);
    }
}

TEST(DirectText, GoesToADestinationOfAProgramsOwn) {
    std::string text;
    OutStream out(new OwnDst(text));
    WriteSome(out);
    EXPECT_EQ(text, "ab,\nc d<end><end>e");
}

TEST(DirectText, IsDroppedWithoutADestination) {
    OutStream out(nullptr);
    WriteSome(out);
    TextFileOutStream closed;
    WriteSome(closed);
    EXPECT_FALSE(closed.IsOpen());
}

} // namespace
