// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/ImageLoader.h"

namespace host::system {

/// Decodes pictures with GdkPixbuf, in the formats that are installed for it.
class GdkPixbufImageLoader : public platform::ImageLoader {
public:
    platform::Result<platform::Image> load(
        const std::string& path, const platform::ImageLimits& limits) const override;
    platform::Result<platform::Picture> loadPicture(const std::string& path,
        const platform::ImageLimits& limits, const std::function<bool()>& isCancelled) const override;
};

} // namespace host::system
