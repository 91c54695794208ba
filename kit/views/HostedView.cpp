// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "kit/views/HostedView.h"

#include "kit/views/ViewVisitor.h"

namespace kit {

HostedView::HostedView(std::string kind, PropertyDictionary settings)
    : _kind(std::move(kind))
    , _settings(std::move(settings))
{
}

void HostedView::accept(ViewVisitor& visitor)
{
    visitor.visit(*this);
}

void HostedView::setSettings(PropertyDictionary settings)
{
    if (settings == _settings)
        return;
    _settings = std::move(settings);
    changed(ViewChange::Content);
}

void HostedView::reportEvent(const std::string& event, const PropertyValue& value)
{
    if (const auto handler = _onEvent)
        handler(event, value);
}

} // namespace kit
