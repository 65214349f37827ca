#include "Orn_Hdl/Orn_Hdl.h"
#include "Support/EngineScript.h"
#include "Support/Environment.h"
#include "Support/TemporaryFolder.h"

#include <gtest/gtest.h>

#include <functional>
#include <memory>
#include <string>
#include <type_traits>
#include <vector>

using namespace Orn_Hdl;
using Support::FailureOf;
using Support::ReadWholeFile;
using Support::SplitLines;
using Support::TemporaryFolder;
using Support::WriteWholeFile;

namespace {

std::string FailureOfLine(Engine& engine, const char* line) {
    return FailureOf([&] { engine.Execute(line); });
}

std::string FailureOfLine(Engine& engine, const char* model, const char* line) {
    return FailureOf([&] { engine.Execute(model, line); });
}

std::string NameOf(const Model* model) {
    return std::string(model->GetName().GetView());
}

} // namespace

// Models

TEST(EngineModels, CreatedModelHasItsNameAndSourceFile) {
    Engine engine;
    EXPECT_TRUE(engine.CreateAndAddModel("Top", "top.src"));
    const Model* model = engine.GetModel("Top");
    ASSERT_NE(model, nullptr);
    EXPECT_EQ(model->GetName(), "Top");
    EXPECT_EQ(model->GetSourceFileName(), "top.src");
    EXPECT_FALSE(model->IsModified());
}

TEST(EngineModels, NullSourceFileIsEmpty) {
    Engine engine;
    EXPECT_TRUE(engine.CreateAndAddModel("Top", nullptr));
    EXPECT_EQ(engine.GetModel("Top")->GetSourceFileName(), "");
}

TEST(EngineModels, NamesIgnoreCase) {
    Engine engine;
    EXPECT_TRUE(engine.CreateAndAddModel("Top", "first"));
    EXPECT_FALSE(engine.CreateAndAddModel("TOP", "second"));
    EXPECT_EQ(NameOf(engine.GetModel("tOp")), "Top");
    EXPECT_EQ(engine.GetModel("top")->GetSourceFileName(), "first");
    EXPECT_TRUE(engine.UseModel("toP"));
    EXPECT_TRUE(engine.RemoveModel("TOP"));
    EXPECT_EQ(engine.GetModel("Top"), nullptr);
}

TEST(EngineModels, NullNameIsTheEmptyName) {
    Engine engine;
    EXPECT_TRUE(engine.CreateAndAddModel(nullptr, ""));
    EXPECT_EQ(engine.GetModel("")->GetName(), "");
    EXPECT_FALSE(engine.CreateAndAddModel(nullptr, ""));
    EXPECT_FALSE(engine.CreateAndAddModel("", ""));
    EXPECT_TRUE(engine.UseModel(nullptr));
    EXPECT_EQ(FailureOfLine(engine, "NOOP"), "");
    EXPECT_TRUE(engine.RemoveModel(nullptr));
    EXPECT_FALSE(engine.RemoveModel(nullptr));
}

TEST(EngineModels, CreatedModelIsNotCurrent) {
    Engine engine;
    engine.CreateAndAddModel("top", "");
    EXPECT_EQ(FailureOfLine(engine, "ADD COMPONENT AND2"), "Missing Model.\n");
    EXPECT_EQ(engine.GetModel("top")->GetComponent("AND2"), nullptr);
}

TEST(EngineModels, UseOfAnUnknownModelKeepsTheCurrentOne) {
    Engine engine;
    engine.CreateAndAddModel("top", "");
    engine.UseModel("top");
    EXPECT_FALSE(engine.UseModel("other"));
    EXPECT_EQ(FailureOfLine(engine, "ADD COMPONENT AND2"), "");
    EXPECT_NE(engine.GetModel("top")->GetComponent("AND2"), nullptr);
}

TEST(EngineModels, RemovalOfTheCurrentModelLeavesNone) {
    Engine engine;
    engine.CreateAndAddModel("a", "");
    engine.CreateAndAddModel("b", "");
    engine.UseModel("a");
    EXPECT_TRUE(engine.RemoveModel("A"));
    EXPECT_EQ(FailureOfLine(engine, "NOOP"), "Missing Model.\n");
    EXPECT_TRUE(engine.UseModel("b"));
    EXPECT_EQ(FailureOfLine(engine, "NOOP"), "");
}

