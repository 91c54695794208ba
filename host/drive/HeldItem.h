#pragma once

#include "host/drive/DriveEntry.h"

#include <optional>
#include <string>

namespace host::drive {

/// An item that was taken out of its folder under a name that nobody else uses, so that what is looked at is
/// what is then removed. It is put back at the end unless it was removed, and at the next start when the
/// process was killed meanwhile.
class HeldItem {
public:
    /// Takes the item away; `name` is its own or its promise's. Answers 0 and fills `held`, else the errno.
    static int take(const DriveLayout& layout, const DriveEntry& entry, const std::string& name,
        std::optional<HeldItem>& held);
    /// Puts back what processes that are gone had taken. What cannot be put back, because its name is taken
    /// or its folder is gone, stays where it is and is named in the log.
    static void restoreAll(const DriveLayout& layout);

    HeldItem(HeldItem&& other) noexcept;
    HeldItem& operator=(HeldItem&&) = delete;
    ~HeldItem();

    /// Where it is now.
    const host::system::FileDescriptor& folder() const { return _isAside ? _aside : _origin; }
    const std::string& name() const { return _name; }

    /// Removes it for good; answers 0 or the errno, what is left of it being put back then.
    int remove();

private:
    HeldItem() = default;
    int writeRecord(const DriveLayout& layout);
    void putBack();
    void forget();

    host::system::FileDescriptor _origin, _aside; ///< its folder; the private one
    host::system::FileDescriptor _record; ///< locked while this lives
    std::string _originName, _name, _path;
    bool _isAside = false; ///< in the private folder; else beside its old name, on another file system
    std::string _recordPath;
    bool _isThere = false;
};

} // namespace host::drive
