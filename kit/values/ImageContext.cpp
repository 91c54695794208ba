// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "kit/values/ImageContext.h"

#include <utility>

namespace kit {

namespace {

ImageContext::Opener& installedOpener()
{
    static ImageContext::Opener opener;
    return opener;
}

} // namespace

std::unique_ptr<ImageContext> ImageContext::open(const Size& size, double scale)
{
    return installedOpener() ? installedOpener()(size, scale) : nullptr;
}

void ImageContext::install(Opener opener)
{
    installedOpener() = std::move(opener);
}

} // namespace kit