TEST(EngineModels, RemovalOfAnotherModelKeepsTheCurrentOne) {
    Engine engine;
    engine.CreateAndAddModel("a", "");
    engine.CreateAndAddModel("b", "");
    engine.UseModel("b");
    EXPECT_TRUE(engine.RemoveModel("a"));
    EXPECT_EQ(FailureOfLine(engine, "ADD SIGNAL N"), "");
    EXPECT_NE(engine.GetModel("b")->GetSignal("N"), nullptr);
    EXPECT_FALSE(engine.RemoveModel("a"));
}

namespace {

/// What the command "REMOVE" of the tests below does, when it is carried out and when it ends.
std::function<void(Model&)> removal;
std::function<void(Model&)> farewell;
int endedRemovers = 0;

class Remover : public Command {
public:
    using Command::Command;
    ~Remover() override {
        ++endedRemovers;
        if (farewell) {
            farewell(*GetModel());
        }
    }
    bool Parse(const StringArray& /*tokens*/) override { return true; }
    void Execute() override { removal(*GetModel()); }
    const char* GetName() const override { return "REMOVE"; }

    static Command* Create(Model* model, const StringArray& /*tokens*/) {
        return new Remover(model);
    }
};

/// An engine with a model "top" that the command "REMOVE" removes; then it goes on with it.
class RemovalFromWithin : public testing::Test {
protected:
    RemovalFromWithin() {
        engine_.CreateAndAddModel("top", "");
        engine_.UseModel("top");
        engine_.GetModel("top")->GetCommandFactory()->AddCommandCreator("REMOVE", &Remover::Create);
        endedRemovers = 0;
        farewell = nullptr;
        removal = [this](Model& model) {
            EXPECT_TRUE(engine_.RemoveModel("top"));
            EXPECT_EQ(engine_.GetModel("top"), nullptr);
            EXPECT_FALSE(engine_.RemoveModel("top"));
            EXPECT_TRUE(engine_.CreateAndAddModel("top", "another")) << "the name is free";
            model.Execute("ADD SIGNAL N");
            model.SetName("other");
            EXPECT_EQ(engine_.GetModel("other"), nullptr);
            EXPECT_NE(model.GetSignal("N"), nullptr);
        };
    }
    ~RemovalFromWithin() override {
        EXPECT_EQ(endedRemovers, 1) << "the model has ended, with its commands";
        EXPECT_EQ(engine_.GetModel("top")->GetSourceFileName(), "another");
        EXPECT_EQ(FailureOfLine(engine_, "NOOP"), "Missing Model.\n");
        EXPECT_TRUE(engine_.RemoveModel("top"));
    }

    Engine engine_;
};

} // namespace

TEST_F(RemovalFromWithin, OfALine) {
    EXPECT_EQ(FailureOfLine(engine_, "REMOVE"), "");
    EXPECT_EQ(endedRemovers, 1);
}

TEST_F(RemovalFromWithin, OfALineOfTheModel) {
    EXPECT_TRUE(engine_.GetModel("top")->Execute("REMOVE"));
}

TEST_F(RemovalFromWithin, OfWords) {
    EXPECT_TRUE(engine_.GetModel("top")->Execute(StringArray("REMOVE", " ", true, nullptr)));
}

TEST_F(RemovalFromWithin, OfWordsGivenToTheManager) {
    Model* const model = engine_.GetModel("top");
    EXPECT_TRUE(model->GetCommandManager()->CreateAndExecute(
        StringArray("REMOVE", " ", true, nullptr), model, model->GetCommandFactory()));
}

TEST_F(RemovalFromWithin, OfACommandThatFails) {
    removal = [remove = removal](Model& model) {
        remove(model);
        model.Execute("UNKNOWN");
    };
    EXPECT_EQ(FailureOfLine(engine_, "REMOVE"), "Command not find.\n");
}

