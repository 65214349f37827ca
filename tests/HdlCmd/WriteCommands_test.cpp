// "WRITE VERILOG" and "WRITE VHDL": options, file names, headers and failures.

#include "Orn_Hdl/Orn_Hdl.h"
#include "Support/EngineScript.h"
#include "Support/Environment.h"
#include "Support/TemporaryFolder.h"

#include <gtest/gtest.h>

#include <cerrno>
#include <filesystem>
#include <string>

using namespace Orn_Hdl;
using Support::EngineScript;
using Support::ReadWholeFile;

namespace {

class WriteCommands : public testing::TestWithParam<const char*> {
protected:
    void Write(const std::string& words) {
        script_.Run(std::string("WRITE ") + GetParam() + " " + words);
    }
    std::string Read(const char* name) { return ReadWholeFile(folder_ / name); }
    bool Exists(const char* name) { return std::filesystem::exists(folder_ / name); }
    bool IsVhdl() const { return std::string(GetParam()) == "VHDL"; }
    /// Whether a text opens with the banner's divider.
    bool HasBanner(const std::string& text) const {
        return text.substr(0, 81) == std::string(80, IsVhdl() ? '-' : '/') + "\n";
    }

    Support::TemporaryFolder folder_;
    Support::CurrentFolder current_{folder_.GetPath()};
    Support::EnvironmentVariable time_{"SOURCE_DATE_EPOCH", "0"};
    EngineScript script_{"ADD PORT A Input"};
};

} // namespace

TEST_P(WriteCommands, AFileNameAloneOverwritesAndHasABanner) {
    Write("out");
    const std::string once = Read("out");
    EXPECT_TRUE(HasBanner(once));
    Write("out");
    EXPECT_EQ(Read("out"), once);
    EXPECT_TRUE(script_.GetOptions().writeHeader);
}

TEST_P(WriteCommands, TheBannerHoldsWhatTheOptionsSay) {
    script_.Run("SET NETLIST NAME named\n"
                "Set Application tool\n"
                "Set Command run it\n"
                "Set Device dev\n"
                "Set Purpose some purpose\n"
                "Set Reference some reference\n");
    Write("./out");
    const std::string prefix = IsVhdl() ? "--" : "//";
    const std::string text = Read("out");
    for (const char* label : {"Vendor: Halvex\n", "Application : tool\n", "Filename : ./out\n",
                              "Timestamp : 01/01/1970 00:00:00\n"}) {
        EXPECT_NE(text.find(label), std::string::npos) << label;
    }
    EXPECT_NE(text.find("\n" + prefix + "Command: run it\n" + prefix + "Design Name: named\n" +
                        prefix + "Device: dev\n" + prefix + "Purpose:\n" + prefix +
                        "    some purpose \n" + prefix + "Reference\n" + prefix +
                        "    some reference \n"),
              std::string::npos)
        << text;
}

TEST_P(WriteCommands, OneOption) {
    Write("-NOHEADER out");
    const std::string bare = Read("out");
    EXPECT_FALSE(HasBanner(bare));
    EXPECT_FALSE(script_.GetOptions().writeHeader);
    Write("-append out");
    EXPECT_EQ(Read("out").substr(0, bare.size()), bare);
    EXPECT_TRUE(HasBanner(Read("out").substr(bare.size())));
    EXPECT_TRUE(script_.GetOptions().writeHeader);
    Write("-OVERWRITE out");
    EXPECT_TRUE(HasBanner(Read("out")));
    Write("-unknown out");
    EXPECT_TRUE(HasBanner(Read("out")));
    Write("\"\" out");
    EXPECT_TRUE(HasBanner(Read("out")));
}

TEST_P(WriteCommands, TwoOptionsInEitherOrder) {
    Write("-NOHEADER out");
    const std::string bare = Read("out");
    Write("-APPEND -NOHEADER out");
    EXPECT_EQ(Read("out"), bare + bare);
    Write("-noheader -Append out");
    EXPECT_EQ(Read("out"), bare + bare + bare);
    Write("-NOHEADER -OVERWRITE out");
    EXPECT_EQ(Read("out"), bare);
    Write("-NOHEADER -NOHEADER out");
    EXPECT_EQ(Read("out"), bare);
    Write("-OVERWRITE -unknown out");
    EXPECT_TRUE(HasBanner(Read("out")));
}

TEST_P(WriteCommands, AppendingToNothingMakesTheFile) {
    Write("-NOHEADER out");
    Write("-APPEND -NOHEADER fresh");
    EXPECT_EQ(Read("fresh"), Read("out"));
}

