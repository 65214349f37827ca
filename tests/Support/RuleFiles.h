// The command files of the check's rules, and what is expected of them.
#pragma once

#include "Orn_Hdl/Orn_Hdl.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <memory>
#include <string>
#include <vector>

namespace Support {

/// A file's bytes; empty when there is none.
inline std::string ReadBytes(const std::filesystem::path& path) {
    std::ifstream in(path, std::ios::binary);
    return std::string(std::istreambuf_iterator<char>(in), {});
}

/// One folder a rule, with a file that it finds something in, bad.cmd, and one in which it does
/// not.
inline std::vector<std::filesystem::path> RuleFolders() {
    std::vector<std::filesystem::path> folders;
    const auto root = std::filesystem::path(ORN_HDL_TEST_DATA) / "check" / "rules";
    for (const auto& entry : std::filesystem::directory_iterator(root)) {
        folders.push_back(entry.path());
    }
    std::sort(folders.begin(), folders.end());
    return folders;
}

/// The design of a command file.
inline std::unique_ptr<Orn_Hdl::Model> ReadDesign(Orn_Hdl::CommandFactory& factory,
                                                  const std::filesystem::path& file) {
    auto model = std::make_unique<Orn_Hdl::Model>(&factory);
    EXPECT_TRUE(model->Read(file.c_str())) << file;
    return model;
}

/// Compares a text with a file. With ORN_HDL_UPDATE in the environment, the file is written
/// instead; the real tools are asked before it is committed.
inline void ExpectFile(const std::filesystem::path& file, const std::string& text) {
    if (std::getenv("ORN_HDL_UPDATE") != nullptr && ReadBytes(file) != text) {
        if (text.empty()) {
            std::filesystem::remove(file);
        } else {
            std::ofstream(file, std::ios::binary) << text;
        }
    }
    EXPECT_EQ(text, ReadBytes(file)) << file;
}

} // namespace Support
