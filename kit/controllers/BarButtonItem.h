// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/values/ObserverSlot.h"
#include "kit/values/PlatformNames.h"
#include "platform/Image.h"

#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <vector>

namespace kit {

class BarButtonItem;
class View;

/// The platform's standard symbols and spaces. A `Plain` item has a title, an image or a view of its own.
enum class SystemItem { Plain, Cancel, Done, Action, Trash, Organize, Search, FlexibleSpace, FixedSpace };

/// Calls down: the item shows something else, or became enabled or disabled.
class BarButtonItemObserver {
public:
    virtual ~BarButtonItemObserver() = default;
    virtual void barButtonItemDidChange(BarButtonItem& item) = 0;
};

/// An entry of a navigation bar or a toolbar.
class BarButtonItem : public std::enable_shared_from_this<BarButtonItem> {
public:
    using Action = std::function<void(const std::shared_ptr<BarButtonItem>& sender)>;

    BarButtonItem(std::string title, Action action);
    BarButtonItem(Image image, std::string accessibilityLabel, Action action);
    explicit BarButtonItem(SystemItem systemItem, Action action = {});
    explicit BarButtonItem(std::shared_ptr<View> customView);

    void setObserver(std::weak_ptr<BarButtonItemObserver> observer) { _observer.set(std::move(observer)); }

    SystemItem systemItem() const { return _systemItem; }
    bool isSpace() const;
    const std::string& title() const { return _title; }
    void setTitle(std::string title);
    const std::optional<Image>& image() const { return _image; }
    /// A narrow bar shows this image in place of the title, so that the screen's own title has room.
    const std::optional<Image>& compactImage() const { return _compactImage; }
    void setCompactImage(Image image);
    const std::shared_ptr<View>& customView() const { return _customView; }
    /// The label is never empty for an item that can be pressed, because a standard symbol has its standard
    /// name.
    const std::string& accessibilityLabel() const { return _accessibilityLabel; }
    void setAccessibilityLabel(std::string label);
    static constexpr double fixedSpaceWidth = 8; ///< points

    /// An item with a custom view is enabled when that view is.
    bool isEnabled() const;
    void setEnabled(bool enabled);
    void setAction(Action action) { _action = std::move(action); }

    /// Event up: the user pressed the item. Answers false, and does nothing, when the item is disabled.
    bool press();

private:
    void changed();

    SystemItem _systemItem = SystemItem::Plain;
    std::string _title, _accessibilityLabel;
    std::optional<Image> _image, _compactImage;
    std::shared_ptr<View> _customView;
    Action _action;
    bool _enabled = true;
    ObserverSlot<BarButtonItemObserver> _observer;
};

using BarButtonItems = std::vector<std::shared_ptr<BarButtonItem>>;

} // namespace kit
