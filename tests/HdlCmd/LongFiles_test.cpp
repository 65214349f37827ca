// Command files that are long enough to be split in a thread of the reader's own: with one thread
// and with two, all that a caller can see is the same.
#include "Orn_Hdl/Orn_Hdl.h"
#include "Port/System.h"
#include "Support/EngineScript.h"
#include "Support/TemporaryFolder.h"

#include <gtest/gtest.h>
#include <rapidcheck/gtest.h>

#include <algorithm>
#include <atomic>
#include <cerrno>
#include <cstdint>
#include <fcntl.h>
#include <filesystem>
#include <memory>
#include <string>
#include <string_view>
#include <sys/stat.h>
#include <thread>
#include <unistd.h>
#include <vector>

using namespace Orn_Hdl;

namespace {

/// More than a reader takes in at a time.
constexpr std::size_t LongSize = 300000;

/// Lines without a word, as many bytes as make a file long.
std::string Padding() {
    std::string text;
    while (text.size() < LongSize) {
        text += std::string(9999, ' ') + '\n';
    }
    return text;
}

/// Different numbers of words and characters, numbered, at least `size` bytes.
std::string NumberedLines(std::size_t size) {
    std::string text;
    for (int i = 0; text.size() < size; ++i) {
        text += "LINE " + std::to_string(i);
        for (int word = 0; word < i % 5; ++word) {
            text += ' ' + std::string(static_cast<std::size_t>(i % 60), 'x');
        }
        text += i % 7 == 0 ? "\r\n" : "\n";
    }
    return text;
}

/// Reading fails with the call of this number, from 1.
class FailingRead : public Port::System {
public:
    explicit FailingRead(int call) : left_(call) { Replace(this); }
    FailingRead(const FailingRead&) = delete;
    FailingRead& operator=(const FailingRead&) = delete;
    ~FailingRead() override { Replace(nullptr); }

    ssize_t Read(int descriptor, void* buffer, std::size_t size) override {
        if (--left_ == 0) {
            errno = EIO;
            return -1;
        }
        return System::Read(descriptor, buffer, size);
    }

private:
    std::atomic<int> left_;
};

class LongFiles : public testing::Test {
protected:
    /// What `Next` gives, one line each, with the position and the error behind it.
    std::string Read(unsigned threads, const std::string& name) {
        model_.GetOptions()->threads = threads;
        CommandReader reader(model_);
        EXPECT_TRUE(reader.Open(name.c_str()));
        std::string told;
        const auto tell = [&](const char* what) {
            told += what + std::to_string(reader.GetPosition()) + ' ' +
                    std::to_string(reader.GetError()) + '\n';
        };
        tell("begin ");
        while (const StringArray* words = reader.Next()) {
            for (const std::string_view word : *words) {
                told.append(word).append(1, '|');
            }
            tell("");
        }
        tell("end ");
        EXPECT_EQ(reader.Next(), nullptr);
        return told;
    }

    /// What is told of a file in which no thread fails, the same for any number of threads.
    std::string Read(std::string_view text) {
        Support::WriteWholeFile(name_, text);
        const std::string told = Read(1, name_);
        EXPECT_TRUE(Read(2, name_) == told);
        EXPECT_TRUE(Read(8, name_) == told);
        return told;
    }

    Support::TemporaryFolder folder_;
    const std::string name_ = folder_ / "lines.cmd";
    CommandFactory factory_;
    Model model_{&factory_};
};

} // namespace

TEST_F(LongFiles, TellTheSameWithAnyNumberOfThreads) {
    const std::string text = NumberedLines(4 * LongSize);
    const std::string told = Read(text);
    EXPECT_NE(told.find("LINE|0|8 0\nLINE|1|x|"), std::string::npos);
    EXPECT_NE(told.find("\nend " + std::to_string(text.size()) + " 0\n"), std::string::npos);
}

TEST_F(LongFiles, MayEndAnyhow) {
    for (const std::string& end :
         {std::string(), std::string("LAST"), std::string("\r"), std::string("\n\n"),
          std::string("a\0b\nc\0", 6), std::string(LongSize, 'z'),
          "ADD " + std::string(LongSize, ' ')}) {
        Read(NumberedLines(2 * LongSize) + end);
    }
}

