// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "platform/DocumentSharing.h"

namespace platform {

namespace {

std::string encodedPath(const std::string& path)
{
    constexpr std::string_view start = "file://";
    return Url::fileURL(path).absoluteString().substr(start.size());
}

} // namespace

std::string linkToItem(const Url& item)
{
    return std::string(applicationScheme) + "://" + encodedPath(encodedPath(item.path()));
}

} // namespace platform
