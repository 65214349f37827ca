// For every file call that can fail in a run: nothing is thrown, the failure is reported, and no
// file is incomplete.
#include "Port/File.h"
#include "Robustness/FailingSystem.h"
#include "Robustness/MidSizedDesign.h"
#include "Support/EngineScript.h"
#include "Support/TemporaryFolder.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cerrno>
#include <cstdint>
#include <map>
#include <string>

namespace {

using Robustness::FailingSystem;
using Support::ReadWholeFile;
using Support::WriteWholeFile;

const std::string Former = "what stood here before\n";

/// What became of one run.
struct Outcome {
    bool isRead = false;
    std::map<std::string, int> errors;
    std::map<std::string, std::uint64_t> leftovers;
    std::map<std::string, std::string> texts;
};

class Faults : public testing::Test {
protected:
    Faults() {
        WriteWholeFile(folder_ / "design.cmd", Robustness::MidSizedDesign());
        FailingSystem none(0, 0);
        expected_ = Run();
        calls_ = none.GetCallCount();
    }

    /// Reads the design and writes it in both languages, and once behind a file's text.
    Outcome Run() {
        Outcome outcome;
        const int openFiles = Support::CountOpenFiles();
        Orn_Hdl::Engine engine;
        outcome.isRead = engine.ReadCommandFile("top", (folder_ / "design.cmd").c_str());
        engine.UseModel("top");
        // The file names the model after its first line.
        const std::string model = engine.GetModel("design") != nullptr ? "design" : "top";
        for (const char* words : {"VERILOG replaced", "VHDL fresh", "VERILOG -APPEND longer"}) {
            const std::string line(words);
            const std::size_t blank = line.rfind(' ');
            const std::string name = line.substr(blank + 1);
            const std::string path = folder_ / name.c_str();
            std::filesystem::remove(path);
            if (name != "fresh") {
                WriteWholeFile(path, Former);
            }
            engine.Execute(model.c_str(),
                           ("WRITE " + line.substr(0, blank) + " -NOHEADER " + path).c_str());
            outcome.errors[name] = engine.GetModel(model.c_str())->GetWriteError();
            outcome.leftovers[name] = engine.GetModel(model.c_str())->GetWriteLeftover();
            outcome.texts[name] = ReadWholeFile(path);
        }
        EXPECT_EQ(Support::CountOpenFiles(), openFiles);
        return outcome;
    }

    void CheckFiles(const Outcome& outcome, int error, bool designIsWhole) {
        for (const auto& [name, text] : outcome.texts) {
            const int told = outcome.errors.at(name);
            EXPECT_TRUE(told == 0 || told == error) << told;
            if (told == 0 && designIsWhole) {
                EXPECT_EQ(text, expected_.texts.at(name));
            } else if (told != 0 && name == "replaced") {
                EXPECT_EQ(text, Former);
            } else if (told != 0 && name == "fresh") {
                EXPECT_EQ(text, "");
                EXPECT_FALSE(std::filesystem::exists(folder_ / "fresh"));
            } else if (told != 0) {
                EXPECT_EQ(text.substr(0, Former.size()), Former);
                EXPECT_EQ(text.size(), Former.size() + outcome.leftovers.at(name));
            }
        }
        for (const auto& entry : std::filesystem::directory_iterator(folder_.GetPath())) {
            const std::string name = entry.path().filename().string();
            EXPECT_TRUE(name == "design.cmd" || outcome.texts.count(name) == 1) << name;
        }
    }

