// Lines that are split in another thread come in order, whatever the sizes of the batches.
#include "HdlCmd/LineBatches.h"
#include "Support/TemporaryFolder.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

namespace {

using Orn_Hdl::Foresight;
using Orn_Hdl::LineBatches;
using Orn_Hdl::SplitLine;

constexpr int Count = 500;

std::string LineOf(int number) {
    return "NOOP n" + std::to_string(number) + ' ' +
           std::string(static_cast<std::size_t>(number * 37 % 1000), 'x') + ".p";
}

class LineBatchesTest : public testing::Test {
protected:
    void SetUp() override {
        std::string text;
        for (int i = 0; i < Count; ++i) {
            text += LineOf(i) + '\n';
        }
        Support::WriteWholeFile(name_, text);
        ASSERT_TRUE(file_.open(name_.c_str(), Port::File::Read, true));
    }

    /// Expects the line of that number.
    static void Expect(const SplitLine& line, const Foresight::Hashes& names, int number) {
        EXPECT_EQ(line.words.Concatenate(" ").GetView(), LineOf(number));
        EXPECT_EQ(line.bytes, LineOf(number).size() + 1);
        EXPECT_EQ(names, Foresight::HashNames(line.words));
    }

    Support::TemporaryFolder folder_;
    const std::string name_ = folder_ / "lines";
    Port::File file_;
};

TEST_F(LineBatchesTest, GiveEveryLine) {
    const LineBatches::Settings all[] = {{0, 1, 1, 1},      {1, 1, 3, 1000},       {1, 2, 1, 1000},
                                         {1, 4, 7, 1000},   {3, 3, 2, 1000},       {1, 4, 100, 1},
                                         {2, 5, 100, 3000}, {1, 2, 1000, 1U << 30}};
    for (const LineBatches::Settings& settings : all) {
        ASSERT_TRUE(file_.open(name_.c_str(), Port::File::Read, true));
        LineBatches batches(file_, settings);
        SplitLine line;
        Foresight::Hashes names;
        for (int i = 0; i < Count; ++i) {
            ASSERT_TRUE(batches.Next(line, names));
            Expect(line, names, i);
        }
        EXPECT_FALSE(batches.Next(line, names));
        EXPECT_FALSE(batches.Next(line, names));
    }
}

TEST_F(LineBatchesTest, EndBeforeTheirFileDoes) {
    for (int given = 0; given < 20; ++given) {
        ASSERT_TRUE(file_.open(name_.c_str(), Port::File::Read, true));
        LineBatches batches(file_, {1, 3, 4, 1000});
        // A ring of lines, each of which is given back for a later one.
        std::vector<SplitLine> lines(3);
        Foresight::Hashes names;
        for (int i = 0; i < given; ++i) {
            SplitLine& line = lines[static_cast<std::size_t>(i) % lines.size()];
            ASSERT_TRUE(batches.Next(line, names));
            Expect(line, names, i);
            line.Release(512);
        }
    }
}

TEST_F(LineBatchesTest, OfAFileThatIsNotOpenAreEmpty) {
    file_.close();
    LineBatches batches(file_, LineBatches::Settings());
    SplitLine line;
    Foresight::Hashes names;
    EXPECT_FALSE(batches.Next(line, names));
}

} // namespace
