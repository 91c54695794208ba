// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Localization.h"

#include <string>

namespace host::system {

struct UserLocale;

/// Texts from gettext's catalogues, domain "tarrow-drive". The choice of language is the whole process's,
/// including the toolkit's own texts, so make one object, in main, before other threads and before the
/// toolkit.
class GettextLocalization : public platform::Localization {
public:
    /// `folder` contains LANGUAGE/LC_MESSAGES/tarrow-drive.mo. Catalogues work even when the system's locale
    /// is not installed, and English ones in the "C" locale.
    GettextLocalization(const std::string& folder, const UserLocale& locale);

    std::string text(const std::string& key) const override;
    std::string pluralText(const std::string& key, double number) const override;
    bool isRightToLeft() const override { return _isRightToLeft; }

private:
    bool _isRightToLeft;
};

} // namespace host::system
