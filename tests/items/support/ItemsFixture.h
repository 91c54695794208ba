// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/drive/records/ItemFacts.h"
#include "platform/Localization.h"
#include "platform/PreviewSupport.h"
#include "tests/items/support/DecoratedCloud.h"
#include "tests/support/DriveFixture.h"
#include "tests/support/SimulatedApps.h"

namespace items_tests {

/// English texts, which are written from left to right unless a test changes that.
class DirectedTexts : public platform::Localization {
public:
    bool rightToLeft = false;

    std::string text(const std::string& key) const override { return key; }
    std::string pluralText(const std::string& key, double) const override { return key; }
    bool isRightToLeft() const override { return rightToLeft; }
};

/// Makes a drive for each test, with decorators in front of the roles that a test may want to fail or to
/// change.
class ItemsFixture : public testing::Test, public testing_support::DriveFixture {
protected:
    ItemsFixture();

    Url at(std::string_view relativePath) const { return url(relativePath); }
    /// Answers the documents folder of the default container.
    Url root() const { return layout().defaultContainerURL(); }
    /// Changes the promised attributes of every item.
    void changeValues(std::function<void(const Url&, AttributeMap&)> change);
    /// Writes a container's description, valid or not. Answers the container's documents folder.
    Url describeContainer(const std::string& identifier, const std::string& description) const;

    std::shared_ptr<DecoratedCloud> decorated;
    std::shared_ptr<DecoratedCoordinator> coordinator;
    std::shared_ptr<testing_support::SimulatedApps> apps = std::make_shared<testing_support::SimulatedApps>();
    std::shared_ptr<DirectedTexts> texts = std::make_shared<DirectedTexts>();
};

/// Writes a file at a path, and makes the folders above it. Answers its location.
Url writeFile(const std::string& path, std::string_view content);

} // namespace items_tests
