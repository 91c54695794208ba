#pragma once

#include "host/system/FileDescriptor.h"

#include <functional>
#include <memory>

namespace host::system {

/// Tells that something in a folder changed: names came or went, contents were written, attributes set, or
/// the folder itself went away. Where the system has no watches left, it tells nothing.
class FolderWatcher {
public:
    /// Make it on the main thread; `changed` is called there (in GLib's default main context), once for all
    /// changes that one turn of the loop brings.
    explicit FolderWatcher(std::function<void()> changed);
    ~FolderWatcher();
    FolderWatcher(const FolderWatcher&) = delete;
    FolderWatcher& operator=(const FolderWatcher&) = delete;

    /// Watches the very folder that is open here instead of what was watched before. Any thread.
    void watch(const FileDescriptor& folder);

private:
    struct State;
    std::shared_ptr<State> _state;
};

} // namespace host::system
