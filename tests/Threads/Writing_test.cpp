// Netlists are the same to the byte whatever the number of threads that write them.
#include "Robustness/FailingSystem.h"
#include "Robustness/MidSizedDesign.h"
#include "Support/EngineScript.h"
#include "Support/Environment.h"
#include "Support/TemporaryFolder.h"
#include "Writers/ItemWriter.h"

#include <gtest/gtest.h>

#include <atomic>
#include <filesystem>
#include <functional>
#include <memory>
#include <new>
#include <random>
#include <string>
#include <thread>
#include <vector>

namespace {

using Orn_Hdl::HdlOptions;
using Orn_Hdl::Language;
using Orn_Hdl::OutStream;
using Orn_Hdl::TextFileOutStream;
using Orn_Hdl::TextMemOutStream;
using Orn_Hdl::Writers::GetRangeSizes;
using Orn_Hdl::Writers::ItemWriter;
using Orn_Hdl::Writers::RangeSizes;

constexpr unsigned Threads[] = {2, 3, 8};

/// Cuts lists into small ranges for a while.
class SmallRanges {
public:
    SmallRanges(std::size_t items, std::size_t memory) : former_(GetRangeSizes()) {
        GetRangeSizes() = {items, 1, memory};
    }
    SmallRanges(const SmallRanges&) = delete;
    SmallRanges& operator=(const SmallRanges&) = delete;
    ~SmallRanges() { GetRangeSizes() = former_; }

private:
    const RangeSizes former_;
};

/// Calls `check` with ranges of several sizes and little or much memory for their texts.
template <class Check> void WithSmallRanges(const Check& check) {
    for (const std::size_t items : {1U, 2U, 7U}) {
        for (const std::size_t memory : {0U, 1U << 11U, 1U << 20U}) {
            SCOPED_TRACE(std::to_string(items) + " items, " + std::to_string(memory) + " bytes");
            const SmallRanges ranges(items, memory);
            check();
        }
    }
}

/// A destination of a program's own, which counts the pieces that it gets.
class OwnDst : public Orn_Hdl::StreamDst {
public:
    explicit OwnDst(std::string& text) : text_(text) {}
    void Write(const char* text) override { text_.append(text == nullptr ? "" : text) += '|'; }
    void Write(int number) override { text_.append(std::to_string(number)) += '|'; }

private:
    std::string& text_;
};

/// What a model gives in a language, in all kinds of streams.
std::string WriteAll(Orn_Hdl::Model& model, Language language, unsigned threads,
                     const std::string& file) {
    model.GetOptions()->threads = threads;
    std::string own;
    TextMemOutStream memory("before it ");
    OutStream owned(new OwnDst(own));
    TextFileOutStream written(file, TextFileOutStream::Replace);
    for (OutStream* out : std::initializer_list<OutStream*>{&memory, &owned, &written}) {
        // A stream may be indented, and stand within a line.
        out->Indent();
        *out << "begun ";
        if (language == Language::Verilog) {
            Orn_Hdl::VerilogNetlister(*out).WriteNetlist(model.GetNetlist(), *model.GetOptions());
        } else {
            Orn_Hdl::VhdlNetlister(*out).WriteNetlist(model.GetNetlist(), model.GetOptions());
        }
    }
    written.Close();
    return std::string(memory.GetValue().GetView()) + own + Support::ReadWholeFile(file);
}

/// Every option that shows in instances.
std::vector<std::function<void(HdlOptions&)>> GetVariants() {
    std::vector<std::function<void(HdlOptions&)>> variants = {
        [](HdlOptions&) {}, [](HdlOptions& options) { options.onePortPerLine = false; },
        [](HdlOptions& options) { options.vhdl.useAttrType = true; }};
    for (int type = HdlOptions::VerilogOption::EXEMPLAR;
         type <= HdlOptions::VerilogOption::PRECISION; ++type) {
        variants.emplace_back(
            [type](HdlOptions& options) { options.verilog.synthesisType = type; });
    }
    return variants;
}

class ThreadedWriting : public testing::Test {
protected:
    /// Checks that all numbers of threads write the same.
    void Check(const std::string& lines) {
        Support::EngineScript script;
        for (const std::string& line : Support::SplitLines(lines)) {
            if (line.find("WRITE") == std::string::npos) {
                script.GetFailure(line);
            }
        }
        Check(script.GetModel());
    }

