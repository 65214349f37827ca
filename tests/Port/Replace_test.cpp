#include "Port/File.h"

#include "Support/TemporaryFolder.h"

#include <gtest/gtest.h>

#include <cerrno>
#include <filesystem>
#include <string>

namespace {

namespace fs = std::filesystem;
using Port::File;

/// A folder with a file "text" that holds "former".
class Replace : public testing::Test {
protected:
    Replace() { Support::WriteWholeFile(name_, "former"); }

    bool Open(const std::string& name) { return file_.open(name.c_str(), File::Replace, true); }
    std::string Text() const { return Support::ReadWholeFile(name_); }
    int CountFiles() const {
        int count = 0;
        for ([[maybe_unused]] const auto& entry : fs::directory_iterator(folder_.GetPath())) {
            ++count;
        }
        return count;
    }

    Support::TemporaryFolder folder_;
    std::string name_ = folder_ / "text";
    File file_;
};

TEST_F(Replace, TakesEffectWhenTheFileIsClosed) {
    ASSERT_TRUE(Open(name_));
    EXPECT_TRUE(file_.write("new", 3));
    EXPECT_EQ(Text(), "former");
    EXPECT_TRUE(file_.close());
    EXPECT_EQ(Text(), "new");
    EXPECT_EQ(CountFiles(), 1) << "no temporary file stays behind";
}

TEST_F(Replace, MakesAFileThatIsMissing) {
    ASSERT_TRUE(Open(folder_ / "second"));
    EXPECT_TRUE(file_.write("new", 3));
    EXPECT_TRUE(file_.close());
    EXPECT_EQ(Support::ReadWholeFile(folder_ / "second"), "new");
    EXPECT_EQ(CountFiles(), 2);
}

TEST_F(Replace, CanBeGivenUp) {
    ASSERT_TRUE(Open(name_));
    EXPECT_TRUE(file_.write("new", 3));
    file_.Discard();
    EXPECT_FALSE(file_.IsOpen());
    EXPECT_EQ(Text(), "former");
    EXPECT_EQ(CountFiles(), 1);
    file_.Discard();
}

TEST_F(Replace, KeepsThePermissionBits) {
    fs::permissions(name_, fs::perms::owner_all | fs::perms::group_read);
    ASSERT_TRUE(Open(name_));
    EXPECT_TRUE(file_.close());
    EXPECT_EQ(fs::status(name_).permissions(), fs::perms::owner_all | fs::perms::group_read);
    EXPECT_EQ(Text(), "");
}

TEST_F(Replace, LeavesASymbolicLinkALink) {
    const std::string link = folder_ / "link";
    fs::create_symlink("text", link);
    ASSERT_TRUE(Open(link));
    EXPECT_TRUE(file_.write("new", 3));
    EXPECT_TRUE(file_.close());
    EXPECT_TRUE(fs::is_symlink(link));
    EXPECT_EQ(Text(), "new");
    EXPECT_EQ(CountFiles(), 2);
}

TEST_F(Replace, WritesDevicesDirectly) {
    ASSERT_TRUE(Open("/dev/null"));
    EXPECT_TRUE(file_.write("new", 3));
    EXPECT_TRUE(file_.close());
    EXPECT_TRUE(fs::is_character_file("/dev/null"));
    ASSERT_TRUE(Open("/dev/full"));
    EXPECT_FALSE(file_.write("new", 3));
    EXPECT_FALSE(file_.close());
    EXPECT_EQ(file_.GetError(), ENOSPC);
}

TEST_F(Replace, RefusesFoldersAndMissingFolders) {
    EXPECT_FALSE(Open(folder_.GetPath()));
    EXPECT_NE(file_.GetError(), 0);
    EXPECT_FALSE(Open(folder_ / "no/such/file"));
    EXPECT_EQ(file_.GetError(), ENOENT);
    EXPECT_EQ(CountFiles(), 1);
}

TEST_F(Replace, LeavesNoFileOpen) {
    const int before = Support::CountOpenFiles();
    for (int i = 0; i < 3; ++i) {
        ASSERT_TRUE(Open(name_));
        EXPECT_TRUE(file_.close());
        ASSERT_TRUE(Open(name_));
        file_.Discard();
    }
    EXPECT_EQ(Support::CountOpenFiles(), before);
}

} // namespace
