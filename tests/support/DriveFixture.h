// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/drive/records/PromiseRecord.h"
#include "host/drive/service/LocalActivityHandOver.h"
#include "host/drive/service/LocalCloudDocumentService.h"
#include "platform/FileCoordinator.h"
#include "platform/NotificationCenter.h"
#include "platform/Services.h"
#include "tests/support/RecordingLog.h"
#include "tests/support/TemporaryDirectory.h"
#include "tests/support/VirtualDispatch.h"

#include <memory>
#include <string>
#include <string_view>

namespace testing_support {

/// A drive in a temporary folder, with an account signed in and the host's real services installed, on queues
/// and a clock that the test drives. Relative paths below start at the drive's top level
/// ("Documents/Notes.txt"); folders that lead to a file are made.
class DriveFixture {
public:
    DriveFixture();
    ~DriveFixture();
    DriveFixture(const DriveFixture&) = delete;
    DriveFixture& operator=(const DriveFixture&) = delete;

    const host::drive::DriveLayout& layout() const { return cloud->layout(); }
    const TemporaryDirectory& folder() const { return _folder; }

    platform::Url url(std::string_view relativePath) const;
    platform::Url writeDocument(std::string_view relativePath, std::string_view content = "content") const;
    platform::Url makeFolder(std::string_view relativePath) const;
    /// Writes the promise of an item; answers the item's logical location.
    platform::Url writePromise(
        std::string_view relativePath, const host::drive::PromiseRecord& promise) const;
    platform::Url writeLink(std::string_view relativePath, const std::string& target) const;
    /// A reference ("....trwref") to a document of a container.
    platform::Url writeReference(
        std::string_view relativePath, const std::string& container, const std::string& path) const;
    /// An alias ("....trwalias") of a path below the documents area, or of an absolute one.
    platform::Url writeAlias(std::string_view relativePath, const std::string& target) const;
    /// Makes a container; answers its documents folder.
    platform::Url makeContainer(
        const std::string& identifier, const host::drive::ContainerRecord& description = {}) const;
    /// Sets an extended attribute; the names are in host::drive::itemMark.
    void mark(const platform::Url& url, const char* attribute, std::string_view value) const;

    void signIn(const std::string& name) const;
    void signOut() const;
    /// Hears of what changed on disk so far and runs all work that is due.
    void settle() const;

    const std::shared_ptr<RecordingLog> log = RecordingLog::install();
    const std::shared_ptr<VirtualDispatch> dispatch = VirtualDispatch::create();
    const std::shared_ptr<platform::NotificationCenter> notifications =
        std::make_shared<platform::NotificationCenter>();

private:
    TemporaryDirectory _folder;

public:
    /// The service under the installed set's cloudDocumentService.
    std::shared_ptr<host::drive::LocalCloudDocumentService> cloud;
    /// The installed set's activityHandOver: this device.
    std::shared_ptr<host::drive::LocalActivityHandOver> handOver;
    /// The installed set's fileCoordinator; what presenters are asked runs before the writer waits.
    std::shared_ptr<platform::FileCoordinator> fileCoordinator;
};

} // namespace testing_support