    void Check(Orn_Hdl::Model& model) {
        const std::string file = folder_ / "netlist";
        for (const Language language : Orn_Hdl::Languages) {
            // The first writes make dummy signals.
            WriteAll(model, language, 1, file);
            WriteAll(model, language, 1, file);
            const std::string expected = WriteAll(model, language, 1, file);
            ASSERT_NE(expected, "");
            for (const unsigned threads : Threads) {
                EXPECT_TRUE(WriteAll(model, language, threads, file) == expected) << threads;
            }
        }
    }

    const Support::TemporaryFolder folder_;
    const Support::EnvironmentVariable time_{"SOURCE_DATE_EPOCH", "1000000000"};
};

TEST_F(ThreadedWriting, GivesTheSameNetlistsOfAllKindsOfDesigns) {
    const SmallRanges ranges(1, 1 << 12);
    int designs = 0;
    for (const auto& entry : std::filesystem::directory_iterator(ORN_HDL_TEST_DATA "/golden")) {
        if (entry.path().extension() == ".cmd") {
            SCOPED_TRACE(entry.path().string());
            Check(Support::ReadWholeFile(entry.path().string()));
            ++designs;
        }
    }
    EXPECT_GT(designs, 10);
}

TEST_F(ThreadedWriting, GivesTheSameNetlistsWhateverTheOptions) {
    for (const auto& set : GetVariants()) {
        const SmallRanges ranges(3, 1 << 16);
        // The name has the mark by which INIT is passed on to instances.
        Support::EngineScript script(Robustness::MidSizedDesign() +
                                     "SET NETLIST NAME MHALVEX1\n"
                                     "ADD MODULE ATTRIBUTE -TYPE=BitVector INIT 8:H:01\n"
                                     "SET MODULE ATTRIBUTE OPTION INIT -GENERIC=SYN\n");
        set(script.GetOptions());
        Check(script.GetModel());
    }
}

TEST_F(ThreadedWriting, GivesTheSameNetlistsWhateverTheRanges) {
    WithSmallRanges([this] { Check(Robustness::MidSizedDesign()); });
}

/// A design with names that are reserved words.
std::string DesignToMend() {
    std::string lines = "ADD COMPONENT INV\nADD PIN INV I input\nADD PIN INV O output\n"
                        "ADD PORT in input\nADD PORT out output\n";
    std::string before = "in";
    for (const std::string name : {"begin", "entity", "a__b", "u1", "u2", "wire", "is", "last"}) {
        const std::string net = name == "last" ? "out" : "net_" + name;
        lines += "ADD INSTANCE INV " + name + "\nCONNECT SIGNAL " + before + " " + name +
                 ".I\nCONNECT SIGNAL " + net + " " + name + ".O\n";
        before = net;
    }
    return lines;
}

TEST_F(ThreadedWriting, GivesTheSameLegalAndVerifiedNetlists) {
    const SmallRanges ranges(2, 1 << 12);
    Support::EngineScript script(DesignToMend());
    script.GetOptions().legal = true;
    Check(script.GetModel());
    script.GetOptions().verify = true;
    for (const char* words : {"VERILOG", "VHDL"}) {
        std::string texts[2];
        for (const unsigned threads : {1U, 3U}) {
            script.GetOptions().threads = threads;
            const std::string file = folder_ / words;
            script.Run(std::string("WRITE ") + words + " -NOHEADER " + file);
            texts[threads / 3] = Support::ReadWholeFile(file);
        }
        EXPECT_NE(texts[0], "");
        EXPECT_EQ(texts[0], texts[1]);
    }
}

/// A design in which names, lists of pins, comments and attributes are of all lengths.
std::string RandomDesign(unsigned seed) {
    std::mt19937 random(seed);
    const auto draw = [&random](unsigned below) { return static_cast<unsigned>(random() % below); };
    const auto word = [&](unsigned number) {
        return "n" + std::string(draw(10) == 0 ? draw(200) : draw(12), 'x') +
               std::to_string(number);
    };
    std::string lines = "ADD PORT a(31:0) input\nADD PORT y(0:31) output\n";
    for (unsigned i = 0; i < 4; ++i) {
        const std::string name = "C" + std::to_string(i);
        lines += "ADD COMPONENT " + name + "\n";
        for (unsigned pin = 0; pin < 1 + draw(20); ++pin) {
            lines += "ADD PIN " + name + " p" + std::to_string(pin) +
                     (draw(2) == 0 ? " input\n" : "(3:0) input\n");
        }
        lines += "ADD COMPONENT COMMENT " + name + " \"a comment\"\nADD COMPONENT ATTRIBUTE " +
                 name + " INIT 1:B:1\n";
    }
    for (unsigned i = 0; i < 60; ++i) {
        const std::string name = "u" + word(i);
        lines += "ADD INSTANCE C" + std::to_string(draw(4)) + " " + name + "\n";
        for (unsigned pin = 0; pin < draw(20); ++pin) {
            const std::string bit = std::to_string(draw(29));
            const std::vector<std::string> nets = {
                word(draw(50)), "a(" + bit + ")",
                "a(" + std::to_string(draw(29) + 3) + ":" + bit + ")",
                "y(" + bit + ")," + word(draw(50)) + ",a(" + bit + ")"};
            lines +=
                "CONNECT SIGNAL " + nets[draw(4)] + " " + name + ".p" + std::to_string(pin) + "\n";
        }
        if (draw(3) == 0) {
            lines += "ADD INSTANCE COMMENT " + name + " \"" + std::string(draw(300), '-') + "\"\n";
        }
        if (draw(3) == 0) {
            lines += "ADD INSTANCE ATTRIBUTE " + name + " " + word(i) + " \"" +
                     std::string(draw(300), ' ') + "\"\nSET INSTANCE ATTRIBUTE OPTION " + name +
                     " INIT " +
                     (draw(2) == 0 ? "-GENERIC=SYN\n" : "-GENERIC=NOSYN -SYNATTR=ASSIGN\n");
        }
    }
    return lines;
}

TEST_F(ThreadedWriting, GivesTheSameNetlistsOfRandomDesigns) {
    for (unsigned seed = 1; seed <= 15; ++seed) {
        SCOPED_TRACE(seed);
        const SmallRanges ranges(1 + seed % 5, std::size_t(64) << seed);
        Check(RandomDesign(seed));
    }
}

TEST_F(ThreadedWriting, LeavesTheFormerFileIfAWriteFails) {
    const SmallRanges ranges(2, 1 << 14);
    const std::string file = folder_ / "netlist";
    const std::string command = "WRITE VERILOG -NOHEADER " + file;
    Support::EngineScript script(Robustness::MidSizedDesign());
    // The first writes make dummy signals.
    script.Run(command + "\n" + command + "\n" + command);
    const std::string expected = Support::ReadWholeFile(file);
    script.GetOptions().threads = 3;
    int calls = 0;
    for (int failing = 1;; ++failing) {
        Support::WriteWholeFile(file, "former");
        int error = 0;
        {
            Robustness::FailingSystem system(failing, ENOSPC,
                                             Robustness::FailingSystem::FromThenOn);
            script.Run(command);
            error = script.GetModel().GetWriteError();
            calls = system.GetCallCount();
        }
        EXPECT_EQ(Support::ReadWholeFile(file), error == 0 ? expected : "former") << failing;
        if (failing > calls) {
            EXPECT_EQ(error, 0);
            break;
        }
        EXPECT_EQ(error, ENOSPC);
    }
    EXPECT_GT(calls, 5);
}

/// Items of random texts, which need not end with a line.
class RandomItems : public ItemWriter {
public:
    RandomItems(OutStream& out, bool endsLines) : out_(out), endsLines_(endsLines) {}

