// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/drive/records/ItemFacts.h"
#include "platform/PreviewSupport.h"
#include "platform/Services.h"
#include "tests/items/support/DecoratedCloud.h"
#include "tests/support/DriveFixture.h"
#include "tests/support/PlainTexts.h"
#include "tests/support/SimulatedApps.h"

namespace items_tests {

/// Makes a drive for each test, with decorators in front of the roles that a test may want to fail or to
/// change.
class ItemsFixture : public testing::Test, public testing_support::DriveFixture {
protected:
    ItemsFixture()
    {
        installed.appRegistry = apps;
        installed.cloudDocumentService = decorated;
        installed.fileCoordinator = coordinator;
        installed.localization = texts;
        platform::installServices(installed);
    }

    Url at(std::string_view relativePath) const { return url(relativePath); }
    /// Answers the documents folder of the default container.
    Url root() const { return layout().defaultContainerURL(); }
    /// Changes the promised attributes of every item.
    void changeValues(std::function<void(const Url&, AttributeMap&)> change)
    {
        decorated->decoratedItems.changePromised = [change = std::move(change)](
                                                       const Url& location, Result<AttributeMap>& values) {
            if (values.value)
                change(location, *values.value);
        };
    }
    /// Writes a container's description, valid or not. Answers the container's documents folder.
    Url describeContainer(const std::string& identifier, const std::string& description) const
    {
        const auto documents = makeContainer(identifier);
        testing_support::writeFile(layout().containerDescription(identifier), description);
        return documents;
    }

    std::shared_ptr<DecoratedCloud> decorated = std::make_shared<DecoratedCloud>(DriveFixture::cloud);
    std::shared_ptr<DecoratedCoordinator> coordinator =
        std::make_shared<DecoratedCoordinator>(fileCoordinator);
    std::shared_ptr<testing_support::SimulatedApps> apps = std::make_shared<testing_support::SimulatedApps>();
    std::shared_ptr<testing_support::PlainTexts> texts = std::make_shared<testing_support::PlainTexts>();
};

} // namespace items_tests
