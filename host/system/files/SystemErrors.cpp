// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/system/files/SystemErrors.h"

#include "host/system/files/ItemPaths.h"
#include "host/system/texts/DisplayableText.h"
#include "host/system/texts/Translate.h"
#include "platform/Localization.h"

#include <algorithm>
#include <cerrno>
#include <cstring>
#include <iterator>

namespace host::system {

using platform::Error;
using platform::FileErrorCode;

namespace {

/// The sentence for an error; "%@" stands for the item's name.
struct Sentence {
    int errorNumber;
    const char* key;
};

constexpr Sentence sentences[] = {
    {ENOENT, textKey("“%@” is no longer there.")},
    {EEXIST, textKey("An item named “%@” already exists here.")},
    {ENOTEMPTY, textKey("“%@” isn’t empty.")},
    {ENAMETOOLONG, textKey("The name “%@” is too long.")},
    {EILSEQ, textKey("The name “%@” can’t be used.")},
    {EINVAL, textKey("The name “%@” can’t be used.")},
    {EACCES, textKey("You don’t have permission to use “%@”.")},
    {EPERM, textKey("You don’t have permission to use “%@”.")},
    {EROFS, textKey("“%@” is in a place that can only be read.")},
    {ENOSPC, textKey("There isn’t enough space for “%@”.")},
    {EDQUOT, textKey("There isn’t enough space for “%@”.")},
    {EFBIG, textKey("“%@” is too large for this storage.")},
    {ENOTDIR, textKey("“%@” isn’t a folder.")},
    {EISDIR, textKey("“%@” is a folder.")},
    {ELOOP, textKey("“%@” is a link that can’t be followed.")},
    {EXDEV, textKey("“%@” lies outside the drive or on another storage.")},
    {EBUSY, textKey("“%@” is being used by another program.")},
    {ETXTBSY, textKey("“%@” is being used by another program.")},
    {EAGAIN, textKey("“%@” is being used by another program.")},
    {EMFILE, textKey("“%@” can’t be opened because too many files are open.")},
    {ENFILE, textKey("“%@” can’t be opened because too many files are open.")},
    {EIO, textKey("The storage that holds “%@” failed.")},
    {ENXIO, textKey("The storage that holds “%@” failed.")},
    {ENODEV, textKey("The storage that holds “%@” failed.")},
    {ETIMEDOUT, textKey("The storage that holds “%@” doesn’t answer.")},
    {ESTALE, textKey("The storage that holds “%@” doesn’t answer.")},
    {EHOSTDOWN, textKey("The storage that holds “%@” doesn’t answer.")},
    {EHOSTUNREACH, textKey("The storage that holds “%@” doesn’t answer.")},
    {EOPNOTSUPP, textKey("The storage that holds “%@” can’t do this.")},
};

std::string sentence(int errorNumber)
{
    const auto* found = std::ranges::find(sentences, errorNumber, &Sentence::errorNumber);
    return translated(found != std::end(sentences) ? found->key : textKey("“%@” can’t be used."));
}

/// Answers the sentence for an error of a file that the drive needs for its work on an item. What is said of
/// the storage and of what the program has open holds for the item, too.
std::string sentenceOfDrive(int errorNumber)
{
    switch (errorNumber) {
    case EACCES:
    case EPERM:
        return translated(
            textKey("You don’t have permission to use the drive’s own files, which are needed for “%@”."));
    case ENOENT:
    case EEXIST:
    case ENOTEMPTY:
    case ENAMETOOLONG:
    case EILSEQ:
    case EINVAL:
    case ENOTDIR:
    case EISDIR:
    case ELOOP:
    case EXDEV:
    case ENXIO:
    case ENODEV:
    case ESPIPE:
    case EBADMSG:
        return translated(textKey("The drive’s own files, which are needed for “%@”, can’t be used."));
    case EBUSY:
    case EAGAIN:
        return translated(
            textKey("The drive’s own files, which are needed for “%@”, are being used by another program."));
    default:
        return sentence(errorNumber);
    }
}

std::optional<FileErrorCode> fileErrorCode(int errorNumber)
{
    switch (errorNumber) {
    case ENOENT:
        return FileErrorCode::NoSuchItem;
    case EEXIST:
        return FileErrorCode::ItemExists;
    case ENAMETOOLONG:
    case EILSEQ:
        return FileErrorCode::InvalidName;
    default:
        return std::nullopt;
    }
}

} // namespace

std::string displayName(std::string_view path)
{
    if (path.size() > 1)
        path = lastName(path);
    return displayableText(path);
}

Error systemError(int errorNumber, std::string_view path, const std::optional<std::string>& destination)
{
    // These errors are about the name at the destination, not about the source.
    const bool concernsDestination = errorNumber == EEXIST || errorNumber == ENOTEMPTY
        || errorNumber == ENAMETOOLONG || errorNumber == EILSEQ || errorNumber == EINVAL;
    const auto name = displayName(destination && concernsDestination ? *destination : path);
    platform::PropertyDictionary info;
    info.emplace(platform::errorKey::filePath, std::string(path));
    info.emplace(
        platform::errorKey::localizedDescription, platform::formatText(sentence(errorNumber), {name}));
    if (destination)
        info.emplace(platform::errorKey::destinationFilePath, *destination);
    if (const auto code = fileErrorCode(errorNumber))
        return Error(*code, std::move(info));
    return Error(platform::errorDomain::system, errorNumber, std::move(info));
}

Error systemError(
    const SystemError& failure, std::string_view path, const std::optional<std::string>& destination)
{
    if (!failure.concernsDrive())
        return systemError(failure.number(), path, destination);
    platform::PropertyDictionary info;
    info.emplace(platform::errorKey::filePath, std::string(path));
    info.emplace(platform::errorKey::localizedDescription,
        platform::formatText(sentenceOfDrive(failure.number()), {displayName(path)}));
    return Error(platform::errorDomain::system, failure.number(), std::move(info));
}

std::string logText(const SystemError& failure)
{
    const char* name = ::strerrorname_np(failure.number());
    const std::string text = name ? name : std::to_string(failure.number());
    return failure.about().empty() ? text : text + " (" + failure.about() + ')';
}

} // namespace host::system
