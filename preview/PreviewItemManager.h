#pragma once

#include "platform/Date.h"
#include "platform/NotificationCenter.h"
#include "platform/Url.h"
#include "platform/components/DocumentListController.h"
#include "platform/ui/NavigationController.h"
#include "platform/ui/ViewController.h"
#include "preview/PreviewMode.h"

#include <memory>
#include <optional>
#include <vector>

namespace tarrow {

class DRItem;
class LookwellItemController;

/// Coordinates the preview of one document: chooses its screen, puts it on the browser's stack and leads the
/// stack to another place. Main thread only.
///
/// Both preview modes show the quick preview, as it is the only preview screen. Being registered as the
/// item's presenter is a state that is kept here; nothing reports changes of the item yet.
class PreviewItemManager : public std::enable_shared_from_this<PreviewItemManager> {
public:
    static std::shared_ptr<PreviewItemManager> newItemManagerWithModeNavController(
        int mode, const std::shared_ptr<platform::ui::NavigationController>& navigationController);
    /// Without a navigation controller the manager prepares screens but shows none.
    static std::shared_ptr<PreviewItemManager> init();

    PreviewItemManager();
    ~PreviewItemManager();

    const std::shared_ptr<DRItem>& item() const { return _item; }
    int mode() const { return _mode; }
    void setMode(int mode) { _mode = mode; }
    std::shared_ptr<platform::ui::NavigationController> navigationController() const
    {
        return _navigationController.lock();
    }
    void setNavigationController(std::weak_ptr<platform::ui::NavigationController> navigationController);

    /// Shows an item. Null only forgets the current one.
    void previewItem(const std::shared_ptr<DRItem>& item);
    void setItem(const std::shared_ptr<DRItem>& item);
    /// With an item and `updatePreview` its screen is prepared and shown; otherwise it is only kept.
    void setItemUpdatePreview(const std::shared_ptr<DRItem>& item, bool updatePreview);
    /// Makes an item the current one and answers the screen that shows it; null when there is nothing to
    /// show.
    std::shared_ptr<platform::ui::ViewController> prepareToPreviewItem(const std::shared_ptr<DRItem>& item);

    std::shared_ptr<LookwellItemController> createLookwellController();
    std::shared_ptr<LookwellItemController> currentLookwellController() const;
    /// Shows a screen in place of the preview on top of the stack, else on top of the stack; a search that
    /// lies over the stack is dismissed first.
    void replaceLastViewController(const std::shared_ptr<platform::ui::ViewController>& screen);
    bool isPreviewControllerDisplayed(const std::shared_ptr<platform::ui::ViewController>& screen) const;

    using ListStack = std::vector<std::shared_ptr<platform::components::DocumentListController>>;
    /// The lists from the drive's top level to the folder of a URL; nothing when it leads to no folder of the
    /// drive.
    static std::optional<ListStack> dlcStackForURL(const platform::Url& url);
    /// Replaces the whole stack by the lists that lead to a URL and, for a document, its preview. False, and
    /// nothing changes, when there is no way to it.
    bool warpToNewURL(const platform::Url& url);

    bool filePresenterRegistered() const { return _filePresenterRegistered; }
    void registerAsFilePresenter();
    void unregisterAsFilePresenter();

private:
    void observeApplication();
    void didBecomeActiveNotification();
    void willResignActiveNotification();

    std::shared_ptr<DRItem> _item;
    int _mode = PreviewModeQuick;
    bool _filePresenterRegistered = false;
    std::optional<platform::Date> _modifiedDate;
    std::weak_ptr<platform::ui::NavigationController> _navigationController;
    std::vector<platform::Observation> _observations;
};

} // namespace tarrow
