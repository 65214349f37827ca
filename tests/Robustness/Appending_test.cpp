// A file that cannot be appended to ends as it began.
#include "Orn_Hdl/Streams.h"
#include "Port/File.h"
#include "Port/System.h"
#include "Support/EngineScript.h"
#include "Support/TemporaryFolder.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cerrno>
#include <cstddef>
#include <string>

namespace {

using Port::File;
using Support::ReadWholeFile;
using Support::WriteWholeFile;

/// A disk on which only so many bytes more find room, and whose other calls fail on demand.
class FullDisk : public Port::System {
public:
    explicit FullDisk(std::size_t room) : room_(room) { System::Replace(this); }
    FullDisk(const FullDisk&) = delete;
    FullDisk& operator=(const FullDisk&) = delete;
    ~FullDisk() override { System::Replace(nullptr); }

    bool failsToClose = false;
    bool failsToTruncate = false;
    bool failsToTellStatus = false;
    bool failsToReopen = false;
    std::string othersText;
    std::string fileOfOthers;

    int Open(const char* name, int flags, unsigned mode) override {
        if (failsToReopen && opened_++ > 0) {
            errno = EMFILE;
            return -1;
        }
        return System::Open(name, flags, mode);
    }
    ssize_t Write(int descriptor, const void* data, std::size_t size) override {
        if (!fileOfOthers.empty()) {
            WriteWholeFile(fileOfOthers, ReadWholeFile(fileOfOthers) + othersText);
            fileOfOthers.clear();
        }
        if (size > 0 && room_ == 0) {
            errno = ENOSPC;
            return -1;
        }
        const std::size_t taken = std::min(size, room_);
        room_ -= taken;
        return System::Write(descriptor, data, taken);
    }
    int Close(int descriptor) override {
        const int result = System::Close(descriptor);
        if (failsToClose) {
            failsToClose = false;
            errno = EIO;
            return -1;
        }
        return result;
    }
    int Truncate(int descriptor, off_t size) override {
        if (failsToTruncate) {
            errno = EIO;
            return -1;
        }
        return System::Truncate(descriptor, size);
    }
    int GetStatus(int descriptor, struct stat* status) override {
        if (failsToTellStatus) {
            errno = EIO;
            return -1;
        }
        return System::GetStatus(descriptor, status);
    }

private:
    std::size_t room_;
    int opened_ = 0;
};

class Appending : public testing::Test {
protected:
    Appending() { WriteWholeFile(name_, Former); }

    /// Appends ten bytes. \return the error.
    int Append(File& file, bool discard = false) {
        EXPECT_TRUE(file.open(name_.c_str(), File::Append, false));
        file.write("0123456789", 10);
        if (discard) {
            file.Discard();
        } else {
            const bool isWritten = file.close();
            EXPECT_EQ(isWritten, file.GetError() == 0);
        }
        return file.GetError();
    }

