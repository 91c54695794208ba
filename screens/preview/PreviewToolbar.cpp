// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "screens/preview/PreviewToolbar.h"

#include "kit/views/Button.h"
#include "kit/views/Label.h"
#include "platform/Localization.h"
#include "platform/Weakly.h"
#include "screens/PlatformNames.h"
#include "screens/preview/PreviewPagesView.h"

namespace screens {

std::shared_ptr<PreviewToolbar> PreviewToolbar::create()
{
    const auto bar = std::make_shared<PreviewToolbar>();
    bar->build();
    return bar;
}

void PreviewToolbar::build()
{
    _find = kit::Button::withSymbol("system-search-symbolic", localized("Search in document"));
    _copy = kit::Button::withSymbol("edit-copy-symbolic", localized("Copy"));
    _edit = kit::Button::withSymbol("document-edit-symbolic", localized("Edit document"));
    _zoomOut = kit::Button::withSymbol("zoom-out-symbolic", localized("Smaller"));
    _zoomIn = kit::Button::withSymbol("zoom-in-symbolic", localized("Larger"));
    _page = std::make_shared<kit::Label>();
    _page->setFont(kit::Font::preferred(kit::TextStyle::Footnote));
    _page->setAlignment(kit::TextAlignment::Center);
    for (const auto& part :
        std::initializer_list<std::shared_ptr<kit::View>>{_find, _copy, _page, _edit, _zoomOut, _zoomIn})
        addSubview(part);
    _find->setAction(weakly(this, [](PreviewToolbar& self) {
        if (const auto call = self._onFind)
            call();
    }));
    _copy->setAction(weakly(this, [](PreviewToolbar& self) {
        if (const auto preview = self._preview.lock())
            preview->copy();
    }));
    _edit->setAction(weakly(this, [](PreviewToolbar& self) {
        if (const auto call = self._onEdit)
            call();
    }));
    _zoomOut->setAction(weakly(this, &PreviewToolbar::zoomBy, 1 / PreviewView::zoomStep));
    _zoomIn->setAction(weakly(this, &PreviewToolbar::zoomBy, PreviewView::zoomStep));
    update();
}

void PreviewToolbar::zoomBy(double factor)
{
    if (const auto preview = _preview.lock())
        preview->setZoom(preview->zoom() * factor);
}

void PreviewToolbar::setCanEdit(bool canEdit)
{
    _canEdit = canEdit;
    update();
}

void PreviewToolbar::setPreview(const std::shared_ptr<PreviewView>& preview)
{
    _preview = preview;
    update();
}

bool PreviewToolbar::isEmpty() const
{
    const auto preview = _preview.lock();
    return !preview || (!preview->canZoom() && !preview->canSearch());
}

std::string PreviewToolbar::pageText() const
{
    const auto pages = std::dynamic_pointer_cast<PreviewPagesView>(_preview.lock());
    if (!pages || pages->pageCount() == 0)
        return {};
    return localized("%1$d of %2$d",
        {static_cast<std::int64_t>(pages->currentPage() + 1), static_cast<std::int64_t>(pages->pageCount())});
}

void PreviewToolbar::update()
{
    const auto preview = _preview.lock();
    const bool zooms = preview && preview->canZoom();
    _find->setHidden(!preview || !preview->canSearch());
    _copy->setHidden(!preview || !preview->canCopy());
    _edit->setHidden(!preview || !_canEdit);
    _zoomOut->setHidden(!zooms);
    _zoomIn->setHidden(!zooms);
    _zoomOut->setEnabled(zooms && preview->zoom() > PreviewView::minZoom);
    _zoomIn->setEnabled(zooms && preview->zoom() < PreviewView::maxZoom);
    const auto page = pageText();
    _page->setText(page);
    _page->setHidden(page.empty());
    _page->setAccessibilityLabel(page.empty() ? page : localized("Page %@", {page}));
    setNeedsLayout();
}

void PreviewToolbar::layoutSubviews()
{
    const double width = bounds().width;
    const bool isMirrored = traits().layoutDirection == kit::LayoutDirection::RightToLeft;
    const auto place = [&](kit::View& view, double x, double itemWidth) {
        view.setFrame({isMirrored ? width - x - itemWidth : x, 0, itemWidth, barHeight});
    };
    place(*_find, 0, barHeight);
    place(*_copy, barHeight, barHeight);
    const double pageEnd = width - (_edit->isHidden() ? 2 : 3) * barHeight;
    place(*_page, 2 * barHeight, std::max(0.0, pageEnd - 2 * barHeight));
    place(*_edit, pageEnd, barHeight);
    place(*_zoomOut, width - 2 * barHeight, barHeight);
    place(*_zoomIn, width - barHeight, barHeight);
}

} // namespace screens
