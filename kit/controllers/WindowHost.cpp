// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "kit/controllers/WindowHost.h"

namespace kit {

namespace {

std::shared_ptr<WindowHost>& installedHost()
{
    static std::shared_ptr<WindowHost> host;
    return host;
}

} // namespace

std::shared_ptr<WindowHost> WindowHost::current()
{
    return installedHost();
}

void WindowHost::install(std::shared_ptr<WindowHost> host)
{
    installedHost() = std::move(host);
}

} // namespace kit
