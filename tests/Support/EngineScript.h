/// \file
/// An engine with one current model that is driven by lines of text, and the written netlists as
/// texts.
#pragma once

#include "Orn_Hdl/Orn_Hdl.h"
#include "Support/TemporaryFolder.h"

#include <filesystem>
#include <sstream>
#include <stdexcept>
#include <string>
#include <string_view>
#include <vector>

namespace Support {

/// The pieces of a text between line feeds; a text that ends in one has no further line.
inline std::vector<std::string> SplitLines(const std::string& text) {
    std::vector<std::string> lines;
    std::istringstream stream(text);
    for (std::string line; std::getline(stream, line);) {
        lines.push_back(line);
    }
    return lines;
}

/// What `action` failed with; empty when it did not fail. Anything but the library's own exception
/// passes through.
template <class Action> std::string FailureOf(Action&& action) {
    try {
        action();
    } catch (const Orn_Hdl::Exception& exception) {
        return std::string(exception.getLocalized().GetView());
    }
    return std::string();
}

/// An engine with one model, named "top" at first, which is the current one.
class EngineScript {
public:
    EngineScript() {
        engine_.CreateAndAddModel("top", "");
        engine_.UseModel("top");
        model_ = engine_.GetModel("top");
    }
    explicit EngineScript(const std::string& lines) : EngineScript() { Run(lines); }

    /// Executes every line of a text; a line that fails ends the test with its message.
    void Run(const std::string& lines) {
        for (const std::string& line : SplitLines(lines)) {
            const std::string failure = GetFailure(line);
            if (!failure.empty()) {
                throw std::runtime_error(line + ": " + failure);
            }
        }
    }

    /// The message that a line fails with; empty when it is carried out.
    std::string GetFailure(const std::string& line) {
        return FailureOf([&] { engine_.Execute(line.c_str()); });
    }

    /// What a write command with these words before the file name leaves in a fresh file.
    std::string Verilog(const std::string& words = "-NOHEADER") { return Write("VERILOG", words); }
    std::string Vhdl(const std::string& words = "-NOHEADER") { return Write("VHDL", words); }

    Orn_Hdl::Engine& GetEngine() { return engine_; }
    /// The model, whatever it is named by now.
    Orn_Hdl::Model& GetModel() { return *model_; }
    Orn_Hdl::Netlist& GetNetlist() { return *GetModel().GetNetlist(); }
    Orn_Hdl::HdlOptions& GetOptions() { return *GetModel().GetOptions(); }
    int GetDoneCount() { return GetModel().GetCommandManager()->GetDoneCommandCount(); }

private:
    std::string Write(const std::string& language, const std::string& words) {
        const std::string file = folder_ / "written";
        std::filesystem::remove(file);
        Run("WRITE " + language + " " + words + " " + file);
        return ReadWholeFile(file);
    }

    TemporaryFolder folder_;
    Orn_Hdl::Engine engine_;
    Orn_Hdl::Model* model_;
};

/// Makes a folder the current one for a while.
class CurrentFolder {
public:
    explicit CurrentFolder(const std::string& folder) : former_(std::filesystem::current_path()) {
        std::filesystem::current_path(folder);
    }
    CurrentFolder(const CurrentFolder&) = delete;
    CurrentFolder& operator=(const CurrentFolder&) = delete;
    ~CurrentFolder() { std::filesystem::current_path(former_); }

private:
    std::filesystem::path former_;
};

} // namespace Support