TEST_F(RemovalFromWithin, OfALineWithinALine) {
    int depth = 0;
    removal = [&depth, remove = removal](Model& model) {
        if (++depth < 3) {
            model.Execute("REMOVE");
            EXPECT_NE(model.GetSignal("N"), nullptr) << "the outer command still has its model";
            EXPECT_EQ(endedRemovers, 0);
        } else {
            remove(model);
        }
    };
    engine_.Execute("REMOVE");
    EXPECT_EQ(endedRemovers, 3);
    endedRemovers -= 2;
}

TEST_F(RemovalFromWithin, OfAModelThatIsUsedOnceMoreWhenItEnds) {
    farewell = [](Model& model) { EXPECT_TRUE(model.Execute("")); };
    engine_.Execute("REMOVE");
}

TEST_F(RemovalFromWithin, OfACommandFile) {
    const TemporaryFolder folder;
    const std::string file = folder / "lines.cmd";
    WriteWholeFile(file, "ADD SIGNAL M\nREMOVE\nCONNECT SIGNAL N M\n");
    EXPECT_TRUE(engine_.ReadCommandFile("top", file.c_str())) << "its other lines are done, too";
}

TEST(EngineModels, AnEngineMayBeDestroyedWithinItsCommand) {
    const TemporaryFolder folder;
    const std::string file = folder / "lines.cmd";
    WriteWholeFile(file, "NOOP\nREMOVE\nUNKNOWN\n");
    std::unique_ptr<Engine> engine;
    removal = [&engine](Model& /*model*/) { engine.reset(); };
    farewell = nullptr;
    const std::function<void()> runs[] = {
        [&] { engine->Execute("REMOVE"); },
        [&] { engine->Execute("top", "REMOVE"); },
        [&] { EXPECT_TRUE(engine->ReadCommandFile("top", file.c_str())); },
    };
    for (const auto& run : runs) {
        endedRemovers = 0;
        engine = std::make_unique<Engine>();
        engine->CreateAndAddModel("top", "");
        engine->UseModel("top");
        engine->GetModel("top")->GetCommandFactory()->AddCommandCreator("REMOVE", &Remover::Create);
        run();
        EXPECT_EQ(engine, nullptr);
        EXPECT_EQ(endedRemovers, 1);
    }
}

TEST(EngineModels, ARenamedModelIsFoundByItsNewName) {
    Engine engine;
    engine.CreateAndAddModel("a", "");
    engine.UseModel("a");
    engine.Execute("SET NETLIST NAME b");
    EXPECT_EQ(engine.GetModel("a"), nullptr);
    EXPECT_NE(engine.GetModel("b"), nullptr);
    EXPECT_TRUE(engine.CreateAndAddModel("a", ""));
    EXPECT_EQ(FailureOfLine(engine, "ADD SIGNAL N"), "");
    EXPECT_NE(engine.GetModel("b")->GetSignal("N"), nullptr);
}

TEST(EngineModels, TheFirstOfTwoModelsOfOneNameIsFound) {
    Engine engine;
    engine.CreateAndAddModel("a", "first");
    engine.CreateAndAddModel("b", "second");
    engine.Execute("b", "SET NETLIST NAME A");
    EXPECT_EQ(engine.GetModel("a")->GetSourceFileName(), "first");
    EXPECT_TRUE(engine.RemoveModel("a"));
    EXPECT_EQ(engine.GetModel("a")->GetSourceFileName(), "second");
}

TEST(EngineModels, AnyWayOfRenamingIsNoticed) {
    Engine engine;
    engine.CreateAndAddModel("a", "first");
    engine.CreateAndAddModel("b", "second");
    Model* const first = engine.GetModel("a");
    Model* const second = engine.GetModel("b");
    second->SetName("C");
    EXPECT_EQ(engine.GetModel("b"), nullptr);
    EXPECT_EQ(engine.GetModel("c"), second);
    first->GetNetlist()->SetName("c");
    EXPECT_EQ(engine.GetModel("C"), first);
    static_cast<Object*>(first->GetNetlist())->SetName("d");
    EXPECT_EQ(engine.GetModel("c"), second);
    second->SetName(nullptr);
    EXPECT_EQ(engine.GetModel("hdl_netlist"), second);
    first->SetName("HDL_NETLIST");
    EXPECT_EQ(engine.GetModel("HDL_netlist"), first);
    EXPECT_TRUE(engine.RemoveModel("hdl_netlist"));
    EXPECT_TRUE(engine.RemoveModel("hdl_netlist"));
    EXPECT_FALSE(engine.RemoveModel("hdl_netlist"));
}

