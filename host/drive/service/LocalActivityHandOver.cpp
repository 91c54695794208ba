// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/service/LocalActivityHandOver.h"

#include "host/drive/records/AccountRecord.h"
#include "host/drive/records/DeviceIdentity.h"
#include "host/drive/records/SmallFile.h"
#include "platform/CloudDocumentService.h"
#include "platform/Log.h"
#include "platform/Weakly.h"

#include <algorithm>
#include <filesystem>
#include <utility>

namespace host::drive {

namespace {

using platform::Date;
using platform::weakly;

/// Answers whether a record is recent. A time in the future counts like one in the past, because the clocks
/// of two devices differ.
bool isRecent(Date time, Date now)
{
    const auto silence = now.nanoseconds - time.nanoseconds;
    const auto longest = ActivityPublication::longestSilence.count();
    return silence < longest && silence > -longest;
}

std::optional<ActivityRecord> readRecord(const std::filesystem::path& path)
{
    static constexpr platform::Operation op{"-[LocalActivityHandOver readRecord:]"};
    const auto text = readSmallFile(path.string(), ActivityRecord::maximumFileSize);
    auto record = text ? ActivityRecord::parse(*text) : std::nullopt;
    const bool isGone = text.error && text.error->is(platform::FileErrorCode::NoSuchItem);
    if (record && ActivityRecord::fileName(record->device) == path.filename().string())
        return record;
    if (!isGone)
        op.info("Not an activity of a device: %@", path.string());
    return std::nullopt;
}

const std::string* bookmarkOf(const ActivityRecord& record)
{
    const auto* value = platform::find(record.activity.userInfo, platform::activityKey::documentURL);
    return value ? value->get<std::string>() : nullptr;
}

/// Answers the bookmark of the document that this device shows; empty for none.
std::string ownBookmark(const std::string& path)
{
    const auto text = readSmallFile(path, ActivityRecord::maximumFileSize);
    const auto record = text ? ActivityRecord::parse(*text) : std::nullopt;
    const auto* bookmark = record ? bookmarkOf(*record) : nullptr;
    return bookmark ? *bookmark : std::string();
}

/// Answers the recent records of the account's other devices, without the document that this device shows.
std::vector<ActivityRecord> readRecords(const DriveLayout& layout, Date now)
{
    const auto account = AccountRecord::read(layout);
    if (!account)
        return {};
    const auto own = ActivityRecord::fileName(DeviceIdentity::identifierAt(layout.device()));
    const auto shownHere = ownBookmark(layout.activities() + '/' + own);
    std::vector<ActivityRecord> records;
    std::error_code problem;
    std::filesystem::directory_iterator entries(layout.activities(), problem);
    for (std::size_t seen = 0; !problem && entries != std::filesystem::directory_iterator();
         entries.increment(problem)) {
        const auto name = entries->path().filename().string();
        if (name.starts_with('.') || name == own)
            continue;
        if (++seen > LocalActivityHandOver::mostDevices)
            break;
        auto record = readRecord(entries->path());
        const auto* bookmark = record ? bookmarkOf(*record) : nullptr;
        if (bookmark && *bookmark != shownHere && record->account == account->identity
            && isRecent(record->time, now))
            records.push_back(std::move(*record));
    }
    return records;
}

} // namespace

std::shared_ptr<LocalActivityHandOver> LocalActivityHandOver::create(const DriveLayout& layout,
    const DriveDependencies& dependencies, std::shared_ptr<platform::CloudDocumentService> cloud)
{
    std::shared_ptr<LocalActivityHandOver> handOver(
        new LocalActivityHandOver(layout, dependencies, std::move(cloud)));
    handOver->begin();
    return handOver;
}

LocalActivityHandOver::LocalActivityHandOver(const DriveLayout& layout, const DriveDependencies& dependencies,
    std::shared_ptr<platform::CloudDocumentService> cloud)
    : _layout(layout)
    , _dispatch(dependencies.dispatch)
    , _notifications(dependencies.notificationCenter)
    , _cloud(std::move(cloud))
    , _queue(_dispatch->makeSerialQueue("TarrowDriveAppID.activities"))
    , _publication(std::make_shared<ActivityPublication>(layout, _dispatch))
{
}

void LocalActivityHandOver::begin()
{
    _identity = _notifications->observe(
        platform::Notification::CloudIdentityDidChange, weakly(this, &LocalActivityHandOver::readAgain));
    _folder = FollowedFolder::follow(_dispatch, _layout.activities(), FollowedFolder::IfMissing::Make,
        weakly(this, &LocalActivityHandOver::readAgain));
    if (_folder->isWatched())
        readAgain();
}

void LocalActivityHandOver::readAgain()
{
    if (std::exchange(_readingWaits, true)) {
        _readAgain = true;
        return;
    }
    _queue->async(
        [weak = weak_from_this(), layout = _layout, now = _dispatch->now(), main = _dispatch->mainQueue()] {
            main->async(weakly(weak, &LocalActivityHandOver::recordsRead, readRecords(layout, now)));
        });
}

void LocalActivityHandOver::recordsRead(const Records& records)
{
    ++_reading;
    _found.clear();
    _undecided = records.size();
    for (const auto& record : records) {
        _cloud->items().decodeBookmark(*bookmarkOf(record),
            [weak = weak_from_this(), reading = _reading, record, main = _dispatch->mainQueue()](
                const platform::Result<platform::Url>& document) {
                main->async(weakly(weak, &LocalActivityHandOver::documentDecided, reading, record, document));
            });
    }
    if (records.empty())
        readingEnded();
}

void LocalActivityHandOver::documentDecided(
    unsigned reading, const ActivityRecord& record, const platform::Result<platform::Url>& document)
{
    static constexpr platform::Operation op{"-[LocalActivityHandOver documentDecided:]"};
    if (reading != _reading)
        return;
    if (document)
        _found.push_back({record.device, record.deviceName, record.activity, *document, record.time});
    else
        op.info("Not offering the activity of %@: %@", record.deviceName, document.error);
    if (--_undecided == 0)
        readingEnded();
}

void LocalActivityHandOver::readingEnded()
{
    _readingWaits = false;
    if (std::exchange(_readAgain, false))
        readAgain();
    std::ranges::sort(_found, [](const auto& a, const auto& b) {
        return std::pair(b.time, a.deviceIdentifier) < std::pair(a.time, b.deviceIdentifier);
    });
    auto before = std::exchange(_offers, std::exchange(_found, {}));
    readAgainWhenOneIsOld();
    if (before != _offers)
        _notifications->post(platform::Notification::ActivityOffersDidChange);
}

void LocalActivityHandOver::readAgainWhenOneIsOld()
{
    if (_offers.empty())
        return;
    const auto age = _dispatch->now().nanoseconds - _offers.back().time.nanoseconds;
    const auto left =
        ActivityPublication::longestSilence - platform::Duration(std::max<std::int64_t>(age, 0));
    _dispatch->after(
        left, _dispatch->mainQueue(), weakly(this, [reading = _reading](LocalActivityHandOver& self) {
            if (self._reading == reading)
                self.readAgain();
        }));
}

} // namespace host::drive