TEST_F(LongFiles, HaveSizesAroundThatOfABuffer) {
    const std::string text = NumberedLines(LongSize);
    for (std::size_t size = (1 << 18) - 2; size < (1 << 18) + 3; ++size) {
        Read(text.substr(0, size));
    }
}

TEST_F(LongFiles, HaveLinesOfMegabytes) {
    std::string text = Padding();
    for (int i = 0; i < 30; ++i) {
        text += "NOOP " + std::string(i % 7 == 3 ? 2000000 : 30, static_cast<char>('a' + i % 26));
        text += '\n';
    }
    const std::string told = Read(text);
    EXPECT_EQ(std::count(told.begin(), told.end(), '|'), 60);
}

TEST_F(LongFiles, AFailureComesBehindTheLinesThatWereRead) {
    Support::WriteWholeFile(name_, NumberedLines(8 * LongSize));
    for (int call = 1; call < 6; ++call) {
        std::string told[2];
        for (const unsigned threads : {1U, 2U}) {
            const FailingRead failing(call);
            told[threads - 1] = Read(threads, name_);
        }
        EXPECT_TRUE(told[0] == told[1]) << call;
        EXPECT_NE(told[1].find(' ' + std::to_string(EIO) + '\n'), std::string::npos);
        // Only the end tells it.
        EXPECT_EQ(told[1].find(' ' + std::to_string(EIO) + '\n'), told[1].rfind(' ')) << call;
    }
}

TEST_F(LongFiles, MayBeLeftAtAnyLine) {
    Support::WriteWholeFile(name_, NumberedLines(4 * LongSize));
    const std::string other = folder_ / "other.cmd";
    Support::WriteWholeFile(other, NumberedLines(2 * LongSize));
    model_.GetOptions()->threads = 2;
    CommandReader reader(model_);
    for (int count = 1; count < 20000; count = count * 3 + 1) {
        ASSERT_TRUE(reader.Open(name_.c_str()));
        for (int i = 0; i < count; ++i) {
            ASSERT_NE(reader.Next(), nullptr);
        }
        ASSERT_TRUE(reader.Open(other.c_str()));
        EXPECT_EQ(reader.GetPosition(), 0U);
        const StringArray* const words = reader.Next();
        ASSERT_NE(words, nullptr);
        EXPECT_EQ(words->GetView(1), "0");
        CommandReader unfinished(model_);
        ASSERT_TRUE(unfinished.Open(name_.c_str()));
        for (int i = 0; i < count; ++i) {
            ASSERT_NE(unfinished.Next(), nullptr);
        }
    }
}

TEST_F(LongFiles, ThatBecomeShorterEnd) {
    model_.GetOptions()->threads = 2;
    Support::WriteWholeFile(name_, NumberedLines(20 * LongSize));
    CommandReader reader(model_);
    ASSERT_TRUE(reader.Open(name_.c_str()));
    ASSERT_NE(reader.Next(), nullptr);
    std::filesystem::resize_file(name_, 0);
    while (reader.Next() != nullptr) {
    }
    EXPECT_EQ(reader.GetError(), 0);
    EXPECT_LT(reader.GetPosition(), 20 * LongSize);
}

TEST_F(LongFiles, OfOtherKindsAreReadAsTheyCome) {
    // A pipe may have more than a buffer at a time, and then nothing for a long time.
    ASSERT_EQ(mkfifo(name_.c_str(), 0600), 0);
    model_.GetOptions()->threads = 2;
    const int writer = open(name_.c_str(), O_RDWR | O_CLOEXEC);
    ASSERT_GE(writer, 0);
    CommandReader reader(model_);
    ASSERT_TRUE(reader.Open(name_.c_str()));
    for (int i = 0; i < 3000; ++i) {
        const std::string line = "LINE " + std::to_string(i) + std::string(200, ' ') + '\n';
        ASSERT_EQ(write(writer, line.data(), line.size()), static_cast<ssize_t>(line.size()));
        const StringArray* const words = reader.Next();
        ASSERT_NE(words, nullptr);
        ASSERT_EQ(words->GetView(1), std::to_string(i));
    }
    close(writer);
    EXPECT_EQ(reader.Next(), nullptr);
}

