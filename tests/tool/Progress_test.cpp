// The progress line, by a clock that the test moves on.
#include "Progress.h"

#include "Support/TemporaryFolder.h"

#include <gtest/gtest.h>

#include <chrono>
#include <cstdio>
#include <memory>
#include <string>

namespace {

using namespace std::chrono_literals;
using Tool::Progress;

class ProgressLine : public testing::Test {
protected:
    ProgressLine() : terminal_(std::fopen((folder_ / "terminal").c_str(), "w"), &std::fclose) {
        Support::WriteWholeFile(file_, std::string(1000, 'x'));
    }

    /// \param file the file that is read; by default the file of 1000 bytes.
    Progress Make(const std::string& file) {
        return Progress(terminal_.get(), file, [this] { return now_; });
    }
    std::string GetShown() {
        std::fflush(terminal_.get());
        return Support::ReadWholeFile(folder_ / "terminal");
    }

    Support::TemporaryFolder folder_;
    std::string file_ = folder_ / "design.cmd";
    std::unique_ptr<std::FILE, int (*)(std::FILE*)> terminal_;
    Progress::Clock::time_point now_{};
};

TEST_F(ProgressLine, IsNotShownWithinTheFirstSecond) {
    Progress progress = Make(file_);
    now_ += 999ms;
    progress.Update(1, 10);
    progress.Writing("out.v");
    progress.Erase();
    EXPECT_EQ(GetShown(), "");
}

TEST_F(ProgressLine, ShowsLinesAndPercentAndIsErased) {
    {
        Progress progress = Make(file_);
        now_ += 1s;
        progress.Update(12, 345);
        EXPECT_EQ(GetShown(), "orn-hdl: 12 lines, 34 %");
    }
    EXPECT_EQ(GetShown(), "orn-hdl: 12 lines, 34 %\r\033[K");
}

TEST_F(ProgressLine, ShowsWhatWasReadOfANetlist) {
    Progress progress = Make(file_);
    now_ += 1s;
    progress.Reading(345, false);
    now_ += 1s;
    progress.Reading(7654321, true);
    now_ += 1s;
    progress.Making("top");
    EXPECT_EQ(GetShown(), "orn-hdl: reading, 34 %\r\033[Korn-hdl: reading, 7 MB\r\033[K"
                          "orn-hdl: making the design top");
}

TEST_F(ProgressLine, ShowsMegabytesOfAPipe) {
    Progress progress = Make("-");
    now_ += 1s;
    progress.Reading(12345678, false);
    EXPECT_EQ(GetShown(), "orn-hdl: reading, 12 MB");
}

TEST_F(ProgressLine, IsRenewedTenTimesASecond) {
    Progress progress = Make(file_);
    now_ += 1s;
    progress.Update(1, 100);
    now_ += 99ms;
    progress.Update(2, 200);
    EXPECT_EQ(GetShown(), "orn-hdl: 1 lines, 10 %");
    now_ += 1ms;
    progress.Update(3, 300);
    EXPECT_EQ(GetShown(), "orn-hdl: 1 lines, 10 %\r\033[Korn-hdl: 3 lines, 30 %");
}

TEST_F(ProgressLine, NeverExceedsAHundredPercent) {
    Progress progress = Make(file_);
    now_ += 1s;
    progress.Update(1, 2000);
    EXPECT_EQ(GetShown(), "orn-hdl: 1 lines, 100 %");
}

TEST_F(ProgressLine, OfAFileWithoutASizeHasNoPercent) {
    Progress progress = Make(folder_ / "missing");
    now_ += 1s;
    progress.Update(1, 10);
    EXPECT_EQ(GetShown(), "orn-hdl: 1 lines");
}

TEST_F(ProgressLine, NamesTheFileThatIsWritten) {
    Progress progress = Make(file_);
    now_ += 1s;
    progress.Writing("out.v");
    EXPECT_EQ(GetShown(), "orn-hdl: writing out.v");
}

TEST_F(ProgressLine, IsErasedOnce) {
    Progress progress = Make(file_);
    now_ += 1s;
    progress.Update(1, 0);
    progress.Erase();
    progress.Erase();
    EXPECT_EQ(GetShown(), "orn-hdl: 1 lines, 0 %\r\033[K");
}

TEST_F(ProgressLine, IsNotShownWithoutATerminal) {
    int looks = 0;
    Progress progress(nullptr, file_, [&] {
        ++looks;
        return now_;
    });
    now_ += 10s;
    progress.Update(1, 10);
    progress.Writing("out.v");
    EXPECT_EQ(looks, 1) << "a clock that nobody needs is not looked at";
    EXPECT_EQ(GetShown(), "");
}

} // namespace
