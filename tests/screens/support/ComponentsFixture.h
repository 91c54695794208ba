// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/LinkOpener.h"
#include "platform/Services.h"
#include "screens/list/DocumentListController.h"
#include "screens/list/DocumentListControllerDelegate.h"
#include "tests/screens/support/HandLister.h"
#include "tests/support/DriveFixture.h"
#include "tests/support/ForwardingCoordinator.h"
#include "tests/support/RecordingSharing.h"
#include "tests/support/SimulatedApps.h"

#include <functional>

namespace testing_support {

/// Counts the reads that go through it to the real coordinator.
class CountingCoordinator : public ForwardingCoordinator {
public:
    using ForwardingCoordinator::ForwardingCoordinator;
    Failure coordinateReading(
        const Url& url, platform::ReadingOptions options, const Accessor& accessor) override;
    std::vector<std::string> takeReads();

private:
    std::vector<std::string> _names;
};

class RecordingLinks : public platform::LinkOpener {
public:
    void openLink(const std::string& url, Completion completion) override
    {
        opened.push_back(url);
        completion(answer);
    }
    std::vector<std::string> opened;
    std::optional<platform::Error> answer;
};

/// Records what a folder list reports, one line for each call.
class RecordingListDelegate : public screens::DocumentListControllerDelegate {
public:
    void documentListControllerDidSelectContainerWithViewController(
        const List& list, const List& container) override;
    void documentListControllerDidSelectItemAtURL(const List& list, const platform::Url& url) override;
    void documentListControllerItemsChanged(const List& list) override;
    void documentListControllerURLWasRemoved(const List& list) override;
    void documentListControllerPerformActionURLOriginatingViewCompletion(const List& list, int action,
        const platform::Url& url, const std::shared_ptr<kit::View>& view,
        const Completion& completion) override;

    void documentListControllerRequestsEditing(const List& list) override;
    std::shared_ptr<kit::ViewController> documentListControllerViewControllerForPreviewingItemAtURL(
        const List&, const platform::Url&) override
    {
        return preview;
    }

    std::vector<std::string> take();

    std::shared_ptr<kit::ViewController> preview; ///< the screen for a peek
    bool allowsEditing = false;

private:
    std::vector<std::string> _lines;
};

/// The screens on a real drive in a temporary folder. Only the listings come from the test, unless it asks
/// for the real ones.
class ComponentsFixture : public testing::Test {
protected:
    using List = std::shared_ptr<screens::DocumentListController>;

    ComponentsFixture();

    /// Answers a list of a folder with room for about ten rows, loaded, shown and watched by `delegate`.
    List shownList(const platform::Url& folder);
    void deliver(const List& list, const HandLister::Entries& entries,
        platform::ListingStage stage = platform::ListingStage::Complete);
    std::vector<std::string> titles(const List& list) const;

    /// From now on lists read the disk and follow it.
    void useRealLister();
    /// Runs the kernel's notices and the virtual clock until the condition holds. Answers false when it never
    /// does.
    bool waitUntil(const std::function<bool()>& condition);

    DriveFixture drive;
    std::shared_ptr<HandLister> lister = std::make_shared<HandLister>();
    std::shared_ptr<RecordingLinks> links = std::make_shared<RecordingLinks>();
    std::shared_ptr<RecordingSharing> sharing = std::make_shared<RecordingSharing>();
    std::shared_ptr<SimulatedApps> apps = std::make_shared<SimulatedApps>();
    std::shared_ptr<CountingCoordinator> coordinator =
        std::make_shared<CountingCoordinator>(drive.fileCoordinator);
    std::shared_ptr<RecordingListDelegate> delegate = std::make_shared<RecordingListDelegate>();

private:
    void install(std::shared_ptr<platform::FolderLister> folderLister);
};

} // namespace testing_support
