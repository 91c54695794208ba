#include "platform/components/PreviewController.h"

#include "platform/Dispatch.h"
#include "platform/Localization.h"
#include "platform/Services.h"
#include "platform/components/DisplayName.h"
#include "platform/components/PlaceholderView.h"
#include "platform/components/PreviewLoader.h"
#include "platform/ui/ImageView.h"
#include "platform/ui/Label.h"
#include "platform/ui/NavigationItem.h"
#include "platform/ui/StandardColors.h"
#include "platform/ui/TextView.h"

#include <chrono>
#include <utility>

namespace platform::components {

namespace {

/// A document that is read sooner never shows that it was loading.
constexpr auto loadingDelay = std::chrono::milliseconds(300);
constexpr double noteHeight = 32;

std::shared_ptr<ui::View> imageView(const PreviewContent& content)
{
    const auto view = std::make_shared<ui::ImageView>(content.image);
    view->setContentMode(ui::ContentMode::AspectFit);
    view->setAccessibilityLabel(content.title);
    return view;
}

std::shared_ptr<ui::View> textView(const PreviewContent& content)
{
    const auto text = std::make_shared<ui::TextView>(content.text);
    text->setSpacing(content.isMonospaced ? ui::TextSpacing::Monospaced : ui::TextSpacing::Proportional);
    text->setAccessibilityLabel(content.title);
    if (content.note.empty())
        return text;
    const auto note = std::make_shared<ui::Label>(content.note);
    note->setFont(ui::Font::preferred(ui::TextStyle::Footnote));
    note->setAlignment(ui::TextAlignment::Center);
    note->setTextColor(ui::StandardColors::gray);
    const auto view = std::make_shared<ui::View>();
    for (const auto& part : std::initializer_list<std::shared_ptr<ui::View>>{note, text}) {
        part->setPlacedByFrame(false);
        view->addSubview(part);
        ui::LayoutConstraint::activate({part->leadingAnchor().equalTo(view->leadingAnchor()),
            part->trailingAnchor().equalTo(view->trailingAnchor())});
    }
    ui::LayoutConstraint::activate({note->topAnchor().equalTo(view->topAnchor()),
        note->heightAnchor().equalToConstant(noteHeight), text->topAnchor().equalTo(note->bottomAnchor()),
        text->bottomAnchor().equalTo(view->bottomAnchor())});
    return view;
}

std::shared_ptr<ui::View> placeholder(const PlaceholderView::Content& content)
{
    const auto view = PlaceholderView::create();
    view->setContent(content);
    return view;
}

std::shared_ptr<ui::View> viewFor(const PreviewContent& content)
{
    switch (content.kind) {
    case PreviewContent::Kind::Image:
        return imageView(content);
    case PreviewContent::Kind::Text:
        return textView(content);
    case PreviewContent::Kind::Summary:
    case PreviewContent::Kind::InCloud:
    case PreviewContent::Kind::Failure:
        break;
    }
    return placeholder({.iconName = content.iconName, .title = content.title, .message = content.note});
}

} // namespace

PreviewController::PreviewController() = default;

PreviewController::~PreviewController() = default;

void PreviewController::setDataSource(std::weak_ptr<PreviewControllerDataSource> dataSource)
{
    _dataSource = std::move(dataSource);
}

void PreviewController::loadView()
{
    setView(std::make_shared<ui::View>());
}

void PreviewController::viewDidLoad()
{
    if (_content)
        setContentView(viewFor(*_content));
    else if (_item)
        showLoadingAfterDelay();
    else
        showNothing();
}

void PreviewController::setAdditionalRightBarButtonItems(ui::BarButtonItems items)
{
    _additionalItems = std::move(items);
    navigationItem().setRightItems(_additionalItems);
}

void PreviewController::reloadData()
{
    const auto source = _dataSource.lock();
    const bool hasItem = source && source->numberOfPreviewItemsInPreviewController(*this) > 0;
    _item = hasItem ? std::optional(source->previewControllerPreviewItemAtIndex(*this, 0)) : std::nullopt;
    _content = nullptr;
    ++_generation;
    setTitle(_item ? displayName(_item->lastPathComponent()) : std::string());
    if (!_item)
        return showNothing();
    setContentView(nullptr);
    load();
    showLoadingAfterDelay();
}

void PreviewController::refreshCurrentPreviewItem()
{
    if (_item)
        load();
}

void PreviewController::load()
{
    const auto self = std::static_pointer_cast<PreviewController>(shared_from_this());
    const auto main = services().dispatch().mainQueue();
    // What an earlier load has not begun yet goes with its queue.
    _queue = services().dispatch().makeOperationQueue("preview", QualityOfService::UserInitiated);
    _queue->addOperation([weak = std::weak_ptr(self), item = *_item, limits = previewLimitsForMainScreen(),
                             generation = ++_generation, main] {
        const auto content = std::make_shared<const PreviewContent>(loadPreview(item, limits));
        main->async([weak, content, generation] {
            if (const auto screen = weak.lock(); screen && screen->_generation == generation)
                screen->show(content);
        });
    });
}

void PreviewController::show(std::shared_ptr<const PreviewContent> content)
{
    _content = std::move(content);
    setTitle(_content->title);
    setContentView(viewFor(*_content));
}

void PreviewController::showNothing()
{
    setContentView(placeholder({.title = localized("Nothing to show")}));
}

void PreviewController::showLoadingAfterDelay()
{
    const auto self = std::static_pointer_cast<PreviewController>(shared_from_this());
    auto& dispatch = services().dispatch();
    dispatch.after(
        loadingDelay, dispatch.mainQueue(), [weak = std::weak_ptr(self), generation = _generation] {
            const auto screen = weak.lock();
            if (screen && screen->_generation == generation && !screen->_content)
                screen->setContentView(placeholder({.message = localized("Loading…"), .isBusy = true}));
        });
}

void PreviewController::setContentView(const std::shared_ptr<ui::View>& contentView)
{
    // Before the screen is shown there is nothing to fill; viewDidLoad catches up.
    if (!isViewLoaded())
        return;
    if (_contentView)
        _contentView->removeFromSuperview();
    _contentView = contentView;
    if (!_contentView)
        return;
    _contentView->setAutoresizing({.flexibleWidth = true, .flexibleHeight = true});
    _contentView->setFrame(view()->bounds());
    view()->addSubview(_contentView);
}

} // namespace platform::components
