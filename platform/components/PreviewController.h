#pragma once

#include "platform/Url.h"
#include "platform/ui/BarButtonItem.h"
#include "platform/ui/ViewController.h"

#include <memory>
#include <optional>

namespace platform {
class OperationQueue;
} // namespace platform

namespace platform::components {

class PlaceholderView;
class PreviewController;
struct PreviewContent;

/// Answers what a preview shows. Main thread only.
class PreviewControllerDataSource {
public:
    virtual ~PreviewControllerDataSource() = default;
    virtual std::size_t numberOfPreviewItemsInPreviewController(
        const PreviewController& controller) const = 0;
    /// `index` is below the number of items.
    virtual Url previewControllerPreviewItemAtIndex(
        const PreviewController& controller, std::size_t index) const = 0;
};

/// What the preview may do with a document.
class PreviewControllerDelegate {
public:
    virtual ~PreviewControllerDelegate() = default;
    virtual bool previewControllerCanEditItem(const PreviewController&, const Url&) { return false; }
    virtual bool previewControllerShouldSaveEditedItem(const PreviewController&, const Url&) { return false; }
};

/// The screen that shows one document: a picture, a text, or for everything else its icon with name, kind and
/// size. Content is read off the main thread, within limits (see PreviewLoader); a document that is not
/// downloaded stays where it is. Main thread only.
class PreviewController : public ui::ViewController {
public:
    PreviewController();
    ~PreviewController() override;

    void setDataSource(std::weak_ptr<PreviewControllerDataSource> dataSource);
    void setDelegate(std::weak_ptr<PreviewControllerDelegate> delegate) { _delegate = std::move(delegate); }

    /// Asks the data source again and shows its first document.
    void reloadData();
    /// Reads the document that is shown again; what is shown stays until the new content is there.
    void refreshCurrentPreviewItem();
    /// As of the last reload; nothing when the data source has no document.
    const std::optional<Url>& currentPreviewItem() const { return _item; }

    /// Buttons at the right end of the navigation bar, the first one at the edge.
    const ui::BarButtonItems& additionalRightBarButtonItems() const { return _additionalItems; }
    void setAdditionalRightBarButtonItems(ui::BarButtonItems items);

    void loadView() override;
    void viewDidLoad() override;

    /// What is shown now; null until something is.
    const std::shared_ptr<const PreviewContent>& content() const { return _content; }

private:
    void load();
    void showNothing();
    void showLoadingAfterDelay();
    void show(std::shared_ptr<const PreviewContent> content);
    void setContentView(const std::shared_ptr<ui::View>& contentView);

    std::weak_ptr<PreviewControllerDataSource> _dataSource;
    std::weak_ptr<PreviewControllerDelegate> _delegate;
    std::optional<Url> _item;
    std::shared_ptr<const PreviewContent> _content;
    std::shared_ptr<ui::View> _contentView;
    ui::BarButtonItems _additionalItems;
    std::shared_ptr<OperationQueue> _queue;
    unsigned _generation = 0; ///< of the latest load; an older one that ends is ignored
};

} // namespace platform::components
