// Options, writing, checking, proving and reading through the C interface.
#include "C/Session.h"
#include "Support/TemporaryFolder.h"

#include <gtest/gtest.h>

#include <cstring>
#include <string>

using CTests::Session;
using CTests::ToString;

namespace {

class COutput : public testing::Test {
protected:
    const Support::TemporaryFolder folder;
    const Session session;
};

TEST_F(COutput, EveryOptionIsSetAndTold) {
    int switches = 0;
    int texts = 0;
    int lists = 0;
    for (orn_hdl_option_t option = ORN_HDL_VHDL_SUPPRESS_CONFIGURATION; option <= ORN_HDL_VERIFY;
         ++option) {
        SCOPED_TRACE(option);
        int number = -1;
        orn_hdl_text_t text;
        if (orn_hdl_model_get_number(session.model, option, &number) == ORN_HDL_OK) {
            ++switches;
            EXPECT_EQ(orn_hdl_model_set_number(session.model, option, 1 - number), ORN_HDL_OK);
            int changed = -1;
            EXPECT_EQ(orn_hdl_model_get_number(session.model, option, &changed), ORN_HDL_OK);
            EXPECT_EQ(changed, 1 - number);
            EXPECT_EQ(orn_hdl_model_set_number(session.model, option, 99),
                      ORN_HDL_INVALID_ARGUMENT);
            EXPECT_EQ(orn_hdl_model_set_text(session.model, option, "x"), ORN_HDL_INVALID_ARGUMENT);
            EXPECT_EQ(orn_hdl_model_get_text(session.model, option, 0, &text),
                      ORN_HDL_INVALID_ARGUMENT);
            continue;
        }
        EXPECT_EQ(orn_hdl_model_set_text(session.model, option, "first"), ORN_HDL_OK);
        EXPECT_EQ(orn_hdl_model_set_text(session.model, option, "second"), ORN_HDL_OK);
        EXPECT_EQ(orn_hdl_model_get_text(session.model, option, 0, &text), ORN_HDL_OK);
        const bool isList = ToString(text) == "first";
        ++(isList ? lists : texts);
        EXPECT_EQ(orn_hdl_model_get_text(session.model, option, 1, &text),
                  isList ? ORN_HDL_OK : ORN_HDL_END);
        EXPECT_EQ(ToString(text), "second");
        EXPECT_EQ(orn_hdl_model_set_text(session.model, option, nullptr), ORN_HDL_OK);
        EXPECT_EQ(orn_hdl_model_get_text(session.model, option, 0, &text),
                  isList ? ORN_HDL_END : ORN_HDL_OK);
        EXPECT_EQ(orn_hdl_model_set_number(session.model, option, 1), ORN_HDL_INVALID_ARGUMENT);
    }
    EXPECT_EQ(switches, 16);
    EXPECT_EQ(texts, 5);
    EXPECT_EQ(lists, 3);
}

TEST_F(COutput, ThreadsAreANumber) {
    int threads = 0;
    ASSERT_EQ(orn_hdl_model_get_number(session.model, ORN_HDL_THREADS, &threads), ORN_HDL_OK);
    EXPECT_EQ(threads, 1);
    for (const int other : {0, 3}) {
        ASSERT_EQ(orn_hdl_model_set_number(session.model, ORN_HDL_THREADS, other), ORN_HDL_OK);
        ASSERT_EQ(orn_hdl_model_get_number(session.model, ORN_HDL_THREADS, &threads), ORN_HDL_OK);
        EXPECT_EQ(threads, other);
    }
    EXPECT_EQ(orn_hdl_model_set_number(session.model, ORN_HDL_THREADS, -1),
              ORN_HDL_INVALID_ARGUMENT);
    EXPECT_EQ(orn_hdl_model_set_text(session.model, ORN_HDL_THREADS, "2"),
              ORN_HDL_INVALID_ARGUMENT);
}

TEST_F(COutput, OptionsAreThoseOfTheCommands) {
    session.Run("SET SYNTHESIS SYNPLICITY\nLOWERCASE instance\nADD LIBRARY cells\n"
                "SUPPRESS COMPONENT\n");
    int number = 0;
    EXPECT_EQ(orn_hdl_model_get_number(session.model, ORN_HDL_VERILOG_SYNTHESIS, &number),
              ORN_HDL_OK);
    EXPECT_EQ(number, 2);
    EXPECT_EQ(orn_hdl_model_get_number(session.model, ORN_HDL_VERILOG_INSTANCE_CASE, &number),
              ORN_HDL_OK);
    EXPECT_EQ(number, ORN_HDL_CASE_LOWER);
    EXPECT_EQ(orn_hdl_model_get_number(session.model, ORN_HDL_VHDL_SUPPRESS_COMPONENT, &number),
              ORN_HDL_OK);
    EXPECT_EQ(number, 1);
    orn_hdl_text_t text;
    EXPECT_EQ(orn_hdl_model_get_text(session.model, ORN_HDL_VHDL_LIBRARIES, 0, &text), ORN_HDL_OK);
    EXPECT_EQ(ToString(text), "cells");
}

TEST_F(COutput, FilesAreAppendedTo) {
    session.Run(CTests::SmallDesign);
    ASSERT_EQ(orn_hdl_model_set_number(session.model, ORN_HDL_WRITE_HEADER, 0), ORN_HDL_OK);
    const std::string file = folder / "top.v";
    ASSERT_EQ(orn_hdl_model_write(session.model, ORN_HDL_VERILOG, file.c_str(), 0), ORN_HDL_OK);
    const std::string once = Support::ReadWholeFile(file);
    EXPECT_NE(once.find("endmodule"), std::string::npos);
    ASSERT_EQ(orn_hdl_model_write(session.model, ORN_HDL_VERILOG, file.c_str(), 1), ORN_HDL_OK);
    EXPECT_EQ(Support::ReadWholeFile(file), once + once);
    EXPECT_EQ(orn_hdl_model_write(session.model, 7, file.c_str(), 0), ORN_HDL_INVALID_ARGUMENT);
    EXPECT_EQ(orn_hdl_model_write(session.model, ORN_HDL_VHDL, nullptr, 0),
              ORN_HDL_INVALID_ARGUMENT);
    size_t done = 0;
    EXPECT_EQ(orn_hdl_model_get_done_count(session.model, &done), ORN_HDL_OK);
    EXPECT_EQ(done, 15U);
    EXPECT_EQ(orn_hdl_model_clear_done(session.model), ORN_HDL_OK);
    EXPECT_EQ(orn_hdl_model_get_done_count(session.model, &done), ORN_HDL_OK);
    EXPECT_EQ(done, 0U);
}

TEST_F(COutput, CommandsAreWritten) {
    session.Run(CTests::SmallDesign);
    const std::string file = folder / "top.cmd";
    ASSERT_EQ(orn_hdl_model_write_commands(session.model, file.c_str()), ORN_HDL_OK);
    char* text = nullptr;
    ASSERT_EQ(orn_hdl_model_write_commands_text(session.model, &text, nullptr), ORN_HDL_OK);
    EXPECT_EQ(Support::ReadWholeFile(file), text);
    orn_hdl_free(text);
    EXPECT_EQ(orn_hdl_model_write_commands(session.model, "/nowhere/top.cmd"), ORN_HDL_FILE);
    ASSERT_EQ(orn_hdl_model_set_name(session.model, ""), ORN_HDL_OK);
    EXPECT_EQ(orn_hdl_model_write_commands_text(session.model, &text, nullptr), ORN_HDL_FAILED);
}

TEST_F(COutput, ACheckTellsItsFindings) {
    session.Run("ADD PORT module input\n");
    orn_hdl_findings_t findings;
    ASSERT_EQ(orn_hdl_model_check(session.model, ORN_HDL_ALL_TARGETS, &findings), ORN_HDL_OK);
    size_t count = 0;
    ASSERT_EQ(orn_hdl_findings_get_count(findings, &count), ORN_HDL_OK);
    ASSERT_GT(count, 0U);
    orn_hdl_finding_t finding;
    ASSERT_EQ(orn_hdl_findings_get(findings, 0, &finding), ORN_HDL_OK);
    EXPECT_EQ(finding.isError, 1);
    EXPECT_EQ(ToString(finding.cause), "Signal");
    EXPECT_EQ(ToString(finding.first), "module");
    EXPECT_NE(ToString(finding.rule), "");
    EXPECT_NE(ToString(finding.message).find("module"), std::string::npos);
    EXPECT_EQ(finding.verdicts[0], ORN_HDL_REJECTS);
    EXPECT_EQ(orn_hdl_findings_get(findings, count, &finding), ORN_HDL_END);
    EXPECT_EQ(orn_hdl_findings_destroy(findings), ORN_HDL_OK);
    EXPECT_EQ(orn_hdl_findings_destroy(findings), ORN_HDL_DEAD_HANDLE);
    // No target of VHDL minds.
    ASSERT_EQ(orn_hdl_model_check(session.model, 0x118, &findings), ORN_HDL_OK);
    ASSERT_EQ(orn_hdl_findings_get_count(findings, &count), ORN_HDL_OK);
    EXPECT_EQ(count, 0U);
    EXPECT_EQ(orn_hdl_findings_destroy(findings), ORN_HDL_OK);
}

TEST_F(COutput, LegalNetlistsHaveOtherNames) {
    session.Run("ADD PORT module input\n");
    orn_hdl_text_t name;
    ASSERT_EQ(orn_hdl_model_get_legal_name(session.model, session.GetSignal("module"), &name),
              ORN_HDL_OK);
    const std::string legal = ToString(name);
    EXPECT_NE(legal, "module");
    ASSERT_EQ(orn_hdl_model_set_number(session.model, ORN_HDL_LEGAL, 1), ORN_HDL_OK);
    EXPECT_NE(CTests::TextOf(session.model, ORN_HDL_VERILOG).find(legal), std::string::npos);
    orn_hdl_findings_t findings;
    ASSERT_EQ(orn_hdl_model_check_legal(session.model, &findings), ORN_HDL_OK);
    size_t count = 1;
    EXPECT_EQ(orn_hdl_findings_get_count(findings, &count), ORN_HDL_OK);
    EXPECT_EQ(count, 0U);
    EXPECT_EQ(orn_hdl_findings_destroy(findings), ORN_HDL_OK);
}

TEST_F(COutput, AProofTellsDifferences) {
    session.Run(CTests::SmallDesign);
    ASSERT_EQ(orn_hdl_model_set_number(session.model, ORN_HDL_VERIFY, 1), ORN_HDL_OK);
    const std::string file = folder / "top.v";
    ASSERT_EQ(orn_hdl_model_write(session.model, ORN_HDL_VERILOG, file.c_str(), 0), ORN_HDL_OK)
        << session.GetError();
    orn_hdl_findings_t findings;
    size_t count = 1;
    ASSERT_EQ(orn_hdl_model_prove(session.model, ORN_HDL_VERILOG, file.c_str(), &findings),
              ORN_HDL_OK);
    EXPECT_EQ(orn_hdl_findings_get_count(findings, &count), ORN_HDL_OK);
    EXPECT_EQ(count, 0U);
    EXPECT_EQ(orn_hdl_findings_destroy(findings), ORN_HDL_OK);
    session.Run("CONNECT SIGNAL D(3) U1.I\n");
    ASSERT_EQ(orn_hdl_model_prove(session.model, ORN_HDL_VERILOG, file.c_str(), &findings),
              ORN_HDL_OK);
    orn_hdl_finding_t finding;
    ASSERT_EQ(orn_hdl_findings_get(findings, 0, &finding), ORN_HDL_OK);
    EXPECT_GT(finding.line, 0U);
    EXPECT_NE(ToString(finding.source), "");
    EXPECT_EQ(orn_hdl_findings_destroy(findings), ORN_HDL_OK);
    EXPECT_EQ(orn_hdl_model_prove(session.model, ORN_HDL_VERILOG, "/nowhere", &findings),
              ORN_HDL_FAILED);
}

TEST_F(COutput, RulesAndTargetsAreListed) {
    size_t targets = 0;
    const char* target = nullptr;
    while (orn_hdl_get_target(targets, &target) == ORN_HDL_OK) {
        ++targets;
    }
    EXPECT_EQ(targets, size_t(ORN_HDL_TARGET_COUNT));
    size_t rules = 0;
    orn_hdl_rule_t rule;
    while (orn_hdl_get_rule(rules, &rule) == ORN_HDL_OK) {
        EXPECT_EQ(std::strlen(rule.name.data), rule.name.length);
        EXPECT_EQ(std::strlen(rule.help.data), rule.help.length);
        ++rules;
    }
    EXPECT_GT(rules, 10U);
}

class CReader : public COutput {
protected:
    ~CReader() override { EXPECT_EQ(orn_hdl_reader_destroy(reader), ORN_HDL_OK); }
    void Create(orn_hdl_language_t language) {
        ASSERT_EQ(orn_hdl_reader_create(language, &reader), ORN_HDL_OK);
    }
    orn_hdl_status_t Read(const char* name, const std::string& text) {
        const std::string file = folder / name;
        Support::WriteWholeFile(file, text);
        return orn_hdl_reader_read(reader, file.c_str(), session.model);
    }
    std::string GetError() const {
        orn_hdl_error_t error;
        EXPECT_EQ(orn_hdl_reader_error(reader, &error), ORN_HDL_OK);
        return ToString(error.text);
    }

