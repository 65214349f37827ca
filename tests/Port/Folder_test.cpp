#include "Port/Folder.h"

#include "Port/File.h"
#include "Support/TemporaryFolder.h"

#include <gtest/gtest.h>

#include <cerrno>
#include <fcntl.h>
#include <filesystem>
#include <string>
#include <sys/stat.h>
#include <unistd.h>

namespace {

namespace fs = std::filesystem;
using Port::File;
using Support::ReadWholeFile;
using Support::WriteWholeFile;

/// A folder "in" with a folder "sub", beside a folder "out" with a file "kept".
class Below : public testing::Test {
protected:
    Below() {
        fs::create_directories(base_ / "in/sub");
        fs::create_directories(base_ / "out");
        WriteWholeFile(base_ / "out/kept", "kept");
        EXPECT_EQ(folder_.Open((base_ / "in").c_str()), 0);
    }

    /// Writes "new". \return the error, 0 for none.
    int Write(const char* path, File::Mode mode) {
        File file;
        if (file.OpenBelow(folder_, path, mode, true)) {
            file.write("new", 3);
            file.close();
        }
        return file.GetError();
    }
    void Refuse(const char* path, int error) {
        for (const File::Mode mode : {File::Replace, File::Append, File::Overwrite}) {
            EXPECT_EQ(Write(path, mode), error) << path << " " << mode;
        }
        EXPECT_EQ(ReadWholeFile(base_ / "out/kept"), "kept");
        EXPECT_FALSE(fs::exists(base_ / "out/new"));
    }

    Support::TemporaryFolder base_;
    Port::Folder folder_;
};

TEST_F(Below, FilesAreWritten) {
    EXPECT_EQ(Write("a", File::Replace), 0);
    EXPECT_EQ(Write("sub/.//b", File::Replace), 0);
    EXPECT_EQ(Write("./sub/b", File::Append), 0);
    EXPECT_EQ(ReadWholeFile(base_ / "in/a"), "new");
    EXPECT_EQ(ReadWholeFile(base_ / "in/sub/b"), "newnew");
    EXPECT_EQ(Write("sub/b", File::Replace), 0);
    EXPECT_EQ(ReadWholeFile(base_ / "in/sub/b"), "new");
}

TEST_F(Below, AReplacedFileKeepsItsPermissions) {
    WriteWholeFile(base_ / "in/a", "former");
    fs::permissions(base_ / "in/a", fs::perms::owner_read | fs::perms::owner_write);
    EXPECT_EQ(Write("a", File::Replace), 0);
    EXPECT_EQ(fs::status(base_ / "in/a").permissions(),
              fs::perms::owner_read | fs::perms::owner_write);
}

TEST_F(Below, ADiscardedFileLeavesNothingBehind) {
    File file;
    ASSERT_TRUE(file.OpenBelow(folder_, "sub/a", File::Replace, true));
    file.write("new", 3);
    file.Discard();
    EXPECT_TRUE(fs::is_empty(base_ / "in/sub"));
}

TEST_F(Below, NoLinkIsFollowed) {
    fs::create_symlink("../out", base_ / "in/way");
    fs::create_symlink("sub", base_ / "in/inner");
    fs::create_symlink("../out/kept", base_ / "in/file");
    fs::create_symlink("../out/new", base_ / "in/fresh");
    Refuse("way/kept", ENOTDIR);
    Refuse("way/new", ENOTDIR);
    Refuse("inner/a", ENOTDIR);
    Refuse("file", ELOOP);
    Refuse("fresh", ELOOP);
}

TEST_F(Below, AFolderThatBecomesALinkWhileAFileIsWrittenDoesNotMatter) {
    File file;
    ASSERT_TRUE(file.OpenBelow(folder_, "sub/new", File::Replace, true));
    fs::rename(base_ / "in/sub", base_ / "in/moved");
    fs::create_symlink("../out", base_ / "in/sub");
    file.write("new", 3);
    EXPECT_TRUE(file.close());
    EXPECT_EQ(ReadWholeFile(base_ / "in/moved/new"), "new");
    EXPECT_FALSE(fs::exists(base_ / "out/new"));
}

TEST_F(Below, OtherPathsAreRefused) {
    Refuse("../out/kept", EXDEV);
    Refuse("sub/../../out/kept", EXDEV);
    Refuse("..", EISDIR);
    Refuse("", EISDIR);
    Refuse("sub/", EISDIR);
    Refuse("sub", EISDIR);
    Refuse("none/a", ENOENT);
}

TEST_F(Below, OnlyRegularFilesAreWritten) {
    ASSERT_EQ(mkfifo((base_ / "in/pipe").c_str(), 0600), 0);
    Refuse("pipe", ENXIO);
    const int reader = open((base_ / "in/pipe").c_str(), O_RDONLY | O_NONBLOCK);
    ASSERT_GE(reader, 0);
    Refuse("pipe", EINVAL);
    close(reader);
}

TEST_F(Below, NoDescriptorIsLeftOpen) {
    const int before = Support::CountOpenFiles();
    Write("a", File::Replace);
    Write("sub/a", File::Append);
    Write("none/a", File::Replace);
    Write("sub", File::Replace);
    EXPECT_EQ(Support::CountOpenFiles(), before);
    EXPECT_EQ(folder_.Open((base_ / "in/sub").c_str()), 0);
    EXPECT_EQ(Support::CountOpenFiles(), before);
    EXPECT_EQ(folder_.Open((base_ / "none").c_str()), ENOENT);
    EXPECT_TRUE(folder_.IsOpen()) << "a failure leaves the former folder open";
    folder_.Close();
    EXPECT_EQ(Support::CountOpenFiles(), before - 1);
    EXPECT_EQ(folder_.Open(nullptr), ENOENT);
    EXPECT_FALSE(folder_.IsOpen());
}

TEST_F(Below, AClosedFileKeepsNoFolderOpen) {
    const int before = Support::CountOpenFiles();
    for (const File::Mode mode : {File::Append, File::Overwrite, File::Replace}) {
        File file;
        EXPECT_TRUE(file.OpenBelow(folder_, "sub/a", mode, true));
        EXPECT_TRUE(file.close());
        EXPECT_EQ(Support::CountOpenFiles(), before) << mode;
    }
}

TEST_F(Below, AFolderThatOpensAnotherClosesTheFormer) {
    const int before = Support::CountOpenFiles();
    EXPECT_EQ(folder_.Open((base_ / "out").c_str()), 0);
    EXPECT_EQ(Support::CountOpenFiles(), before);
}

TEST_F(Below, ADestroyedFolderIsClosed) {
    const int before = Support::CountOpenFiles();
    {
        Port::Folder folder;
        EXPECT_EQ(folder.Open((base_ / "out").c_str()), 0);
        EXPECT_EQ(Support::CountOpenFiles(), before + 1);
    }
    EXPECT_EQ(Support::CountOpenFiles(), before);
}

} // namespace