TEST_P(WriteCommands, OfSixWordsTheThirdIsTheFileName) {
    Write("-APPEND -NOHEADER out more");
    EXPECT_FALSE(Exists("out"));
    EXPECT_FALSE(Exists("more"));
    ASSERT_TRUE(Exists("-APPEND"));
    EXPECT_TRUE(HasBanner(Read("-APPEND")));
    Write("-APPEND -NOHEADER out more words here");
    EXPECT_TRUE(HasBanner(Read("-APPEND")));
    EXPECT_FALSE(Exists("out"));
}

TEST_P(WriteCommands, OfThreeWordsTheThirdIsTheFileName) {
    Write("-NOHEADER");
    ASSERT_TRUE(Exists("-NOHEADER"));
    EXPECT_TRUE(HasBanner(Read("-NOHEADER")));
    Write("-APPEND \"\"");
    EXPECT_TRUE(Exists("-APPEND"));
}

TEST_P(WriteCommands, AFileNameMayHoldBlanks) {
    Write("-NOHEADER \"a file\"");
    EXPECT_TRUE(Exists("a file"));
}

TEST_P(WriteCommands, EveryWriteSetsTheHeaderFlagAnew) {
    Write("-NOHEADER out");
    EXPECT_FALSE(script_.GetOptions().writeHeader);
    Write("out");
    EXPECT_TRUE(script_.GetOptions().writeHeader);
    EXPECT_TRUE(HasBanner(Read("out")));
    script_.GetOptions().writeHeader = false;
    Write("out");
    EXPECT_TRUE(HasBanner(Read("out")));
}

TEST_P(WriteCommands, AFileThatCannotBeOpenedIsNoFailureOfTheCommand) {
    const int done = script_.GetDoneCount();
    Write("missing/out");
    EXPECT_EQ(script_.GetDoneCount(), done + 1);
    EXPECT_EQ(script_.GetModel().GetWriteError(), ENOENT);
    EXPECT_EQ(script_.GetModel().GetWrittenFileName(), "missing/out");
    Write(".");
    EXPECT_NE(script_.GetModel().GetWriteError(), 0);
    Write("out");
    EXPECT_EQ(script_.GetModel().GetWriteError(), 0);
    EXPECT_EQ(script_.GetModel().GetWrittenFileName(), "out");
}

TEST_P(WriteCommands, AFileThatCannotBeOpenedStillPreparesTheModel) {
    script_.Run("ADD COMPONENT BUF\nADD PIN BUF I Input\nADD PIN BUF O Output\n"
                "ADD PORT Y Output\nADD INSTANCE BUF U1\nADD INSTANCE BUF U2\n"
                "CONNECT SIGNAL Y U1.O\nCONNECT SIGNAL Y U2.I");
    Write("missing/out");
    EXPECT_NE(script_.GetModel().GetSignal("Y_DUMMY"), nullptr);
}

TEST_P(WriteCommands, AFullDiskIsRecorded) {
    if (!std::filesystem::exists("/dev/full")) {
        GTEST_SKIP() << "no /dev/full";
    }
    Write("/dev/full");
    EXPECT_EQ(script_.GetModel().GetWriteError(), ENOSPC);
}

TEST_P(WriteCommands, ALegalNetlistIsWrittenWhereTheOptionsAskForIt) {
    script_.Run("ADD PORT begin Input");
    script_.GetOptions().legal = true;
    Write("legal");
    EXPECT_NE(Read("legal").find("begin_"), std::string::npos);
    script_.GetOptions().legal = false;
    Write("literal");
    EXPECT_EQ(Read("literal").find("begin_"), std::string::npos);
}

TEST_P(WriteCommands, TheFileIsClosedWhenTheCommandEnds) {
    Write("out");
    const int before = Support::CountOpenFiles();
    for (int i = 0; i < 10; ++i) {
        Write("out");
        Write("-APPEND out");
        Write("missing/out");
    }
    EXPECT_EQ(Support::CountOpenFiles(), before);
}

TEST_P(WriteCommands, ReplayedFromAFileTheyAreCarriedOutAsTheyCome) {
    const std::string write = std::string("WRITE ") + GetParam() + " -NOHEADER ";
    Support::WriteWholeFile("design.cmd",
                            write + "first\nADD PORT SecondPort Input\n" + write + "second\n");
    EXPECT_TRUE(script_.GetEngine().ReadCommandFile("top", "design.cmd"));
    EXPECT_NE(Read("first"), "");
    EXPECT_EQ(Read("first").find("SecondPort"), std::string::npos);
    EXPECT_NE(Read("second").find("SecondPort"), std::string::npos);
}

INSTANTIATE_TEST_SUITE_P(Languages, WriteCommands, testing::Values("VERILOG", "VHDL"));
