#pragma once

#include <functional>
#include <memory>
#include <string>

namespace host::drive {

/// Watches the names directly inside one folder: written, created, replaced, moved, deleted. Works in the
/// main loop (the default GLib context); make and destroy it on the main thread.
class FolderWatch {
public:
    /// Called on the main thread with the name that changed, or empty when changes were lost or the folder
    /// itself went away. Perhaps several times for one change.
    using Handler = std::function<void(const std::string& name)>;

    virtual ~FolderWatch() = default;

    /// Null when the folder cannot be watched (it is missing, or the system's limit is reached).
    static std::unique_ptr<FolderWatch> start(const std::string& folder, Handler handler);
};

} // namespace host::drive
