/// \file
/// `Port::Folder`: a folder that is kept open, so that renaming or replacing it later has no
/// effect.
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

    /// Opens a folder and then closes the one that was open. Null is read as "".
    /// \return 0, or the system's error number.
    int Open(const char* name);
    /// Opens the folder that contains a file, one path component at a time and without following
    /// links, so that no other process can redirect the path out of this folder.
    /// \param path the path of the file below this folder; "." and empty components are ignored.
    /// \param parent receives the folder.
    /// \param name receives the last component of the path; it points into `path`.
    /// \return 0, or the system's error number: ENOTDIR for a component that is a link or not a
    ///         folder, EXDEV for "..", EISDIR for a path that does not end in a name.
    int OpenParent(const char* path, Folder& parent, const char*& name) const;
    /// Closes the folder, if one is open.
    void Close() noexcept;

    /// Whether a folder is open.
    bool IsOpen() const noexcept { return descriptor_ >= 0; }
    /// The system's descriptor, -1 if no folder is open.
    int GetDescriptor() const noexcept { return descriptor_; }

private:
    int OpenAt(int base, const char* name, bool followLinks);

    int descriptor_ = -1;
};

} // namespace Port
