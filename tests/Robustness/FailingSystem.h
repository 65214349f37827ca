/// \file
/// File calls of which the N-th one fails.
#pragma once

#include "Port/System.h"

#include <cerrno>

namespace Robustness {

class FailingSystem : public Port::System {
public:
    enum Extent { Once, FromThenOn };

    /// \param failing the number, from 1, of the first call that fails; with 0 none fails.
    FailingSystem(int failing, int error, Extent extent = Once)
        : failing_(failing), error_(error), extent_(extent) {
        System::Replace(this);
    }
    FailingSystem(const FailingSystem&) = delete;
    FailingSystem& operator=(const FailingSystem&) = delete;
    ~FailingSystem() override { System::Replace(nullptr); }

    int GetCallCount() const noexcept { return calls_; }

    int Open(const char* name, int flags, unsigned mode) override {
        return Fails() ? -1 : System::Open(name, flags, mode);
    }
    ssize_t Read(int descriptor, void* buffer, std::size_t size) override {
        return Fails() ? -1 : System::Read(descriptor, buffer, size);
    }
    ssize_t Write(int descriptor, const void* data, std::size_t size) override {
        return Fails() ? -1 : System::Write(descriptor, data, size);
    }
    int Close(int descriptor) override {
        // The descriptor is free afterwards, whatever the call tells.
        const int result = System::Close(descriptor);
        return Fails() ? -1 : result;
    }
    int GetStatus(int descriptor, struct stat* status) override {
        return Fails() ? -1 : System::GetStatus(descriptor, status);
    }
    int Truncate(int descriptor, off_t size) override {
        return Fails() ? -1 : System::Truncate(descriptor, size);
    }
    int ChangeMode(int descriptor, unsigned mode) override {
        return Fails() ? -1 : System::ChangeMode(descriptor, mode);
    }
    ssize_t ReadLink(const char* name, char* target, std::size_t size) override {
        return Fails() ? -1 : System::ReadLink(name, target, size);
    }
    int Rename(const char* from, const char* to) override {
        return Fails() ? -1 : System::Rename(from, to);
    }
    int OpenAt(int folder, const char* name, int flags, unsigned mode) override {
        return Fails() ? -1 : System::OpenAt(folder, name, flags, mode);
    }
    int RenameAt(int folder, const char* from, const char* to) override {
        return Fails() ? -1 : System::RenameAt(folder, from, to);
    }

private:
    bool Fails() noexcept {
        ++calls_;
        if (failing_ == 0 || calls_ < failing_ || (extent_ == Once && calls_ > failing_)) {
            return false;
        }
        errno = error_;
        return true;
    }

    int failing_;
    int error_;
    Extent extent_;
    int calls_ = 0;
};

} // namespace Robustness