TEST(EngineModels, NamesOfOneHashAreToldApart) {
    // Each letter counts 33 times the next one: B! and AB differ in both, yet weigh the same.
    Engine engine;
    ASSERT_TRUE(engine.CreateAndAddModel("B!", "first"));
    ASSERT_TRUE(engine.CreateAndAddModel("AB", "second"));
    EXPECT_EQ(engine.GetModel("ab")->GetSourceFileName(), "second");
    EXPECT_TRUE(engine.RemoveModel("b!"));
    EXPECT_EQ(engine.GetModel("ab")->GetSourceFileName(), "second");
}

TEST(EngineModels, ModelNamesAreNotNormalised) {
    Engine engine;
    engine.CreateAndAddModel("a[3-0]", "");
    EXPECT_EQ(NameOf(engine.GetModel("a[3-0]")), "a[3-0]");
    EXPECT_EQ(engine.GetModel("a(3:0)"), nullptr);
}

TEST(EngineModels, EnginesAreIndependent) {
    Engine first;
    Engine second;
    first.CreateAndAddModel("top", "");
    EXPECT_EQ(second.GetModel("top"), nullptr);
    EXPECT_EQ(FailureOfLine(second, "top", "NOOP"), "Missing Model.\n");
    EXPECT_TRUE(second.CreateAndAddModel("top", ""));
}

TEST(EngineModels, DestructionDeletesManyModelsWithDesigns) {
    constexpr int Models = 50;
    endedRemovers = 0;
    farewell = nullptr;
    removal = [](Model&) {};
    {
        Engine engine;
        for (int i = 0; i < Models; ++i) {
            const std::string name = "m" + std::to_string(i);
            engine.CreateAndAddModel(name.c_str(), "");
            engine.GetModel(name.c_str())
                ->GetCommandFactory()
                ->AddCommandCreator("REMOVE", &Remover::Create);
            for (const char* line : {"ADD COMPONENT INV", "ADD PIN INV I Input",
                                     "ADD INSTANCE INV U1", "CONNECT SIGNAL N U1.I", "REMOVE"}) {
                engine.Execute(name.c_str(), line);
            }
        }
        EXPECT_EQ(endedRemovers, 0);
    }
    EXPECT_EQ(endedRemovers, Models) << "each model has ended, with the commands that it keeps";
}

TEST(EngineModels, ThreadsAreThoseOfAllModels) {
    Engine engine;
    engine.CreateAndAddModel("first", "");
    EXPECT_EQ(engine.GetThreads(), 1U);
    EXPECT_EQ(engine.GetModel("first")->GetOptions()->threads, 1U);
    engine.SetThreads(3);
    engine.CreateAndAddModel("second", "");
    EXPECT_EQ(engine.GetThreads(), 3U);
    EXPECT_EQ(engine.GetModel("first")->GetOptions()->threads, 3U);
    EXPECT_EQ(engine.GetModel("second")->GetOptions()->threads, 3U);
    const Engine taken(std::move(engine));
    EXPECT_EQ(taken.GetThreads(), 3U);
}

TEST(EngineModels, AnEngineIsNotCopied) {
    EXPECT_FALSE(std::is_copy_constructible_v<Engine>);
    EXPECT_FALSE(std::is_copy_assignable_v<Engine>);
}

// Lines

TEST(EngineExecute, NullLineDoesNothing) {
    Engine engine;
    engine.CreateAndAddModel("top", "");
    engine.UseModel("top");
    EXPECT_EQ(FailureOfLine(engine, nullptr), "");
    EXPECT_EQ(FailureOfLine(engine, ""), "");
    EXPECT_EQ(engine.GetModel("top")->GetCommandManager()->GetDoneCommandCount(), 0);
}

