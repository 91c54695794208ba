// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/values/PlatformNames.h"
#include "kit/views/View.h"
#include "platform/PropertyValue.h"

#include <functional>

namespace kit {

/// A place for a native view. The host makes the native view by its kind ("document", "video", ...), reads
/// the settings and reports events. Without a host the place stays empty.
class HostedView : public View {
public:
    explicit HostedView(std::string kind, PropertyDictionary settings = {});

    void accept(ViewVisitor& visitor) override;

    const std::string& kind() const { return _kind; }
    const PropertyDictionary& settings() const { return _settings; }
    void setSettings(PropertyDictionary settings); ///< the peer is told of a change of content

    using EventHandler = std::function<void(const std::string& event, const PropertyValue& value)>;
    void setOnEvent(EventHandler handler) { _onEvent = std::move(handler); }
    /// Event up: something happened in the native view.
    void reportEvent(const std::string& event, const PropertyValue& value = {});

private:
    std::string _kind;
    PropertyDictionary _settings;
    EventHandler _onEvent;
};

} // namespace kit
