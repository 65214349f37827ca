// A written netlist takes the place of a file as a whole, or not at all.
#include "Orn_Hdl/Streams.h"
#include "Port/Folder.h"
#include "Port/System.h"
#include "Robustness/FailingSystem.h"
#include "Support/EngineScript.h"
#include "Support/TemporaryFolder.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cerrno>
#include <cstdlib>
#include <fcntl.h>
#include <filesystem>
#include <functional>
#include <stdexcept>
#include <string>
#include <sys/stat.h>
#include <thread>
#include <unistd.h>
#include <utility>

namespace {

using Orn_Hdl::OutStream;
using Orn_Hdl::TextFileOutStream;
using Support::ReadWholeFile;
using Support::WriteWholeFile;
namespace fs = std::filesystem;

class Replacing : public testing::Test {
protected:
    std::string Path(const char* name) const { return folder_ / name; }

    int CountFiles() const {
        int count = 0;
        for ([[maybe_unused]] const auto& entry : fs::directory_iterator(folder_.GetPath())) {
            ++count;
        }
        return count;
    }

    /// Writes "new" to replace a file. \return the error that the stream tells.
    static int Replace(const std::string& name) {
        TextFileOutStream out(name.c_str(), TextFileOutStream::Replace);
        out << "new" << OutStream::NewLine;
        out.Close();
        return out.GetError();
    }

