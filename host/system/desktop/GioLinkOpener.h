// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/LinkOpener.h"

namespace host::system {

/// Opens pages with the desktop's default browser.
class GioLinkOpener : public platform::LinkOpener {
public:
    void openLink(const std::string& url, Completion completion) override;
};

} // namespace host::system
