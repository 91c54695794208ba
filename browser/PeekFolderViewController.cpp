// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "browser/PeekFolderViewController.h"

namespace tarrow {

std::shared_ptr<PeekFolderViewController> PeekFolderViewController::initWithURL(const platform::Url& url)
{
    return std::make_shared<PeekFolderViewController>(url);
}

std::shared_ptr<PeekFolderViewController> PeekFolderViewController::initWithURLTitle(
    const platform::Url& url, const std::string& title)
{
    return std::make_shared<PeekFolderViewController>(url, title);
}

} // namespace tarrow