namespace {

/// What the commands of these tests act on besides their model.
CommandFactory* factoryInUse = nullptr;
std::unique_ptr<Model>* modelToDestroy = nullptr;

/// Does something that a reader might not survive.
class Unusual : public Command {
public:
    explicit Unusual(Model* model) noexcept : Command(model) {}
    bool Parse(const StringArray& tokens) override {
        what_ = std::string(tokens.GetView(1));
        return true;
    }
    void Execute() override {
        if (what_ == "within") {
            GetModel()->Execute(StringArray("ADD SIGNAL within", " ", true, nullptr));
        } else if (what_ == "register") {
            factoryInUse->AddCommandCreator(
                "LATER WORDS",
                [](Model* model, const StringArray&) -> Command* { return new Unusual(model); });
        } else if (what_ == "destroy") {
            modelToDestroy->reset();
        }
    }
    const char* GetName() const override { return "UNUSUAL"; }

private:
    std::string what_;
};

Command* MakeUnusual(Model* model, const StringArray& /*tokens*/) {
    return new Unusual(model);
}

} // namespace

TEST_F(LongFiles, ACommandMayDoAnything) {
    for (const unsigned threads : {1U, 2U}) {
        CommandFactory factory;
        factoryInUse = &factory;
        factory.AddCommandCreator("UNUSUAL", &MakeUnusual);
        std::unique_ptr<Model> model(factory.CreateModel());
        modelToDestroy = &model;
        model->GetOptions()->threads = threads;
        Support::WriteWholeFile(name_, Padding() + Padding() +
                                           "UNUSUAL within\nUNUSUAL register\nLATER WORDS\n" +
                                           "ADD SIGNAL behind\n");
        EXPECT_TRUE(model->Read(name_.c_str()));
        EXPECT_NE(model->GetSignal("within"), nullptr);
        EXPECT_NE(model->GetSignal("behind"), nullptr);
        Support::WriteWholeFile(name_, Padding() + Padding() + "UNUSUAL destroy\n" + Padding());
        EXPECT_TRUE(model->Read(name_.c_str()));
        EXPECT_EQ(model, nullptr);
    }
}

namespace {

rc::Gen<std::string> CommandLines() {
    return rc::gen::element<std::string>(
        "ADD COMPONENT INV", "ADD PIN INV A INPUT", "ADD PIN INV Y OUTPUT", "ADD INSTANCE INV u1",
        "ADD INSTANCE INV u2", "CONNECT SIGNAL n(3) u1.A", "CONNECT SIGNAL n(2:1) u2.Y",
        "CONNECT SIGNAL n u2.A", "ADD PORT n OUTPUT", "ADD SIGNAL \"two words\"", "NONSENSE", "",
        "ADD SIGNAL", "DELETE INSTANCE u1", "ASSIGN CONSTANT k 1:B:1", "ADD NOTES 'a b' c");
}

/// What becomes of a file whose failing lines are passed over: each failure with its position, then
/// the netlist.
std::string ReplayFile(unsigned threads, const std::string& name) {
    Support::EngineScript script;
    script.GetModel().GetOptions()->threads = threads;
    CommandReader reader(script.GetModel());
    EXPECT_TRUE(reader.Open(name.c_str()));
    std::string told;
    while (const StringArray* words = reader.Next()) {
        const std::string failure = Support::FailureOf([&] { script.GetModel().Execute(*words); });
        if (!failure.empty()) {
            told += std::to_string(reader.GetPosition()) + ' ' + failure;
        }
    }
    EXPECT_EQ(reader.GetError(), 0);
    return told + script.Verilog();
}

} // namespace

RC_GTEST_FIXTURE_PROP(LongFiles, LeaveTheSameDesign, ()) {
    const auto lines = *rc::gen::container<std::vector<std::string>>(CommandLines());
    std::string text = Padding();
    for (const std::string& line : lines) {
        text += line + '\n';
    }
    Support::WriteWholeFile(name_, text);
    RC_ASSERT(ReplayFile(1, name_) == ReplayFile(2, name_));
}
