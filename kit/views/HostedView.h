// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/views/View.h"

#include <string>

namespace kit {

/// A place for a native view, which the host makes by its kind ("document", "video", ...). Without a host the
/// place stays empty.
class HostedView : public View {
public:
    explicit HostedView(std::string kind);

    void accept(ViewVisitor& visitor) override;

    const std::string& kind() const { return _kind; }

private:
    std::string _kind;
};

} // namespace kit