    void GoTo(std::size_t item) override { item_ = item; }
    void WriteNext() override {
        std::mt19937 random(static_cast<unsigned>(item_++));
        out_.Indent();
        for (std::size_t piece = random() % 30; piece > 0; --piece) {
            const std::string_view texts[] = {"word", ", ", " ",  "\"",
                                              "--",   "(",  "\n", "end\nbegin"};
            out_ << texts[random() % 8] << static_cast<int>(random() % 100);
        }
        out_.Unindent();
        if (endsLines_ || random() % 4 != 0) {
            out_ << OutStream::NewLine;
        }
    }

private:
    OutStream& out_;
    const bool endsLines_;
    std::size_t item_ = 0;
};

TEST_F(ThreadedWriting, ItemsMayEndWithinLines) {
    const std::string file = folder_ / "items";
    const auto write = [&](unsigned threads, bool endsLines) {
        TextFileOutStream out(file, TextFileOutStream::Overwrite);
        out.Indent();
        out << "in the line ";
        Orn_Hdl::Writers::WriteItems(out, 500, threads, [endsLines](OutStream& stream) {
            return std::make_unique<RandomItems>(stream, endsLines);
        });
        out << "the rest";
        out.Close();
        return Support::ReadWholeFile(file);
    };
    for (const bool endsLines : {false, true}) {
        const std::string expected = write(1, endsLines);
        ASSERT_GT(expected.size(), 10000U);
        WithSmallRanges([&] {
            for (const unsigned threads : Threads) {
                EXPECT_TRUE(write(threads, endsLines) == expected) << threads;
            }
        });
    }
}

/// Counts the items that are written, and calls a function for each.
class CountedItems : public ItemWriter {
public:
    CountedItems(OutStream& out, std::function<void(std::size_t)> look)
        : out_(out), look_(std::move(look)) {}