TEST(EngineExecute, WithoutAModelEvenTheEmptyLineFails) {
    Engine engine;
    EXPECT_EQ(FailureOfLine(engine, nullptr), "Missing Model.\n");
    EXPECT_EQ(FailureOfLine(engine, ""), "Missing Model.\n");
    EXPECT_EQ(FailureOfLine(engine, "top", ""), "Missing Model.\n");
    EXPECT_EQ(FailureOfLine(engine, nullptr, nullptr), "Missing Model.\n");
}

TEST(EngineExecute, ANamedModelNeitherUsesNorChangesTheCurrentOne) {
    Engine engine;
    engine.CreateAndAddModel("a", "");
    engine.CreateAndAddModel("b", "");
    engine.UseModel("a");
    engine.Execute("B", "ADD SIGNAL N");
    EXPECT_NE(engine.GetModel("b")->GetSignal("N"), nullptr);
    EXPECT_EQ(engine.GetModel("a")->GetSignal("N"), nullptr);
    engine.Execute("ADD SIGNAL M");
    EXPECT_NE(engine.GetModel("a")->GetSignal("M"), nullptr);
    EXPECT_EQ(engine.GetModel("b")->GetSignal("M"), nullptr);
    EXPECT_EQ(FailureOfLine(engine, "c", "ADD SIGNAL N"), "Missing Model.\n");
}

TEST(EngineExecute, MissingModelTellsItsOrigin) {
    Engine engine;
    try {
        engine.Execute("NOOP");
        FAIL() << "nothing was thrown";
    } catch (const Exception& exception) {
        EXPECT_EQ(exception.GetModule(), "DesignEntry");
        EXPECT_EQ(exception.GetSourceUnit(), "../s/HdlEngine");
        EXPECT_EQ(exception.GetRevision(), "$Revision: 1.5 $");
        EXPECT_GT(exception.GetLine(), 0);
        EXPECT_STREQ(exception.what(), "Missing Model.\n");
        EXPECT_GE(exception.report().GetIndexOfString("Missing Model.\n"), 0);
    }
}

TEST(EngineExecute, TheExceptionOutlivesTheEngine) {
    auto engine = std::make_unique<Engine>();
    engine->CreateAndAddModel("top", "");
    std::unique_ptr<Exception> kept;
    try {
        engine->Execute("top", "ADD INSTANCE NONE U1");
    } catch (const Exception& exception) {
        kept = std::make_unique<Exception>(exception);
    }
    engine.reset();
    ASSERT_NE(kept, nullptr);
    EXPECT_EQ(kept->getLocalized(), "Component \"NONE\" not found.\n");
}

// Command files

class EngineFiles : public testing::Test {
protected:
    std::string Write(const char* name, const std::string& text) {
        const std::string path = folder_ / name;
        WriteWholeFile(path, text);
        return path;
    }

    TemporaryFolder folder_;
    Engine engine_;
};

TEST_F(EngineFiles, ReadingCreatesTheModelAndKeepsTheCurrentOne) {
    const std::string file = Write("design.cmd", "ADD SIGNAL N\n");
    engine_.CreateAndAddModel("other", "");
    engine_.UseModel("other");
    EXPECT_TRUE(engine_.ReadCommandFile("fresh", file.c_str()));
    const Model* model = engine_.GetModel("fresh");
    ASSERT_NE(model, nullptr);
    EXPECT_EQ(model->GetSourceFileName(), file.c_str());
    EXPECT_NE(model->GetSignal("N"), nullptr);
    engine_.Execute("ADD SIGNAL M");
    EXPECT_NE(engine_.GetModel("other")->GetSignal("M"), nullptr);
}

TEST_F(EngineFiles, ReadingWithoutACurrentModelLeavesNone) {
    const std::string file = Write("design.cmd", "NOOP\n");
    EXPECT_TRUE(engine_.ReadCommandFile("fresh", file.c_str()));
    EXPECT_EQ(FailureOfLine(engine_, "NOOP"), "Missing Model.\n");
}