    Support::TemporaryFolder folder_;
    Outcome expected_;
    int calls_ = 0;
};

TEST_F(Faults, WithoutAnyAllIsWell) {
    EXPECT_TRUE(expected_.isRead);
    for (const auto& [name, error] : expected_.errors) {
        EXPECT_EQ(error, 0) << name;
        EXPECT_NE(expected_.texts.at(name), "");
    }
    // Reading: open, status, read, read, close. Each replacing write: link, open, ..., rename.
    EXPECT_GT(calls_, 20);
}

TEST_F(Faults, AnyOneCallMayFail) {
    for (const int error : {EIO, ENOSPC}) {
        for (int failing = 1; failing <= calls_; ++failing) {
            SCOPED_TRACE("call " + std::to_string(failing));
            FailingSystem system(failing, error);
            const Outcome outcome = Run();
            int told = 0;
            for (const auto& [name, writeError] : outcome.errors) {
                told += writeError != 0 ? 1 : 0;
            }
            EXPECT_LE(told, 1) << "one failure fails one write";
            EXPECT_EQ(outcome.leftovers.at("longer"), 0u) << "one failure leaves nothing behind";
            CheckFiles(outcome, error, outcome.isRead);
        }
    }
}

TEST_F(Faults, EveryCallFromOneOnMayFail) {
    for (int failing = 1; failing <= calls_; ++failing) {
        SCOPED_TRACE("call " + std::to_string(failing));
        FailingSystem system(failing, ENOSPC, FailingSystem::FromThenOn);
        const Outcome outcome = Run();
        EXPECT_TRUE(!outcome.isRead || outcome.errors.at("longer") == ENOSPC);
        CheckFiles(outcome, ENOSPC, outcome.isRead);
    }
}

/// Calls that are interrupted by a signal every other time, and writes that take seven bytes at
/// most.
class InterruptedSystem : public Port::System {
public:
    InterruptedSystem() { System::Replace(this); }
    InterruptedSystem(const InterruptedSystem&) = delete;
    InterruptedSystem& operator=(const InterruptedSystem&) = delete;
    ~InterruptedSystem() override { System::Replace(nullptr); }

    int Open(const char* name, int flags, unsigned mode) override {
        return IsInterrupted() ? -1 : System::Open(name, flags, mode);
    }
    ssize_t Read(int descriptor, void* buffer, std::size_t size) override {
        return IsInterrupted() ? -1 : System::Read(descriptor, buffer, std::min(size, Piece));
    }
    ssize_t Write(int descriptor, const void* data, std::size_t size) override {
        return IsInterrupted() ? -1 : System::Write(descriptor, data, std::min(size, Piece));
    }
    int Close(int descriptor) override {
        const int result = System::Close(descriptor);
        return IsInterrupted() ? -1 : result;
    }

private:
    static constexpr std::size_t Piece = 7;

    bool IsInterrupted() noexcept {
        errno = EINTR;
        return ++calls_ % 2 == 1;
    }

    int calls_ = 0;
};

/// Writes that take nothing and tell no error, a hundred times; then they fail.
class IdleSystem : public Port::System {
public:
    IdleSystem() { System::Replace(this); }
    IdleSystem(const IdleSystem&) = delete;
    IdleSystem& operator=(const IdleSystem&) = delete;
    ~IdleSystem() override { System::Replace(nullptr); }

    ssize_t Write(int /*descriptor*/, const void* /*data*/, std::size_t /*size*/) override {
        errno = ENOSPC;
        return ++writes > 100 ? -1 : 0;
    }

    int writes = 0;
};

TEST_F(Faults, AWriteThatTakesNothingIsAFailureAndNotTriedAgain) {
    const std::string name = folder_ / "file";
    IdleSystem system;
    Port::File file;
    ASSERT_TRUE(file.open(name.c_str(), Port::File::Overwrite, true));
    EXPECT_FALSE(file.write("text", 4));
    EXPECT_EQ(system.writes, 1);
    EXPECT_EQ(file.GetError(), EIO);
    EXPECT_FALSE(file.close());
}

TEST_F(Faults, InterruptedAndPartialCallsAreNoFailures) {
    InterruptedSystem system;
    const Outcome outcome = Run();
    EXPECT_TRUE(outcome.isRead);
    EXPECT_EQ(outcome.errors, expected_.errors);
    EXPECT_EQ(outcome.texts, expected_.texts);
}

} // namespace