    void GoTo(std::size_t item) override { item_ = item; }
    void WriteNext() override {
        look_(item_++);
        out_ << "item" << OutStream::NewLine;
    }

private:
    OutStream& out_;
    const std::function<void(std::size_t)> look_;
    std::size_t item_ = 0;
};

TEST_F(ThreadedWriting, EndsWhenAWriteHasFailed) {
    const SmallRanges ranges(10, 1 << 16);
    std::atomic<std::size_t> count = 0;
    TextFileOutStream out("/dev/full", TextFileOutStream::Overwrite);
    Orn_Hdl::Writers::WriteItems(out, 10000, 3, [&count](OutStream& stream) {
        return std::make_unique<CountedItems>(stream, [&count](std::size_t) { ++count; });
    });
    EXPECT_LT(count, 1000U);
    EXPECT_EQ(out.GetError(), ENOSPC);
}

TEST_F(ThreadedWriting, AnExceptionComesToTheCallerAfterTheTextBeforeIt) {
    const SmallRanges ranges(5, 1 << 16);
    TextMemOutStream out;
    EXPECT_THROW(Orn_Hdl::Writers::WriteItems(out, 1000, 3,
                                              [](OutStream& stream) {
                                                  return std::make_unique<CountedItems>(
                                                      stream, [](std::size_t item) {
                                                          if (item == 502) {
                                                              throw std::bad_alloc();
                                                          }
                                                      });
                                              }),
                 std::bad_alloc);
    EXPECT_EQ(out.GetValue().GetLength(), 5U * 500);
}

TEST_F(ThreadedWriting, ASmallDesignHasOneThread) {
    TextMemOutStream out;
    const std::thread::id caller = std::this_thread::get_id();
    Orn_Hdl::Writers::WriteItems(out, 4000, 8, [caller](OutStream& stream) {
        return std::make_unique<CountedItems>(
            stream, [caller](std::size_t) { EXPECT_EQ(std::this_thread::get_id(), caller); });
    });
    EXPECT_EQ(out.GetValue().GetLength(), 5U * 4000);
}

} // namespace