TEST_F(EngineFiles, ReadingIntoAModelThatExistsKeepsItsSourceFile) {
    const std::string file = Write("more.cmd", "ADD SIGNAL M\n");
    engine_.CreateAndAddModel("top", "first.cmd");
    engine_.Execute("top", "ADD SIGNAL N");
    EXPECT_TRUE(engine_.ReadCommandFile("TOP", file.c_str()));
    const Model* model = engine_.GetModel("top");
    EXPECT_EQ(model->GetSourceFileName(), "first.cmd");
    EXPECT_NE(model->GetSignal("N"), nullptr);
    EXPECT_NE(model->GetSignal("M"), nullptr);
}

TEST_F(EngineFiles, AMissingFileGivesFalseAndLeavesTheNewModel) {
    const std::string missing = folder_ / "missing.cmd";
    EXPECT_FALSE(engine_.ReadCommandFile("top", missing.c_str()));
    ASSERT_NE(engine_.GetModel("top"), nullptr);
    EXPECT_EQ(engine_.GetModel("top")->GetSourceFileName(), missing.c_str());
}

TEST_F(EngineFiles, NullNamesAreEmpty) {
    EXPECT_FALSE(engine_.ReadCommandFile(nullptr, nullptr));
    ASSERT_NE(engine_.GetModel(""), nullptr);
    EXPECT_TRUE(engine_.WriteCommandFile(nullptr, nullptr));
}

TEST_F(EngineFiles, AFolderCannotBeRead) {
    EXPECT_FALSE(engine_.ReadCommandFile("top", folder_.GetPath().c_str()));
}

TEST_F(EngineFiles, AnUnknownLineStopsTheReplay) {
    const std::string file = Write("bad.cmd", "ADD SIGNAL A\nMAKE COFFEE\nADD SIGNAL B\n");
    EXPECT_EQ(FailureOf([&] { engine_.ReadCommandFile("top", file.c_str()); }),
              "Command not find.\n");
    EXPECT_NE(engine_.GetModel("top")->GetSignal("A"), nullptr);
    EXPECT_EQ(engine_.GetModel("top")->GetSignal("B"), nullptr);
    EXPECT_EQ(engine_.GetModel("top")->GetCommandManager()->GetDoneCommandCount(), 1);
}

TEST_F(EngineFiles, WritingNeedsTheModelAndMakesNoFile) {
    const std::string file = folder_ / "saved.cmd";
    EXPECT_FALSE(engine_.WriteCommandFile("top", file.c_str()));
    engine_.CreateAndAddModel("top", "");
    engine_.Execute("top", "ADD SIGNAL N");
    EXPECT_TRUE(engine_.GetModel("top")->IsModified());
    EXPECT_TRUE(engine_.WriteCommandFile("Top", file.c_str()));
    EXPECT_FALSE(engine_.GetModel("top")->IsModified());
    EXPECT_FALSE(std::filesystem::exists(file));
}

// Keywords

TEST(EngineKeywords, VhdlIgnoresCase) {
    EXPECT_TRUE(Engine::IsVhdlKeyword("Signal"));
    EXPECT_TRUE(Engine::IsVhdlKeyword("signal"));
    EXPECT_TRUE(Engine::IsVhdlKeyword("ENTITY"));
    EXPECT_TRUE(Engine::IsVhdlKeyword("xnor"));
    EXPECT_FALSE(Engine::IsVhdlKeyword("wire"));
    EXPECT_FALSE(Engine::IsVhdlKeyword("signals"));
}

TEST(EngineKeywords, VerilogMindsCase) {
    EXPECT_TRUE(Engine::IsVerilogKeyword("wire"));
    EXPECT_FALSE(Engine::IsVerilogKeyword("WIRE"));
    EXPECT_TRUE(Engine::IsVerilogKeyword("module"));
    EXPECT_FALSE(Engine::IsVerilogKeyword("Module"));
    EXPECT_FALSE(Engine::IsVerilogKeyword("MODULE"));
    EXPECT_FALSE(Engine::IsVerilogKeyword("force"));
    EXPECT_FALSE(Engine::IsVerilogKeyword("entity"));
}

