// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/records/FollowedFile.h"

#include "host/system/files/ItemPaths.h"
#include "platform/Log.h"
#include "platform/Weakly.h"

#include <utility>

namespace host::drive {

std::shared_ptr<FollowedFile> FollowedFile::follow(
    std::shared_ptr<platform::Dispatch> dispatch, std::string path, const std::string& queueName, Read read)
{
    std::shared_ptr<FollowedFile> file(
        new FollowedFile(std::move(dispatch), std::move(path), queueName, std::move(read)));
    file->begin();
    return file;
}

FollowedFile::FollowedFile(
    std::shared_ptr<platform::Dispatch> dispatch, std::string path, const std::string& queueName, Read read)
    : _dispatch(std::move(dispatch))
    , _path(std::move(path))
    , _read(std::move(read))
    , _queue(_dispatch->makeSerialQueue(queueName))
{
}

void FollowedFile::begin()
{
    static constexpr platform::Operation op{"-[FollowedFile begin]"};
    _folder = FollowedFolder::follow(_dispatch, system::parentPath(_path), FollowedFolder::IfMissing::Wait,
        platform::weakly(this, [](FollowedFile& self, const std::vector<std::string>& names) {
            if (mayHaveChanged(names, system::lastName(self._path)))
                self.readAgain();
        }));
    if (!_folder->isWatched())
        op.warning("Cannot watch the folder of %@", _path);
}

void FollowedFile::readAgain()
{
    if (_readingWaits->exchange(true))
        return;
    _queue->async([waits = _readingWaits, read = _read, main = _dispatch->mainQueue()] {
        // The flag is cleared before the reading, so that a change during the reading leads to another one.
        waits->store(false);
        main->async(read());
    });
}

} // namespace host::drive
