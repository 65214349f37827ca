// A model, the commands that it writes, and a fresh model that reads them.
#pragma once

#include "Orn_Hdl/Orn_Hdl.h"
#include "Support/EngineScript.h"
#include "Support/Environment.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <functional>
#include <string>
#include <vector>

namespace Support {

inline std::string CommandsOf(const Orn_Hdl::Model& model) {
    Orn_Hdl::TextMemOutStream out;
    model.WriteCommands(out);
    return std::string(out.GetValue().GetView());
}

inline std::string WriteVerilog(Orn_Hdl::Model& model) {
    Orn_Hdl::TextMemOutStream out;
    Orn_Hdl::VerilogNetlister(out).WriteNetlist(model.GetNetlist(), *model.GetOptions());
    return std::string(out.GetValue().GetView());
}

inline std::string WriteVhdl(Orn_Hdl::Model& model) {
    Orn_Hdl::TextMemOutStream out;
    Orn_Hdl::VhdlNetlister(out).WriteNetlist(model.GetNetlist(), model.GetOptions());
    return std::string(out.GetValue().GetView());
}

inline std::string SortedLines(const std::string& text) {
    std::vector<std::string> lines = SplitLines(text);
    std::sort(lines.begin(), lines.end());
    std::string sorted;
    for (const std::string& line : lines) {
        sorted.append(line).append("\n");
    }
    return sorted;
}

/// How far the netlists of both models must agree.
enum class Agreement { Bytes, LinesInAnyOrder };

/// Makes a design several times over, since a write changes it, and compares each with what its
/// commands make.
class RoundTrip {
public:
    using Build = std::function<void(Orn_Hdl::Model&)>;

    explicit RoundTrip(Build build) : build_(std::move(build)) {}
    /// \param lines commands; those that fail change what they change.
    static RoundTrip OfCommands(const std::string& lines) {
        return RoundTrip([lines](Orn_Hdl::Model& model) {
            for (const std::string& line : SplitLines(lines)) {
                FailureOf([&] { model.ExecuteLine(line); });
            }
        });
    }

    /// Checks everything. \return the commands.
    std::string Check(Agreement agreement = Agreement::Bytes) {
        const EnvironmentVariable time("SOURCE_DATE_EPOCH", "0");
        const std::string commands = [this] {
            Orn_Hdl::Model model(&factory_);
            build_(model);
            const std::string text = CommandsOf(model);
            EXPECT_EQ(CommandsOf(model), text) << "writing commands changes nothing";
            return text;
        }();
        Orn_Hdl::Model replayed(&factory_);
        Replay(replayed, commands);
        EXPECT_EQ(CommandsOf(replayed), commands);
        CheckNetlists(commands, WriteVerilog, agreement);
        CheckNetlists(commands, WriteVhdl, agreement);
        return commands;
    }

private:
    static void Replay(Orn_Hdl::Model& model, const std::string& commands) {
        for (const std::string& line : SplitLines(commands)) {
            EXPECT_EQ(FailureOf([&] { model.ExecuteLine(line); }), "") << line;
        }
    }

    void CheckNetlists(const std::string& commands, std::string (*write)(Orn_Hdl::Model&),
                       Agreement agreement) {
        Orn_Hdl::Model model(&factory_);
        build_(model);
        Orn_Hdl::Model replayed(&factory_);
        Replay(replayed, commands);
        const std::string expected = write(model);
        const std::string actual = write(replayed);
        if (agreement == Agreement::Bytes) {
            EXPECT_EQ(actual, expected) << commands;
        } else {
            EXPECT_EQ(SortedLines(actual), SortedLines(expected)) << commands;
        }
    }

    Build build_;
    Orn_Hdl::CommandFactory factory_;
};

} // namespace Support