TEST(EngineKeywords, NullAndEmptyAreNoKeywords) {
    EXPECT_FALSE(Engine::IsVhdlKeyword(nullptr));
    EXPECT_FALSE(Engine::IsVhdlKeyword(""));
    EXPECT_FALSE(Engine::IsVerilogKeyword(nullptr));
    EXPECT_FALSE(Engine::IsVerilogKeyword(""));
}

// The banner alone

class EngineHeader : public testing::Test {
protected:
    std::vector<std::string> WriteBanner(bool vhdl) {
        Engine::WriteHalvexHeader("app", "cmd -x", "design", "device", "a purpose", "a reference",
                                  vhdl, file_.c_str());
        return SplitLines(ReadWholeFile(file_));
    }

    TemporaryFolder folder_;
    std::string file_ = folder_ / "banner";
};

TEST_F(EngineHeader, HoldsEveryTextInItsPlace) {
    const Support::EnvironmentVariable time("SOURCE_DATE_EPOCH", "86400");
    for (const bool vhdl : {true, false}) {
        const std::string prefix = vhdl ? "--" : "//";
        const std::vector<std::string> lines = WriteBanner(vhdl);
        ASSERT_EQ(lines.size(), 19u);
        const std::string divider(80, prefix[0]);
        EXPECT_EQ(lines[0], divider);
        EXPECT_EQ(lines[1].substr(0, 3), prefix + " ");
        EXPECT_EQ(lines[2], divider);
        const char* const labels[] = {"Vendor: Halvex", "Version : ", "Application : app",
                                      "Filename : ", "Timestamp : 01/02/1970 00:00:00"};
        const std::size_t column = lines[5].find(labels[0]);
        ASSERT_NE(column, std::string::npos);
        for (std::size_t i = 0; i < 9; ++i) {
            EXPECT_EQ(lines[3 + i].substr(0, 2), prefix);
        }
        for (std::size_t i = 0; i < 5; ++i) {
            EXPECT_EQ(lines[5 + i].find(labels[i]), column) << lines[5 + i];
        }
        EXPECT_EQ(lines[8].substr(column), "Filename : " + file_);
        EXPECT_EQ(lines[12], prefix + "Command: cmd -x");
        EXPECT_EQ(lines[13], prefix + "Design Name: design");
        EXPECT_EQ(lines[14], prefix + "Device: device");
        EXPECT_EQ(lines[15], prefix + "Purpose:");
        EXPECT_EQ(lines[16], prefix + "    a purpose ");
        EXPECT_EQ(lines[17], prefix + "Reference");
        EXPECT_EQ(lines[18], prefix + "    a reference ");
    }
}

TEST_F(EngineHeader, ReplacesTheFile) {
    WriteWholeFile(file_, std::string(100000, 'x'));
    EXPECT_EQ(WriteBanner(true).size(), 19u);
}

TEST_F(EngineHeader, NullTextsAreEmpty) {
    Engine::WriteHalvexHeader(nullptr, nullptr, nullptr, nullptr, nullptr, nullptr, false,
                              file_.c_str());
    const std::vector<std::string> lines = SplitLines(ReadWholeFile(file_));
    ASSERT_EQ(lines.size(), 19u);
    EXPECT_EQ(lines[12], "//Command: ");
    EXPECT_EQ(lines[16], "//    ");
    EXPECT_EQ(lines[18], "//    ");
}

TEST_F(EngineHeader, AFileThatCannotBeOpenedIsNotReported) {
    const std::string nowhere = folder_ / "no/such/folder/banner";
    Engine::WriteHalvexHeader("", "", "", "", "", "", true, nowhere.c_str());
    Engine::WriteHalvexHeader("", "", "", "", "", "", true, folder_.GetPath().c_str());
    Engine::WriteHalvexHeader("", "", "", "", "", "", true, nullptr);
    EXPECT_FALSE(std::filesystem::exists(nowhere));
}
