// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/controllers/AlertController.h"
#include "kit/views/ListView.h"
#include "platform/LinkOpener.h"
#include "platform/Services.h"
#include "tests/screens/support/HandLister.h"
#include "tests/support/DriveFixture.h"
#include "tests/support/RecordingSharing.h"
#include "tests/support/SimulatedApps.h"

#include <algorithm>

namespace testing_support {

using Lines = std::vector<std::string>;

class RecordingLinks : public platform::LinkOpener {
public:
    void openLink(const std::string& url, Completion completion) override
    {
        opened.push_back(url);
        completion(answer);
    }
    Lines opened;
    std::optional<platform::Error> answer;
};

/// The screens on a real drive in a temporary folder. Only the listings come from the test.
class ScreensFixture : public testing::Test {
protected:
    ScreensFixture()
    {
        auto set = drive.installed;
        set.appRegistry = apps;
        set.documentSharing = sharing;
        set.folderLister = lister;
        set.linkOpener = links;
        platform::installServices(std::move(set));
    }

    static Lines titles(const kit::ListView& list)
    {
        Lines found;
        for (std::size_t row = 0; row < list.rowCount(); ++row)
            found.push_back(list.row(row).title);
        return found;
    }
    /// Answers the alert that lies over a screen; null without one.
    static std::shared_ptr<kit::AlertController> alertOver(const kit::ViewController& screen)
    {
        return std::dynamic_pointer_cast<kit::AlertController>(screen.presentedViewController());
    }
    /// Presses the alert's button of this title, and runs what follows.
    void pressTitled(const std::shared_ptr<kit::AlertController>& alert, const std::string& title) const
    {
        ASSERT_TRUE(alert);
        const auto action = std::ranges::find(alert->actions(), title, &kit::AlertAction::title);
        ASSERT_NE(action, alert->actions().end()) << title;
        alert->press(*action);
        drive.dispatch->runUntilIdle();
    }

    DriveFixture drive;
    std::shared_ptr<HandLister> lister = std::make_shared<HandLister>();
    std::shared_ptr<RecordingLinks> links = std::make_shared<RecordingLinks>();
    std::shared_ptr<RecordingSharing> sharing = std::make_shared<RecordingSharing>();
    std::shared_ptr<SimulatedApps> apps = std::make_shared<SimulatedApps>();
};

} // namespace testing_support
