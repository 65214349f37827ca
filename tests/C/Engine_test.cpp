// Engines and models through the C interface: their handles, their errors, the lines they run.
#include "C/Session.h"
#include "Support/TemporaryFolder.h"

#include <gtest/gtest.h>

#include <cerrno>
#include <cstdint>
#include <cstring>
#include <string>
#include <vector>

using CTests::Session;
using CTests::ToString;

namespace {

std::string ErrorOf(orn_hdl_engine_t engine) {
    orn_hdl_error_t error;
    EXPECT_EQ(orn_hdl_engine_error(engine, &error), ORN_HDL_OK);
    return ToString(error.text);
}

TEST(CEngine, FindsItsModelsByName) {
    const Session session;
    orn_hdl_model_t found = {};
    EXPECT_EQ(orn_hdl_engine_get_model(session.engine, "TOP", &found), ORN_HDL_OK);
    EXPECT_EQ(found.id, session.model.id);
    EXPECT_EQ(orn_hdl_engine_add_model(session.engine, "Top", "", nullptr), ORN_HDL_EXISTS);
    EXPECT_EQ(ErrorOf(session.engine), "name taken");
    EXPECT_EQ(orn_hdl_engine_get_model(session.engine, "other", &found), ORN_HDL_NOT_FOUND);
    EXPECT_EQ(orn_hdl_engine_use_model(session.engine, "other"), ORN_HDL_NOT_FOUND);
    EXPECT_EQ(orn_hdl_engine_remove_model(session.engine, "other"), ORN_HDL_NOT_FOUND);
}

TEST(CEngine, AHandleSurvivesARenaming) {
    const Session session;
    EXPECT_EQ(orn_hdl_engine_execute(session.engine, "SET NETLIST NAME other"), ORN_HDL_OK);
    orn_hdl_text_t name;
    EXPECT_EQ(orn_hdl_model_get_name(session.model, &name), ORN_HDL_OK);
    EXPECT_EQ(ToString(name), "other");
    EXPECT_EQ(orn_hdl_engine_execute(session.engine, "ADD PORT A input"), ORN_HDL_OK);
}

TEST(CEngine, TellsTheTextOfTheLibrary) {
    const Session session;
    EXPECT_EQ(orn_hdl_engine_execute(session.engine, "NONSENSE"), ORN_HDL_FAILED);
    EXPECT_EQ(ErrorOf(session.engine), "Command not find.\n");
    EXPECT_EQ(session.GetError(), "");
    EXPECT_EQ(orn_hdl_model_execute(session.model, "ADD PIN"), ORN_HDL_FAILED);
    EXPECT_EQ(session.GetError(), "ADD PIN: Invalid Arguments.\n");
    EXPECT_EQ(orn_hdl_engine_remove_model(session.engine, "top"), ORN_HDL_OK);
    EXPECT_EQ(orn_hdl_engine_execute(session.engine, "NOOP"), ORN_HDL_FAILED);
    EXPECT_EQ(ErrorOf(session.engine), "Missing Model.\n");
}

TEST(CEngine, HandlesOfWhatIsGoneAreDead) {
    orn_hdl_engine_t engine;
    ASSERT_EQ(orn_hdl_engine_create(&engine), ORN_HDL_OK);
    orn_hdl_model_t first;
    orn_hdl_model_t second;
    ASSERT_EQ(orn_hdl_engine_add_model(engine, "first", "", &first), ORN_HDL_OK);
    ASSERT_EQ(orn_hdl_engine_add_model(engine, "second", "", &second), ORN_HDL_OK);
    orn_hdl_object_t netlist;
    ASSERT_EQ(orn_hdl_model_get_netlist(first, &netlist), ORN_HDL_OK);
    EXPECT_EQ(orn_hdl_engine_remove_model(engine, "first"), ORN_HDL_OK);
    EXPECT_EQ(orn_hdl_model_execute(first, "NOOP"), ORN_HDL_DEAD_HANDLE);
    int32_t kind = 0;
    EXPECT_EQ(orn_hdl_object_get_kind(netlist, &kind), ORN_HDL_DEAD_HANDLE);
    EXPECT_EQ(orn_hdl_model_execute(second, "NOOP"), ORN_HDL_OK);
    EXPECT_EQ(orn_hdl_engine_destroy(engine), ORN_HDL_OK);
    EXPECT_EQ(orn_hdl_model_execute(second, "NOOP"), ORN_HDL_DEAD_HANDLE);
    EXPECT_EQ(orn_hdl_engine_destroy(engine), ORN_HDL_DEAD_HANDLE);
    // The slot is used again, and the old handle does not lead to what is in it now.
    orn_hdl_engine_t next;
    ASSERT_EQ(orn_hdl_engine_create(&next), ORN_HDL_OK);
    EXPECT_EQ(orn_hdl_engine_execute(engine, "NOOP"), ORN_HDL_DEAD_HANDLE);
    EXPECT_EQ(orn_hdl_engine_destroy(next), ORN_HDL_OK);
}

TEST(CEngine, AModelIsDestroyedWhateverItsName) {
    const Session session;
    orn_hdl_model_t other;
    ASSERT_EQ(orn_hdl_engine_add_model(session.engine, "other", "", &other), ORN_HDL_OK);
    ASSERT_EQ(orn_hdl_model_set_name(other, "top"), ORN_HDL_OK);
    EXPECT_EQ(orn_hdl_model_destroy(other), ORN_HDL_OK);
    EXPECT_EQ(orn_hdl_model_destroy(other), ORN_HDL_DEAD_HANDLE);
    orn_hdl_text_t name;
    ASSERT_EQ(orn_hdl_model_get_name(session.model, &name), ORN_HDL_OK);
    EXPECT_EQ(ToString(name), "top");
    EXPECT_EQ(orn_hdl_engine_execute(session.engine, "NOOP"), ORN_HDL_OK);
}

TEST(CEngine, HandlesOfOtherKindsAreRefused) {
    const Session session;
    EXPECT_EQ(orn_hdl_model_execute(orn_hdl_model_t{session.engine.id}, "NOOP"),
              ORN_HDL_WRONG_KIND);
    EXPECT_EQ(orn_hdl_engine_destroy(orn_hdl_engine_t{session.model.id}), ORN_HDL_WRONG_KIND);
    EXPECT_EQ(orn_hdl_findings_destroy(orn_hdl_findings_t{session.model.id}), ORN_HDL_WRONG_KIND);
    EXPECT_EQ(orn_hdl_engine_destroy(orn_hdl_engine_t{}), ORN_HDL_NULL_HANDLE);
    EXPECT_EQ(orn_hdl_engine_destroy(orn_hdl_engine_t{UINT64_MAX}), ORN_HDL_DEAD_HANDLE);
}

TEST(CEngine, ManyEnginesHaveHandlesOfTheirOwn) {
    std::vector<orn_hdl_engine_t> engines(1000);
    for (orn_hdl_engine_t& engine : engines) {
        ASSERT_EQ(orn_hdl_engine_create(&engine), ORN_HDL_OK);
    }
    for (const orn_hdl_engine_t& engine : engines) {
        EXPECT_EQ(orn_hdl_engine_add_model(engine, "m", "", nullptr), ORN_HDL_OK);
    }
    for (const orn_hdl_engine_t& engine : engines) {
        EXPECT_EQ(orn_hdl_engine_destroy(engine), ORN_HDL_OK);
        EXPECT_EQ(orn_hdl_engine_destroy(engine), ORN_HDL_DEAD_HANDLE);
    }
}

TEST(CLines, AFailureHasItsLine) {
    const Session session;
    const std::string lines = "ADD COMPONENT INV\r\n\nADD INSTANCE MISSING U1\nADD PORT A input\n";
    EXPECT_EQ(orn_hdl_model_execute_lines(session.model, lines.data(), lines.size()),
              ORN_HDL_FAILED);
    orn_hdl_error_t error;
    ASSERT_EQ(orn_hdl_model_error(session.model, &error), ORN_HDL_OK);
    EXPECT_EQ(ToString(error.text), "Component \"MISSING\" not found.\n");
    EXPECT_EQ(ToString(error.file), "");
    EXPECT_EQ(error.line, 3U);
    orn_hdl_object_t object;
    EXPECT_EQ(orn_hdl_model_get_component(session.model, "INV", &object), ORN_HDL_OK);
    EXPECT_EQ(orn_hdl_model_get_signal(session.model, "A", &object), ORN_HDL_NOT_FOUND);
}

TEST(CLines, AFileThatCannotBeWrittenIsAFailure) {
    const Session session;
    EXPECT_EQ(orn_hdl_model_execute(session.model, "WRITE VERILOG /nowhere/top.v"), ORN_HDL_FILE);
    EXPECT_EQ(session.GetError(), "cannot write /nowhere/top.v: No such file or directory");
    int error = 0;
    orn_hdl_text_t file;
    EXPECT_EQ(orn_hdl_model_get_last_write(session.model, &error, nullptr, &file), ORN_HDL_OK);
    EXPECT_EQ(error, ENOENT);
    EXPECT_EQ(ToString(file), "/nowhere/top.v");
    // It is told once.
    EXPECT_EQ(orn_hdl_model_execute(session.model, "NOOP"), ORN_HDL_OK);
    EXPECT_EQ(orn_hdl_model_write(session.model, ORN_HDL_VHDL, "/nowhere/top.vhd", 0),
              ORN_HDL_FILE);
}

/// What the callbacks of a replay are told, and what they answer.
struct Told {
    orn_hdl_engine_t engine;
    orn_hdl_model_t model;
    int progressAnswer = 0;
    int failureAnswer = 0;
    std::vector<std::uint64_t> progress;
    std::vector<std::string> failures;
};

int OnProgress(void* user, std::uint64_t lines, std::uint64_t bytes) {
    Told& told = *static_cast<Told*>(user);
    EXPECT_EQ(bytes, lines * std::strlen("NOOP\n"));
    told.progress.push_back(lines);
    // A callback can look at the model, but neither change nor destroy it.
    orn_hdl_text_t name;
    EXPECT_EQ(orn_hdl_model_get_name(told.model, &name), ORN_HDL_OK);
    EXPECT_EQ(orn_hdl_model_execute(told.model, "NOOP"), ORN_HDL_BUSY);
    EXPECT_EQ(orn_hdl_engine_remove_model(told.engine, "top"), ORN_HDL_BUSY);
    EXPECT_EQ(orn_hdl_engine_destroy(told.engine), ORN_HDL_BUSY);
    EXPECT_EQ(orn_hdl_engine_add_model(told.engine, "other", "", nullptr),
              told.progress.size() == 1 ? ORN_HDL_OK : ORN_HDL_EXISTS);
    return told.progressAnswer;
}

int OnFailure(void* user, const orn_hdl_error_t* error) {
    Told& told = *static_cast<Told*>(user);
    told.failures.push_back(ToString(error->file) + ":" + std::to_string(error->line) + ": " +
                            ToString(error->text));
    return told.failureAnswer;
}

class CReplay : public testing::Test {
protected:
    orn_hdl_status_t Replay(const std::string& text, orn_hdl_progress_t progress,
                            orn_hdl_failure_t failure) {
        Support::WriteWholeFile(file, text);
        return orn_hdl_model_replay(session.model, file.c_str(), progress, failure, &told);
    }