    const std::string Former = "what stood here before\n";
    Support::TemporaryFolder folder_;
    std::string name_ = folder_ / "text";
    File file_;
};

TEST_F(Appending, ThatFailsGivesTheFileItsLengthBack) {
    for (std::size_t room = 0; room < 10; ++room) {
        for (const bool discard : {false, true}) {
            const FullDisk disk(room);
            EXPECT_EQ(Append(file_, discard), ENOSPC);
            EXPECT_EQ(file_.GetLeftoverSize(), 0u);
            EXPECT_EQ(ReadWholeFile(name_), Former);
        }
    }
    const FullDisk disk(10);
    EXPECT_EQ(Append(file_), 0);
    EXPECT_EQ(ReadWholeFile(name_), Former + "0123456789");
}

TEST_F(Appending, ThatIsGivenUpWithoutAFailureStays) {
    EXPECT_EQ(Append(file_, true), 0);
    EXPECT_EQ(ReadWholeFile(name_), Former + "0123456789");
}

TEST_F(Appending, ThatFailsAtTheEndGivesTheFileItsLengthBack) {
    FullDisk disk(100);
    disk.failsToClose = true;
    EXPECT_EQ(Append(file_), EIO);
    EXPECT_EQ(file_.GetLeftoverSize(), 0u);
    EXPECT_EQ(ReadWholeFile(name_), Former);
}

TEST_F(Appending, TellsWhatIsLeftWhereTheLengthCannotBeGivenBack) {
    FullDisk disk(4);
    disk.failsToTruncate = true;
    EXPECT_EQ(Append(file_), ENOSPC);
    EXPECT_EQ(file_.GetLeftoverSize(), 4u);
    EXPECT_EQ(ReadWholeFile(name_), Former + "0123");
    EXPECT_FALSE(file_.open((folder_ / "no/such").c_str(), File::Append, false));
    EXPECT_EQ(file_.GetLeftoverSize(), 0u) << "of the last opening only";
}

TEST_F(Appending, TellsWhatIsLeftOfAFileThatIsNotKnown) {
    FullDisk disk(4);
    disk.failsToTellStatus = true;
    EXPECT_EQ(Append(file_), ENOSPC);
    EXPECT_EQ(file_.GetLeftoverSize(), 4u);
}

TEST_F(Appending, TellsWhatIsLeftWhereTheFileDoesNotOpenAgain) {
    FullDisk disk(100);
    disk.failsToClose = true;
    disk.failsToReopen = true;
    EXPECT_EQ(Append(file_), EIO);
    EXPECT_EQ(file_.GetLeftoverSize(), 10u);
    EXPECT_EQ(ReadWholeFile(name_), Former + "0123456789");
}

TEST_F(Appending, LeavesWhatOthersAppend) {
    FullDisk disk(4);
    disk.fileOfOthers = name_;
    disk.othersText = "of somebody else\n";
    EXPECT_EQ(Append(file_), ENOSPC);
    EXPECT_EQ(file_.GetLeftoverSize(), 4u);
    EXPECT_EQ(ReadWholeFile(name_), Former + "of somebody else\n0123");
}

TEST_F(Appending, LeavesAFileThatIsEmptiedMeanwhile) {
    EXPECT_TRUE(file_.open(name_.c_str(), File::Append, false));
    WriteWholeFile(name_, "x");
    const FullDisk disk(4);
    EXPECT_FALSE(file_.write("0123456789", 10));
    EXPECT_FALSE(file_.close());
    EXPECT_EQ(file_.GetLeftoverSize(), 0u);
    EXPECT_EQ(ReadWholeFile(name_), "x0123");
}

TEST_F(Appending, ToADeviceHasNoLength) {
    ASSERT_TRUE(file_.open("/dev/full", File::Append, false));
    EXPECT_FALSE(file_.write("a", 1));
    EXPECT_FALSE(file_.close());
    EXPECT_EQ(file_.GetLeftoverSize(), 0u);
}

TEST_F(Appending, WithAStreamEndsAsItBegan) {
    FullDisk disk(4);
    Orn_Hdl::TextFileOutStream out(name_, true);
    out << "0123456789\n";
    out.Close();
    EXPECT_EQ(out.GetError(), ENOSPC);
    EXPECT_EQ(out.GetLeftoverSize(), 0u);
    EXPECT_EQ(ReadWholeFile(name_), Former);
}

TEST_F(Appending, WithACommandTellsWhatIsLeft) {
    Support::EngineScript script;
    FullDisk disk(4);
    disk.failsToTruncate = true;
    script.GetModel().Execute(("WRITE VERILOG -APPEND " + name_).c_str());
    EXPECT_EQ(script.GetModel().GetWriteError(), ENOSPC);
    EXPECT_EQ(script.GetModel().GetWriteLeftover(), 4u);
    EXPECT_EQ(ReadWholeFile(name_).size(), Former.size() + 4);
    script.GetModel().RecordWrite("", 0);
    EXPECT_EQ(script.GetModel().GetWriteLeftover(), 0u);
}

} // namespace
