// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/previews/PopplerDocuments.h"

#include "host/previews/PopplerEditing.h"
#include "host/previews/PopplerPages.h"
#include "host/system/files/SystemErrors.h"

#include <sys/stat.h>
#include <unistd.h>

#include <cerrno>

namespace host::previews {

using host::system::systemError;
using platform::Error;
using platform::PagedDocument;
using platform::PagesErrorCode;
using platform::Result;

namespace {

std::optional<Error> checkFile(const std::string& path)
{
    struct stat status { };
    if (::stat(path.c_str(), &status) != 0)
        return errno == ENOENT ? Error(platform::FileErrorCode::NoSuchFile) : systemError(errno, path);
    // Only a regular file is opened, because reading a pipe or a device could block for ever.
    if (!S_ISREG(status.st_mode))
        return pagesError(PagesErrorCode::Damaged);
    if (::access(path.c_str(), R_OK) != 0)
        return systemError(errno, path);
    return std::nullopt;
}

} // namespace

Result<std::shared_ptr<PagedDocument>> PopplerDocuments::open(const std::string& path) const
{
    if (const auto refused = checkFile(path))
        return *refused;
    const Object<GFile> file(g_file_new_for_path(path.c_str()));
    GError* problem = nullptr;
    Object<PopplerDocument> document(poppler_document_new_from_gfile(file.get(), nullptr, nullptr, &problem));
    auto opened = PopplerPages::checked(std::move(document), problem);
    if (!opened)
        return *opened.error;
    return std::shared_ptr<PagedDocument>(std::make_shared<PopplerPages>(std::move(*opened.value)));
}

Result<std::shared_ptr<platform::PagedDocumentEditing>> PopplerDocuments::openForEditing(
    std::shared_ptr<const std::string> bytes) const
{
    return PopplerEditing::open(std::move(bytes));
}

} // namespace host::previews