    const Support::TemporaryFolder folder;
    const std::string file = folder / "a.cmd";
    const Session session;
    Told told{session.engine, session.model, 0, 0, {}, {}};
};

TEST_F(CReplay, StopsAtTheFirstFailure) {
    EXPECT_EQ(Replay("NOOP\nADD PIN\nADD PORT A input\n", nullptr, nullptr), ORN_HDL_FAILED);
    orn_hdl_error_t error;
    ASSERT_EQ(orn_hdl_model_error(session.model, &error), ORN_HDL_OK);
    EXPECT_EQ(error.status, ORN_HDL_FAILED);
    EXPECT_EQ(error.line, 2U);
    EXPECT_EQ(ToString(error.file), file);
    orn_hdl_object_t port;
    EXPECT_EQ(orn_hdl_model_get_signal(session.model, "A", &port), ORN_HDL_NOT_FOUND);
}

TEST_F(CReplay, GoesOnWhenAsked) {
    EXPECT_EQ(Replay("BAD\nADD PIN\nADD PORT A input\n", nullptr, &OnFailure), ORN_HDL_FAILED);
    EXPECT_EQ(told.failures, (std::vector<std::string>{file + ":1: Command not find.\n",
                                                       file + ":2: ADD PIN: Invalid "
                                                              "Arguments.\n"}));
    session.GetSignal("A");
}

TEST_F(CReplay, TellsItsProgress) {
    std::string text;
    for (int i = 0; i < 10000; ++i) {
        text += "NOOP\n";
    }
    EXPECT_EQ(Replay(text, &OnProgress, nullptr), ORN_HDL_OK);
    EXPECT_EQ(told.progress, (std::vector<std::uint64_t>{4096, 8192}));
    told.progress.clear();
    told.progressAnswer = 1;
    EXPECT_EQ(orn_hdl_engine_remove_model(session.engine, "other"), ORN_HDL_OK);
    EXPECT_EQ(Replay(text, &OnProgress, nullptr), ORN_HDL_STOPPED);
    EXPECT_EQ(told.progress.size(), 1U);
}

TEST_F(CReplay, MakesTheModelOfAnEngine) {
    Support::WriteWholeFile(file, "ADD PORT A input\n");
    EXPECT_EQ(orn_hdl_engine_replay(session.engine, "new", file.c_str()), ORN_HDL_OK);
    orn_hdl_model_t made;
    ASSERT_EQ(orn_hdl_engine_get_model(session.engine, "new", &made), ORN_HDL_OK);
    orn_hdl_text_t source;
    EXPECT_EQ(orn_hdl_model_get_source_file(made, &source), ORN_HDL_OK);
    EXPECT_EQ(ToString(source), file);
    EXPECT_EQ(orn_hdl_engine_replay(session.engine, "new", file.c_str()), ORN_HDL_FAILED);
    orn_hdl_error_t error;
    ASSERT_EQ(orn_hdl_engine_error(session.engine, &error), ORN_HDL_OK);
    EXPECT_EQ(error.line, 1U);
    EXPECT_EQ(orn_hdl_engine_replay(session.engine, "new", "/nowhere"), ORN_HDL_FILE);
    EXPECT_EQ(ErrorOf(session.engine), "cannot read /nowhere: No such file or directory");
}

const char* OnlyVhdl(void* user, const char* fileName) {
    ++*static_cast<int*>(user);
    return std::string(fileName).find(".vhd") == std::string::npos ? "only VHDL" : nullptr;
}

TEST_F(CReplay, AsksTheGuard) {
    int asked = 0;
    ASSERT_EQ(orn_hdl_model_set_guard(session.model, &OnlyVhdl, &asked), ORN_HDL_OK);
    EXPECT_EQ(orn_hdl_model_write(session.model, ORN_HDL_VERILOG, (folder / "a.v").c_str(), 0),
              ORN_HDL_FAILED);
    EXPECT_EQ(session.GetError(), "Cannot write \"" + (folder / "a.v") + "\": only VHDL.\n");
    EXPECT_EQ(orn_hdl_model_write(session.model, ORN_HDL_VHDL, (folder / "a.vhd").c_str(), 0),
              ORN_HDL_OK);
    EXPECT_EQ(asked, 2);
    ASSERT_EQ(orn_hdl_model_set_guard(session.model, nullptr, nullptr), ORN_HDL_OK);
    EXPECT_EQ(orn_hdl_model_write(session.model, ORN_HDL_VERILOG, (folder / "a.v").c_str(), 0),
              ORN_HDL_OK);
}

TEST(CLibrary, TellsOfItself) {
    EXPECT_STRNE(orn_hdl_version(), "");
    EXPECT_STREQ(orn_hdl_status_text(ORN_HDL_OK), "success");
    EXPECT_STREQ(orn_hdl_status_text(-1), "unknown status");
    int reserved = -1;
    EXPECT_EQ(orn_hdl_is_keyword(ORN_HDL_VERILOG, "module", &reserved), ORN_HDL_OK);
    EXPECT_EQ(reserved, 1);
    EXPECT_EQ(orn_hdl_is_keyword(ORN_HDL_VHDL, "module", &reserved), ORN_HDL_OK);
    EXPECT_EQ(reserved, 0);
    EXPECT_EQ(orn_hdl_is_keyword(2, "module", &reserved), ORN_HDL_INVALID_ARGUMENT);
    size_t phrases = 0;
    orn_hdl_command_t command;
    while (orn_hdl_get_command(phrases, &command) == ORN_HDL_OK) {
        EXPECT_STRNE(command.phrase, "");
        ++phrases;
    }
    EXPECT_EQ(phrases, 61U);
}

} // namespace
