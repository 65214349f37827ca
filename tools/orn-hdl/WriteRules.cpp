#include "WriteRules.h"

#include "Port/Folder.h"

#include <algorithm>
#include <filesystem>
#include <system_error>

namespace Tool {

namespace fs = std::filesystem;

namespace {

constexpr const char* Outside = "it leads out of the output folder";

/// Rejects every file.
class NothingMayBeWritten : public Orn_Hdl::OutputGuard {
public:
    Port::StringBase<char> WhyNot(const char* /*fileName*/) override {
        return "--no-write is in force";
    }
};

/// Confines output to one folder, which is the current folder during the lifetime of this object.
class OutputFolder : public Orn_Hdl::OutputGuard {
public:
    explicit OutputFolder(const fs::path& folder) : former_(fs::current_path()) {
        fs::current_path(folder);
        folder_ = fs::current_path();
        if (const int error = open_.Open("."); error != 0) {
            fs::current_path(former_);
            throw std::system_error(error, std::generic_category());
        }
    }
    ~OutputFolder() override {
        std::error_code error;
        fs::current_path(former_, error);
    }

    Port::StringBase<char> WhyNot(const char* fileName) override;
    const Port::Folder* GetFolder(const char* /*fileName*/, Port::StringBase<char>& path) override {
        path = allowed_.c_str();
        return &open_;
    }

private:
    /// Whether a path without links and ".." lies below the folder.
    bool Holds(const fs::path& path) const {
        return std::mismatch(folder_.begin(), folder_.end(), path.begin(), path.end()).first ==
               folder_.end();
    }

    /// Allows the file at a path without links and "..". The file is opened by that path below the
    /// open folder: a link that is created there after the check is not followed.
    Port::StringBase<char> Allow(const fs::path& path) {
        allowed_ = path.string();
        return "";
    }

    const fs::path former_;
    fs::path folder_;
    Port::Folder open_;
    /// The file that was allowed last, below the folder.
    std::string allowed_;
};

Port::StringBase<char> OutputFolder::WhyNot(const char* fileName) {
    const fs::path name(fileName);
    if (name.has_root_path() || std::find(name.begin(), name.end(), "..") != name.end()) {
        return Outside;
    }
    std::error_code error;
    const fs::path parent = fs::canonical(folder_ / name.parent_path(), error);
    if (error) {
        // There is no such folder. Opening the file will fail and report the reason.
        return Allow(name);
    }
    if (!Holds(parent)) {
        return Outside;
    }
    switch (fs::symlink_status(name, error).type()) {
    case fs::file_type::not_found:
    case fs::file_type::regular:
    case fs::file_type::directory:
        return Allow(parent.lexically_relative(folder_) / name.filename());
    case fs::file_type::symlink: {
        // Writing through a link without a target would create the target.
        const fs::path target = fs::canonical(name, error);
        return !error && Holds(target) && fs::is_regular_file(target, error)
                   ? Allow(target.lexically_relative(folder_))
                   : Outside;
    }
    default:
        return "it is not a regular file";
    }
}

std::unique_ptr<Orn_Hdl::OutputGuard> MakeGuard(const WriteRules& rules) {
    if (rules.noWrite) {
        return std::make_unique<NothingMayBeWritten>();
    }
    return rules.folder ? std::make_unique<OutputFolder>(*rules.folder) : nullptr;
}

} // namespace

RulesInForce::RulesInForce(Orn_Hdl::Model& model, const WriteRules& rules)
    : model_(model), guard_(MakeGuard(rules)) {
    model_.SetOutputGuard(guard_.get());
}

RulesInForce::~RulesInForce() {
    model_.SetOutputGuard(nullptr);
}

} // namespace Tool
