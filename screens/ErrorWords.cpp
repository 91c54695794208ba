// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "screens/ErrorWords.h"

#include "platform/ImageLoader.h"
#include "platform/Localization.h"
#include "platform/PagedDocument.h"

#include <cerrno>

namespace screens {

bool saysItemIsGone(const Error& error)
{
    if (error.domain() == errorDomain::system)
        return error.code() == ENOENT || error.code() == ENOTDIR;
    return error.is(FileErrorCode::NoSuchItem) || error.is(FileErrorCode::NoSuchFile);
}

std::string errorWords(const Error& error)
{
    if (auto words = error.text(errorKey::localizedDescription))
        return *words;
    if (saysItemIsGone(error))
        return localized("It is no longer there.");
    if (error.domain() == errorDomain::system && (error.code() == EACCES || error.code() == EPERM))
        return localized("You do not have permission to see it.");
    if (error.domain() == errorDomain::system && (error.code() == ENOSPC || error.code() == EDQUOT))
        return localized("There is not enough space on this computer.");
    if (error.domain() == errorDomain::image && error.code() == static_cast<int>(ImageErrorCode::TooLarge))
        return localized("The picture is too large to be shown here.");
    if (error.domain() == errorDomain::image)
        return localized("The picture is damaged.");
    if (error.domain() == errorDomain::pages
        && error.code() == static_cast<int>(PagesErrorCode::PasswordRequired))
        return localized("The document is protected with a password.");
    if (error.domain() == errorDomain::pages)
        return localized("The document is damaged.");
    return localized("It could not be read.");
}

} // namespace screens
