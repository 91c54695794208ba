#include "host/system/SystemErrors.h"

#include "host/system/Translate.h"
#include "platform/Localization.h"

#include <glib.h>

#include <cerrno>
#include <memory>

namespace host::system {

using platform::Error;
using platform::FileErrorCode;

namespace {

/// The sentence for an error, "%@" standing for the item's name.
std::string sentence(int errorNumber)
{
    switch (errorNumber) {
    case ENOENT:
        return translated("“%@” is no longer there.");
    case EEXIST:
    case ENOTEMPTY:
        return translated("An item named “%@” already exists here.");
    case ENAMETOOLONG:
        return translated("The name “%@” is too long.");
    case EILSEQ:
    case EINVAL:
        return translated("The name “%@” can’t be used.");
    case EACCES:
    case EPERM:
        return translated("You don’t have permission to use “%@”.");
    case EROFS:
        return translated("“%@” is in a place that can only be read.");
    case ENOSPC:
    case EDQUOT:
        return translated("There isn’t enough space for “%@”.");
    case EFBIG:
        return translated("“%@” is too large for this storage.");
    case ENOTDIR:
        return translated("“%@” isn’t a folder.");
    case EISDIR:
        return translated("“%@” is a folder.");
    case ELOOP:
        return translated("“%@” is a link that can’t be followed.");
    case EXDEV:
        return translated("“%@” lies outside the drive or on another storage.");
    case EBUSY:
    case ETXTBSY:
    case EAGAIN:
        return translated("“%@” is being used by another program.");
    case EMFILE:
    case ENFILE:
        return translated("“%@” can’t be opened because too many files are open.");
    case EIO:
    case ENXIO:
    case ENODEV:
        return translated("The storage that holds “%@” failed.");
    case ETIMEDOUT:
    case ESTALE:
    case EHOSTDOWN:
    case EHOSTUNREACH:
        return translated("The storage that holds “%@” doesn’t answer.");
    case EOPNOTSUPP:
        return translated("The storage that holds “%@” can’t do this.");
    default:
        return translated("“%@” can’t be used.");
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
    if (const auto slash = path.rfind('/'); slash != std::string_view::npos && path.size() > 1)
        path.remove_prefix(slash + 1);
    const std::unique_ptr<char, decltype(&g_free)> valid(
        g_utf8_make_valid(path.data(), static_cast<gssize>(path.size())), g_free);
    return valid.get();
}

Error systemError(int errorNumber, std::string_view path, const std::optional<std::string>& destination)
{
    // A name is taken or refused where the item was to go, not where it comes from.
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

} // namespace host::system
