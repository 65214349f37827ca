/// \file
/// `Port::Folder`: a folder that is kept open, so that what its name leads to later does not
/// matter.
#pragma once

#include "Port/Export.h"

namespace Port {

/// One open folder, or none. Closed by its destructor.
class ORN_HDL_API Folder {
public:
    /// No folder is open.
    Folder() noexcept = default;
    /// Closes the folder.
    ~Folder();
    Folder(const Folder&) = delete;
    Folder& operator=(const Folder&) = delete;

    /// Opens a folder, and then closes the one that was open. Null is read as "".
    /// \return 0, or the system's error number.
    int Open(const char* name);
    /// Opens the folder in which a file lies, step by step and without following a link: no other
    /// process can make the way lead out of this folder.
    /// \param path the file, below this folder; "." and empty steps count nothing.
    /// \param parent receives the folder.
    /// \param name receives the last step of the path; it points into `path`.
    /// \return 0, or the system's error number: ENOTDIR for a step that is a link or no folder,
    ///         EXDEV for "..", EISDIR for a path that does not end in a name.
    int OpenParent(const char* path, Folder& parent, const char*& name) const;
    /// Closes the folder; without one nothing happens.
    void Close() noexcept;

    /// Whether a folder is open.
    bool IsOpen() const noexcept { return descriptor_ >= 0; }
    /// The system's descriptor, -1 when no folder is open.
    int GetDescriptor() const noexcept { return descriptor_; }

private:
    int OpenAt(int base, const char* name, bool followLinks);

    int descriptor_ = -1;
};

} // namespace Port
