// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "kit/views/HostedView.h"

#include "kit/views/ViewVisitor.h"

namespace kit {

HostedView::HostedView(std::string kind)
    : _kind(std::move(kind))
{
}

void HostedView::accept(ViewVisitor& visitor)
{
    visitor.visit(*this);
}

} // namespace kit
