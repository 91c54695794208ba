// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "tests/items/support/ItemsFixture.h"

#include "platform/Services.h"

namespace items_tests {

ItemsFixture::ItemsFixture()
{
    decorated = std::make_shared<DecoratedCloud>(DriveFixture::cloud);
    coordinator = std::make_shared<DecoratedCoordinator>(fileCoordinator);
    installed.appRegistry = apps;
    installed.cloudDocumentService = decorated;
    installed.fileCoordinator = coordinator;
    installed.localization = texts;
    platform::installServices(installed);
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
