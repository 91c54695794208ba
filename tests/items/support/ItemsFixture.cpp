// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "tests/items/support/ItemsFixture.h"

#include "host/system/desktop/MimeTypeRegistry.h"
#include "host/system/desktop/TypePreviewSupport.h"
#include "host/system/files/JsonKeyedArchiver.h"
#include "host/system/files/JsonUserDefaults.h"
#include "host/system/files/PosixFileSystem.h"
#include "host/system/listing/ThreadedFolderLister.h"
#include "host/system/texts/IcuFormatters.h"
#include "host/system/texts/UnicodeCharacterData.h"
#include "platform/Services.h"

#include <filesystem>
#include <fstream>

namespace items_tests {

ItemsFixture::ItemsFixture()
{
    decorated = std::make_shared<DecoratedCloud>(DriveFixture::cloud);
    coordinator = std::make_shared<DecoratedCoordinator>(fileCoordinator);
    platform::ServiceSet set;
    set.appRegistry = apps;
    set.characterData = std::make_shared<host::system::UnicodeCharacterData>();
    set.cloudDocumentService = decorated;
    set.dispatch = dispatch;
    set.fileCoordinator = coordinator;
    set.fileChanges = DriveFixture::cloud->fileChanges();
    set.fileSystem = std::make_shared<host::system::PosixFileSystem>();
    set.formatters = std::make_shared<host::system::IcuFormatters>("en_US", "UTC");
    set.localization = texts;
    set.notificationCenter = notifications;
    const auto types = std::make_shared<host::system::MimeTypeRegistry>();
    set.typeRegistry = types;
    set.folderLister = std::make_shared<host::system::ThreadedFolderLister>(dispatch, types, "en_US");
    set.previewSupport = std::make_shared<host::system::TypePreviewSupport>(set.typeRegistry);
    // A list reads its last order from these two.
    set.keyedArchiver = std::make_shared<host::system::JsonKeyedArchiver>();
    set.userDefaults = std::make_shared<host::system::JsonUserDefaults>(layout().defaults(), *dispatch);
    platform::installServices(std::move(set));
}

ItemsFixture::~ItemsFixture()
{
    platform::installServices({});
}

void ItemsFixture::changeValues(std::function<void(const Url&, AttributeMap&)> change)
{
    decorated->decoratedItems.changePromised = [change = std::move(change)](
                                                   const Url& location, Result<AttributeMap>& values) {
        if (values.value)
            change(location, *values.value);
    };
}

Url ItemsFixture::describeContainer(const std::string& identifier, const std::string& description) const
{
    const auto documents = makeContainer(identifier);
    writeFile(layout().containerDescription(identifier), description);
    return documents;
}

Url writeFile(const std::string& path, std::string_view content)
{
    std::filesystem::create_directories(std::filesystem::path(path).parent_path());
    std::ofstream(path, std::ios::binary) << content;
    return Url::fileURL(path);
}

} // namespace items_tests
