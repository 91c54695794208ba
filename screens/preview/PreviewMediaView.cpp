// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "screens/preview/PreviewMediaView.h"

#include <utility>

namespace screens {

void PreviewMediaView::setMedia(Content content)
{
    _content = std::move(content);
    peer().notify([](auto& peer) { peer.previewContentDidChange(); });
}

} // namespace screens