    orn_hdl_reader_t reader = {};
};

TEST_F(CReader, ReadsWhatIsWritten) {
    session.Run(CTests::SmallDesign);
    for (const orn_hdl_language_t language : {ORN_HDL_VERILOG, ORN_HDL_VHDL}) {
        const std::string text = CTests::TextOf(session.model, language);
        orn_hdl_reader_t first;
        ASSERT_EQ(orn_hdl_reader_create(language, &first), ORN_HDL_OK);
        // The cells are those of the model itself.
        ASSERT_EQ(orn_hdl_reader_add_library_model(first, session.model), ORN_HDL_OK);
        const std::string file = folder / "read";
        Support::WriteWholeFile(file, text);
        const orn_hdl_object_t before = session.GetInstance("U1");
        ASSERT_EQ(orn_hdl_reader_read(first, file.c_str(), session.model), ORN_HDL_OK);
        orn_hdl_text_t name;
        EXPECT_EQ(orn_hdl_object_get_name(before, &name), ORN_HDL_DEAD_HANDLE);
        EXPECT_EQ(CTests::NameOf(session.GetInstance("U1")), "U1");
        EXPECT_EQ(orn_hdl_reader_destroy(first), ORN_HDL_OK);
    }
    Create(ORN_HDL_VERILOG);
}

TEST_F(CReader, TellsTheTextOfTheLibrary) {
    Create(ORN_HDL_VERILOG);
    EXPECT_EQ(Read("a.v", "module top(a);\n  input b;\nendmodule\n"), ORN_HDL_FAILED);
    EXPECT_EQ(GetError().find(folder / "a.v"), 0U);
    EXPECT_EQ(orn_hdl_reader_read(reader, nullptr, session.model), ORN_HDL_INVALID_ARGUMENT);
    EXPECT_EQ(orn_hdl_reader_read(reader, "/nowhere", {}), ORN_HDL_NULL_HANDLE);
}

TEST_F(CReader, ListsReplacedNames) {
    Create(ORN_HDL_VERILOG);
    ASSERT_EQ(Read("a.v", "module top(\\a+b );\n  input \\a+b ;\nendmodule\n"), ORN_HDL_OK)
        << GetError();
    orn_hdl_renaming_t renaming;
    ASSERT_EQ(orn_hdl_reader_get_renaming(reader, 0, &renaming), ORN_HDL_OK);
    EXPECT_EQ(ToString(renaming.name), "a+b");
    EXPECT_EQ(ToString(renaming.kind), "Signal");
    EXPECT_EQ(orn_hdl_reader_get_renaming(reader, 1, &renaming), ORN_HDL_END);
    ASSERT_EQ(orn_hdl_reader_set(reader, ORN_HDL_LITERAL_NAMES, 1), ORN_HDL_OK);
    ASSERT_EQ(Read("a.v", "module top(\\a+b );\n  input \\a+b ;\nendmodule\n"), ORN_HDL_OK);
    EXPECT_EQ(orn_hdl_reader_get_renaming(reader, 0, &renaming), ORN_HDL_END);
    session.GetSignal("a+b");
}

struct KeptNames {
    orn_hdl_reader_t reader;
    orn_hdl_model_t model;
    int asked;
};

int KeepAllButA(void* user, const char* name) {
    KeptNames& kept = *static_cast<KeptNames*>(user);
    ++kept.asked;
    EXPECT_EQ(orn_hdl_reader_destroy(kept.reader), ORN_HDL_BUSY);
    EXPECT_EQ(orn_hdl_reader_set_top(kept.reader, "x"), ORN_HDL_BUSY);
    EXPECT_EQ(orn_hdl_model_execute(kept.model, "NOOP"), ORN_HDL_BUSY);
    return std::strcmp(name, "a") != 0;
}

TEST_F(CReader, AsksWhichNamesStay) {
    Create(ORN_HDL_VERILOG);
    KeptNames kept{reader, session.model, 0};
    ASSERT_EQ(orn_hdl_reader_set_kept_names(reader, &KeepAllButA, &kept), ORN_HDL_OK);
    ASSERT_EQ(Read("a.v", "module top(a, b);\n  input a;\n  input b;\nendmodule\n"), ORN_HDL_OK);
    EXPECT_GT(kept.asked, 0);
    orn_hdl_object_t signal;
    EXPECT_EQ(orn_hdl_model_get_signal(session.model, "a", &signal), ORN_HDL_NOT_FOUND);
    session.GetSignal("b");
}

TEST_F(CReader, VerilogHasSwitchesOfItsOwn) {
    Create(ORN_HDL_VHDL);
    EXPECT_EQ(orn_hdl_reader_set(reader, ORN_HDL_KEEP_INCLUDES, 1), ORN_HDL_WRONG_KIND);
    EXPECT_EQ(orn_hdl_reader_define(reader, "A", "1"), ORN_HDL_WRONG_KIND);
    EXPECT_EQ(orn_hdl_reader_add_include_folder(reader, "."), ORN_HDL_WRONG_KIND);
    EXPECT_EQ(orn_hdl_reader_set(reader, ORN_HDL_KEEP_COMMENTS, 1), ORN_HDL_OK);
    EXPECT_EQ(orn_hdl_reader_set(reader, 99, 1), ORN_HDL_INVALID_ARGUMENT);
}

TEST_F(CReader, InfersUndeclaredCells) {
    Create(ORN_HDL_VERILOG);
    const std::string text = "module top(a, y);\n  input a;\n  output y;\n"
                             "  CELL u(.I(a), .O(y));\nendmodule\n";
    EXPECT_EQ(Read("a.v", text), ORN_HDL_FAILED);
    ASSERT_EQ(orn_hdl_reader_set(reader, ORN_HDL_INFER_UNDECLARED, 1), ORN_HDL_OK);
    EXPECT_EQ(Read("a.v", text), ORN_HDL_OK) << GetError();
}

TEST_F(CReader, KeepsDontCares) {
    for (const orn_hdl_language_t language : {ORN_HDL_VERILOG, ORN_HDL_VHDL}) {
        SCOPED_TRACE(language);
        Create(language);
        const bool isVhdl = language == ORN_HDL_VHDL;
        const char* const file = isVhdl ? "x.vhd" : "x.v";
        const std::string text = isVhdl ? "library ieee; use ieee.std_logic_1164.all;\n"
                                          "entity top is port (y : out std_logic); end;\n"
                                          "architecture a of top is begin y <= '-'; end;\n"
                                        : "module top(y); output y; assign y = 1'bx; endmodule\n";
        EXPECT_EQ(Read(file, text), ORN_HDL_FAILED);
        ASSERT_EQ(orn_hdl_reader_set(reader, ORN_HDL_KEEP_DONT_CARES, 1), ORN_HDL_OK);
        EXPECT_EQ(Read(file, text), ORN_HDL_OK) << GetError();
        int keeps = 0;
        EXPECT_EQ(orn_hdl_model_get_number(session.model, ORN_HDL_DONT_CARES, &keeps), ORN_HDL_OK);
        EXPECT_EQ(keeps, 1);
        ASSERT_EQ(orn_hdl_model_set_number(session.model, ORN_HDL_DONT_CARES, 0), ORN_HDL_OK);
    }
}

} // namespace