    Support::TemporaryFolder folder_;
};

TEST_F(Replacing, TheFormerFileStandsUntilTheStreamIsClosed) {
    WriteWholeFile(Path("file"), "former");
    TextFileOutStream out(Path("file").c_str(), TextFileOutStream::Replace);
    ASSERT_TRUE(out.IsOpen());
    out << std::string(1000000, 'x').c_str() << OutStream::Flush;
    EXPECT_EQ(ReadWholeFile(Path("file")), "former");
    out.Close();
    EXPECT_EQ(out.GetError(), 0);
    EXPECT_EQ(ReadWholeFile(Path("file")).size(), 1000000u + 8);
    EXPECT_EQ(CountFiles(), 1);
}

TEST_F(Replacing, AStreamThatEndsWithoutCloseChangesNothing) {
    WriteWholeFile(Path("file"), "former");
    try {
        TextFileOutStream out(Path("file").c_str(), TextFileOutStream::Replace);
        out << "half";
        throw std::runtime_error("in the middle");
    } catch (const std::runtime_error&) {
    }
    EXPECT_EQ(ReadWholeFile(Path("file")), "former");
    { TextFileOutStream out(Path("fresh").c_str(), TextFileOutStream::Replace); }
    EXPECT_EQ(CountFiles(), 1);
}

TEST_F(Replacing, OpeningAnotherFileClosesTheFirst) {
    TextFileOutStream out(Path("first").c_str(), TextFileOutStream::Replace);
    out << "one";
    ASSERT_TRUE(out.Open(Path("second").c_str(), false));
    out << "two";
    out.Close();
    EXPECT_EQ(ReadWholeFile(Path("first")), "one\n");
    EXPECT_EQ(ReadWholeFile(Path("second")), "two\n");
    EXPECT_EQ(out.GetFileName(), Path("first").c_str());
}

TEST_F(Replacing, MakesAFileThatIsMissingWithTheUsersPermissions) {
    const mode_t mask = umask(027);
    EXPECT_EQ(Replace(Path("file")), 0);
    umask(mask);
    EXPECT_EQ(ReadWholeFile(Path("file")), "new\n");
    EXPECT_EQ(fs::status(Path("file")).permissions(), fs::perms(0640));
}

TEST_F(Replacing, KeepsThePermissionBits) {
    for (const unsigned bits : {0600U, 0644U, 0666U, 0755U}) {
        WriteWholeFile(Path("file"), "former");
        fs::permissions(Path("file"), fs::perms(bits));
        EXPECT_EQ(Replace(Path("file")), 0);
        EXPECT_EQ(fs::status(Path("file")).permissions(), fs::perms(bits));
    }
}

TEST_F(Replacing, ASymbolicLinkStaysOne) {
    fs::create_directory(Path("sub"));
    WriteWholeFile(Path("sub/file"), "former");
    fs::create_symlink("sub/link", Path("outer"));
    fs::create_symlink("file", Path("sub/link"));
    EXPECT_EQ(Replace(Path("outer")), 0);
    EXPECT_TRUE(fs::is_symlink(Path("outer")));
    EXPECT_TRUE(fs::is_symlink(Path("sub/link")));
    EXPECT_EQ(ReadWholeFile(Path("sub/file")), "new\n");
    fs::create_symlink(Path("sub/fresh"), Path("dangling"));
    EXPECT_EQ(Replace(Path("dangling")), 0);
    EXPECT_TRUE(fs::is_symlink(Path("dangling")));
    EXPECT_EQ(ReadWholeFile(Path("sub/fresh")), "new\n");
}

TEST_F(Replacing, ARingOfLinksCannotBeWritten) {
    fs::create_symlink(Path("b"), Path("a"));
    fs::create_symlink(Path("a"), Path("b"));
    EXPECT_EQ(Replace(Path("a")), ELOOP);
    EXPECT_EQ(CountFiles(), 2);
}

TEST_F(Replacing, AFolderCannotBeReplaced) {
    EXPECT_EQ(Replace(folder_.GetPath()), EISDIR);
    EXPECT_EQ(Replace(Path("missing/file")), ENOENT);
    EXPECT_EQ(Replace(""), ENOENT);
    WriteWholeFile(Path("file"), "former");
    EXPECT_EQ(Replace(Path("file/file")), ENOTDIR);
    EXPECT_EQ(CountFiles(), 1);
}

TEST_F(Replacing, AFolderThatVanishesIsTold) {
    fs::create_directory(Path("sub"));
    TextFileOutStream out(Path("sub/file").c_str(), TextFileOutStream::Replace);
    ASSERT_TRUE(out.IsOpen());
    fs::remove_all(Path("sub"));
    out << "text";
    out.Close();
    EXPECT_EQ(out.GetError(), ENOENT);
}

TEST_F(Replacing, AFolderThatComesInBetweenIsTold) {
    TextFileOutStream out(Path("file").c_str(), TextFileOutStream::Replace);
    fs::create_directory(Path("file"));
    out << "text";
    out.Close();
    EXPECT_EQ(out.GetError(), EISDIR);
    EXPECT_EQ(CountFiles(), 1);
}

TEST_F(Replacing, NamesMayBeAsLongAsTheSystemAllows) {
    const std::string longest(255, 'n');
    EXPECT_EQ(Replace(Path(longest.c_str())), 0);
    EXPECT_EQ(Replace(Path(longest.c_str())), 0);
    EXPECT_EQ(Replace(Path((longest + "n").c_str())), ENAMETOOLONG);
    EXPECT_EQ(CountFiles(), 1);
}

TEST_F(Replacing, DevicesAreWrittenDirectly) {
    EXPECT_EQ(Replace("/dev/null"), 0);
    EXPECT_TRUE(fs::is_character_file("/dev/null"));
    EXPECT_EQ(Replace("/dev/full"), ENOSPC);
    fs::create_symlink("/dev/full", Path("link"));
    EXPECT_EQ(Replace(Path("link")), ENOSPC);
    EXPECT_TRUE(fs::is_character_file("/dev/full"));
}

TEST_F(Replacing, APipeIsWrittenDirectly) {
    ASSERT_EQ(mkfifo(Path("pipe").c_str(), 0600), 0);
    std::string received;
    std::thread reader([&] { received = ReadWholeFile(Path("pipe")); });
    EXPECT_EQ(Replace(Path("pipe")), 0);
    reader.join();
    EXPECT_EQ(received, "new\n");
    EXPECT_TRUE(fs::is_fifo(Path("pipe")));
}

TEST_F(Replacing, AnOpenFileOfTheProcessIsWrittenDirectly) {
    // As /dev/stdout is, when the output of the process goes into a file.
    const int descriptor = open(Path("file").c_str(), O_RDWR | O_CREAT | O_CLOEXEC, 0600);
    ASSERT_GE(descriptor, 0);
    EXPECT_EQ(Replace("/dev/fd/" + std::to_string(descriptor)), 0);
    char text[8] = {};
    EXPECT_EQ(read(descriptor, text, sizeof text), 4) << "it is the same file still";
    EXPECT_STREQ(text, "new\n");
    close(descriptor);
    EXPECT_EQ(CountFiles(), 1);
}

/// While it lives, a process of the superuser, who may write anything, is one of a plain user.
class PlainUser {
public:
    explicit PlainUser(const std::string& folder) : isSuperuser_(geteuid() == 0) {
        if (isSuperuser_ && (chown(folder.c_str(), Nobody, Nobody) != 0 || seteuid(Nobody) != 0)) {
            throw std::runtime_error("cannot become a plain user");
        }
    }
    PlainUser(const PlainUser&) = delete;
    PlainUser& operator=(const PlainUser&) = delete;
    ~PlainUser() {
        if (isSuperuser_ && seteuid(0) != 0) {
            std::abort();
        }
    }

private:
    static constexpr unsigned Nobody = 65534;

