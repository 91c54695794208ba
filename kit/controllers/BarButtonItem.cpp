// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "kit/controllers/BarButtonItem.h"

#include "kit/views/View.h"

namespace kit {

namespace {

std::string standardName(SystemItem item)
{
    switch (item) {
    case SystemItem::Cancel:
        return "Cancel";
    case SystemItem::Done:
        return "Done";
    case SystemItem::Action:
        return "Share";
    case SystemItem::Trash:
        return "Delete";
    case SystemItem::Organize:
        return "Move";
    case SystemItem::Search:
        return "Search";
    case SystemItem::Plain:
    case SystemItem::FlexibleSpace:
    case SystemItem::FixedSpace:
        break;
    }
    return {};
}

} // namespace

BarButtonItem::BarButtonItem(std::string title, Action action)
    : _title(std::move(title))
    , _accessibilityLabel(_title)
    , _action(std::move(action))
{
}

BarButtonItem::BarButtonItem(Image image, std::string accessibilityLabel, Action action)
    : _accessibilityLabel(std::move(accessibilityLabel))
    , _image(std::move(image))
    , _action(std::move(action))
{
}

BarButtonItem::BarButtonItem(SystemItem systemItem, Action action)
    : _systemItem(systemItem)
    , _accessibilityLabel(standardName(systemItem))
    , _action(std::move(action))
{
}

BarButtonItem::BarButtonItem(std::shared_ptr<View> customView)
    : _customView(std::move(customView))
{
}

bool BarButtonItem::isSpace() const
{
    return _systemItem == SystemItem::FlexibleSpace || _systemItem == SystemItem::FixedSpace;
}

void BarButtonItem::changed()
{
    _observer.notify([this](BarButtonItemObserver& observer) { observer.barButtonItemDidChange(*this); });
}

void BarButtonItem::setTitle(std::string title)
{
    if (_accessibilityLabel == _title)
        _accessibilityLabel = title;
    _title = std::move(title);
    changed();
}

void BarButtonItem::setCompactImage(Image image)
{
    _compactImage = std::move(image);
    changed();
}

void BarButtonItem::setAccessibilityLabel(std::string label)
{
    _accessibilityLabel = std::move(label);
    changed();
}

bool BarButtonItem::isEnabled() const
{
    return _customView ? _customView->isEnabled() : _enabled;
}

void BarButtonItem::setEnabled(bool enabled)
{
    if (enabled == isEnabled())
        return;
    _enabled = enabled;
    if (_customView)
        _customView->setEnabled(enabled);
    changed();
}

bool BarButtonItem::press()
{
    if (!isEnabled() || isSpace())
        return false;
    const auto action = _action;
    if (action)
        action(shared_from_this());
    return action != nullptr;
}

} // namespace kit
