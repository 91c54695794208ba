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

#include <gmock/gmock.h>

#include <filesystem>
#include <fstream>
#include <memory>
#include <string>
#include <string_view>

namespace testing_support {

/// Answers the content of a file; empty when there is none.
std::string contentOf(const std::string& path);
inline std::string contentOf(const platform::Url& url)
{
    return contentOf(url.path());
}

/// Writes a file and makes the folders above it. Answers its location.
platform::Url writeFile(const std::string& path, std::string_view content);

/// A drive in a temporary folder, with an account signed in and the host's real services installed, on queues
/// and a clock that the test controls. Relative paths below start at the drive's top level
/// ("Documents/Notes.txt"). Folders above a file are made.
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
    /// Writes the promise of an item. Answers the item's logical location.
    platform::Url writePromise(
        std::string_view relativePath, const host::drive::PromiseRecord& promise) const;
    platform::Url writeLink(std::string_view relativePath, const std::string& target) const;
    /// Writes a reference ("....trwref") to a document of a container.
    platform::Url writeReference(
        std::string_view relativePath, const std::string& container, const std::string& path) const;
    /// Writes an alias ("....trwalias") of a path below the documents area, or of an absolute path.
    platform::Url writeAlias(std::string_view relativePath, const std::string& target) const;
    /// Makes a container. Answers its documents folder.
    platform::Url makeContainer(
        const std::string& identifier, const host::drive::ContainerRecord& description = {}) const;
    /// Sets an extended attribute. The names are in host::drive::itemMark.
    void mark(const platform::Url& url, const char* attribute, std::string_view value) const;

    /// Answers whether a change left a temporary file below the drive.
    bool hasTraces() const;

    void signIn(const std::string& name) const;
    void signOut() const;
    /// Delivers the notices of changes on disk so far and runs all work that is due.
    void settle() const;

    const std::shared_ptr<RecordingLog> log = RecordingLog::install();
    const std::shared_ptr<VirtualDispatch> dispatch = VirtualDispatch::create();
    const std::shared_ptr<platform::NotificationCenter> notifications =
        std::make_shared<platform::NotificationCenter>();

private:
    TemporaryDirectory _folder;

public:
    /// These services are installed; a fixture that replaces some of them installs a changed copy.
    platform::ServiceSet installed;
    /// The service behind the installed set's cloudDocumentService.
    std::shared_ptr<host::drive::LocalCloudDocumentService> cloud;
    /// The installed set's activityHandOver, which is this device's.
    std::shared_ptr<host::drive::LocalActivityHandOver> handOver;
    /// The installed set's fileCoordinator. The presenters' work runs before the writer waits.
    std::shared_ptr<platform::FileCoordinator> fileCoordinator;
};

} // namespace testing_support