    bool isSuperuser_;
};

TEST_F(Replacing, WhatMayNotBeWrittenIsNotReplaced) {
    const PlainUser user(folder_.GetPath());
    WriteWholeFile(Path("file"), "former");
    fs::permissions(Path("file"), fs::perms(0444));
    EXPECT_EQ(Replace(Path("file")), EACCES);
    fs::permissions(folder_.GetPath(), fs::perms(0555));
    EXPECT_EQ(Replace(Path("file")), EACCES);
    EXPECT_EQ(Replace(Path("fresh")), EACCES);
    fs::permissions(folder_.GetPath(), fs::perms(0755));
    EXPECT_EQ(ReadWholeFile(Path("file")), "former");
    EXPECT_EQ(CountFiles(), 1);
}

TEST_F(Replacing, AFileIsWrittenDirectlyWhereNoOtherCanBeMade) {
    const PlainUser user(folder_.GetPath());
    WriteWholeFile(Path("file"), "former, and longer than the new text");
    fs::permissions(Path("file"), fs::perms(0640));
    fs::create_symlink("file", Path("link"));
    fs::permissions(folder_.GetPath(), fs::perms(0555));
    for (const char* name : {"file", "link"}) {
        EXPECT_EQ(Replace(Path(name)), 0);
        EXPECT_EQ(ReadWholeFile(Path("file")), "new\n");
    }
    Support::EngineScript script;
    script.Run("WRITE VERILOG -NOHEADER " + Path("file"));
    EXPECT_EQ(script.GetModel().GetWriteError(), 0);
    EXPECT_NE(ReadWholeFile(Path("file")).find("endmodule"), std::string::npos);
    fs::permissions(folder_.GetPath(), fs::perms(0755));
    EXPECT_EQ(fs::status(Path("file")).permissions(), fs::perms(0640));
    EXPECT_EQ(CountFiles(), 2);
}

/// A system in which no file can be made, and, if so wished, none written over.
class ReadOnlySystem : public Port::System {
public:
    ReadOnlySystem(int error, bool refusesAll) : error_(error), refusesAll_(refusesAll) {
        System::Replace(this);
    }
    ReadOnlySystem(const ReadOnlySystem&) = delete;
    ReadOnlySystem& operator=(const ReadOnlySystem&) = delete;
    ~ReadOnlySystem() override { System::Replace(nullptr); }

    int Open(const char* name, int flags, unsigned mode) override {
        if ((flags & O_CREAT) != 0 || (refusesAll_ && (flags & O_TRUNC) != 0)) {
            errno = error_;
            return -1;
        }
        return System::Open(name, flags, mode);
    }

private:
    int error_;
    bool refusesAll_;
};

TEST_F(Replacing, OnlyARefusalOfNewFilesIsGoneRound) {
    for (const int error : {EACCES, EPERM, EROFS, ENOSPC, EIO, EMFILE}) {
        const bool isRefusal = error == EACCES || error == EPERM || error == EROFS;
        WriteWholeFile(Path("file"), "former");
        for (const bool refusesAll : {true, false}) {
            const ReadOnlySystem system(error, refusesAll);
            const bool isWritten = isRefusal && !refusesAll;
            EXPECT_EQ(Replace(Path("file")), isWritten ? 0 : error);
            EXPECT_EQ(ReadWholeFile(Path("file")), isWritten ? "new\n" : "former");
            EXPECT_EQ(Replace(Path("fresh")), error) << "there is nothing to write over";
        }
    }
    EXPECT_EQ(CountFiles(), 1);
}

TEST_F(Replacing, OtherNamesOfAFileLeadToTheFormerText) {
    WriteWholeFile(Path("file"), "former");
    fs::permissions(Path("file"), fs::perms(0604));
    fs::create_hard_link(Path("file"), Path("other"));
    EXPECT_EQ(Replace(Path("other")), 0);
    EXPECT_EQ(ReadWholeFile(Path("other")), "new\n");
    EXPECT_EQ(fs::status(Path("other")).permissions(), fs::perms(0604));
    EXPECT_EQ(ReadWholeFile(Path("file")), "former");
    EXPECT_EQ(CountFiles(), 2);
}

TEST_F(Replacing, AFailureBelowAFolderLeavesTheFormerText) {
    Port::Folder folder;
    ASSERT_EQ(folder.Open(folder_.GetPath().c_str()), 0);
    const int before = Support::CountOpenFiles();
    int calls = 0;
    // The first run fails nowhere and counts the calls.
    for (int failing = 0; failing <= calls; ++failing) {
        WriteWholeFile(Path("file"), "former");
        int error = 0;
        {
            const Robustness::FailingSystem system(failing, EIO);
            TextFileOutStream out(folder, "file", "file", TextFileOutStream::Replace);
            out << "new" << OutStream::NewLine;
            out.Close();
            error = out.GetError();
            calls = std::max(calls, system.GetCallCount());
        }
        EXPECT_EQ(ReadWholeFile(Path("file")), error == 0 ? "new\n" : "former") << failing;
        EXPECT_EQ(CountFiles(), 1) << failing;
        EXPECT_EQ(Support::CountOpenFiles(), before) << failing;
    }
    EXPECT_GT(calls, 8);
}

TEST_F(Replacing, LeavesNoFileOpenWhetherDoneOrRefused) {
    const int before = Support::CountOpenFiles();
    Replace(Path("file"));
    Replace(Path("file"));
    Replace(folder_.GetPath());
    Replace("/dev/full");
    EXPECT_EQ(Support::CountOpenFiles(), before);
}

/// Looks at each file that is made, before and after.
class WatchedSystem : public Port::System {
public:
    WatchedSystem() { System::Replace(this); }
    WatchedSystem(const WatchedSystem&) = delete;
    WatchedSystem& operator=(const WatchedSystem&) = delete;
    ~WatchedSystem() override { System::Replace(nullptr); }

    int Open(const char* name, int flags, unsigned mode) override {
        if ((flags & O_CREAT) != 0 && beforeMaking) {
            std::exchange(beforeMaking, nullptr)(name);
        }
        const int descriptor = System::Open(name, flags, mode);
        if (descriptor >= 0) {
            ++opened;
            inherited += (fcntl(descriptor, F_GETFD) & FD_CLOEXEC) == 0 ? 1 : 0;
        }
        return descriptor;
    }

    /// Called once, with the name of the first file that is about to be made.
    std::function<void(const char* name)> beforeMaking;
    int opened = 0;
    /// Of these, the files that a program started by this one would have open.
    int inherited = 0;
};

TEST_F(Replacing, NeverWritesIntoAFileThatItHasNotMade) {
    WriteWholeFile(Path("file"), "former");
    WriteWholeFile(Path("victim"), "untouched");
    for (const bool byLink : {false, true}) {
        WatchedSystem system;
        std::string taken;
        system.beforeMaking = [&](const char* name) {
            taken = name;
            if (byLink) {
                fs::create_symlink(Path("victim"), name);
            } else {
                WriteWholeFile(name, "untouched");
            }
        };
        EXPECT_EQ(Replace(Path("file")), 0);
        ASSERT_NE(taken, "");
        EXPECT_NE(taken, Path("file"));
        EXPECT_EQ(ReadWholeFile(Path("file")), "new\n");
        EXPECT_FALSE(fs::is_symlink(Path("file")));
        EXPECT_EQ(ReadWholeFile(taken), "untouched");
        EXPECT_EQ(fs::is_symlink(taken), byLink);
        fs::remove(taken);
    }
    EXPECT_EQ(CountFiles(), 2);
}

TEST_F(Replacing, NoFileIsOpenInAProgramThatIsStarted) {
    WatchedSystem system;
    WriteWholeFile(Path("file"), "former");
    EXPECT_EQ(Replace(Path("file")), 0);
    EXPECT_EQ(Replace(Path("fresh")), 0);
    for (const auto mode : {TextFileOutStream::Overwrite, TextFileOutStream::Append}) {
        TextFileOutStream out(Path("file").c_str(), mode);
        EXPECT_TRUE(out.IsOpen());
    }
    Support::EngineScript script;
    WriteWholeFile(Path("lines"), "NOOP\n");
    EXPECT_TRUE(script.GetEngine().ReadCommandFile("top", Path("lines").c_str()));
    EXPECT_GE(system.opened, 6);
    EXPECT_EQ(system.inherited, 0);
}

TEST_F(Replacing, TheWriteCommandsReplace) {
    Support::EngineScript script;
    WriteWholeFile(Path("file"), "former");
    fs::permissions(Path("file"), fs::perms(0600));
    for (const char* language : {"VERILOG", "VHDL"}) {
        script.Run(std::string("WRITE ") + language + " -NOHEADER " + Path("file"));
        const std::string text = ReadWholeFile(Path("file"));
        EXPECT_EQ(text.find("former"), std::string::npos);
        script.Run(std::string("WRITE ") + language + " -APPEND -NOHEADER " + Path("file"));
        EXPECT_EQ(ReadWholeFile(Path("file")), text + text);
        EXPECT_EQ(fs::status(Path("file")).permissions(), fs::perms(0600));
    }
    EXPECT_EQ(CountFiles(), 1);
}

} // namespace
