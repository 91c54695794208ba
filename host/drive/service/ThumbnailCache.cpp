// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/service/ThumbnailCache.h"

#include "host/system/desktop/PixbufImage.h"
#include "platform/Log.h"

#include <gdk-pixbuf/gdk-pixbuf.h>
#include <unistd.h>

#include <cstdio>
#include <filesystem>

namespace host::drive {

namespace {

using system::Pixbuf;

struct FreeText {
    void operator()(char* text) const { g_free(text); }
};
using Text = std::unique_ptr<char, FreeText>;

std::string uriOf(const std::string& path)
{
    const Text uri(g_filename_to_uri(path.c_str(), nullptr, nullptr));
    return uri ? uri.get() : "";
}

std::string seconds(platform::Date date)
{
    return std::to_string(date.nanoseconds / 1'000'000'000);
}

std::string entryPath(const std::string& folder, const std::string& uri)
{
    const Text name(g_compute_checksum_for_string(G_CHECKSUM_MD5, uri.c_str(), -1));
    return folder + "/xx-large/" + name.get() + ".png";
}

// Answers the entry for this version of the file, or null when it is missing or was made from another
// version.
Pixbuf readEntry(const std::string& folder, const std::string& uri, platform::Date modified)
{
    const auto path = entryPath(folder, uri);
    if (::access(path.c_str(), R_OK) != 0)
        return nullptr;
    Pixbuf entry(gdk_pixbuf_new_from_file(path.c_str(), nullptr));
    const char* time = entry ? gdk_pixbuf_get_option(entry.get(), "tEXt::Thumb::MTime") : nullptr;
    const char* name = entry ? gdk_pixbuf_get_option(entry.get(), "tEXt::Thumb::URI") : nullptr;
    return time && name && seconds(modified) == time && uri == name ? std::move(entry) : nullptr;
}

Pixbuf scaledPicture(const std::string& path)
{
    int width = 0, height = 0;
    if (!gdk_pixbuf_get_file_info(path.c_str(), &width, &height) || width <= 0 || height <= 0
        || std::int64_t{width} * height > ThumbnailCache::mostPixels)
        return nullptr;
    const int side = std::min(ThumbnailCache::pixelSize, std::max(width, height));
    const Pixbuf picture(gdk_pixbuf_new_from_file_at_scale(path.c_str(), side, side, TRUE, nullptr));
    return picture ? Pixbuf(gdk_pixbuf_apply_embedded_orientation(picture.get())) : nullptr;
}

// Writes the entry under a temporary name first, so that other programs never read half of it.
void writeEntry(const std::string& folder, GdkPixbuf* pixbuf, const std::string& uri, platform::Date modified)
{
    static constexpr platform::Operation op{"-[ThumbnailCache writeEntry:]"};
    std::error_code error;
    std::filesystem::create_directories(folder + "/xx-large", error);
    std::filesystem::permissions(folder + "/xx-large", std::filesystem::perms::owner_all, error);
    auto temporary = folder + "/xx-large/.tarrow-XXXXXX";
    const int file = ::mkstemp(temporary.data()); // readable by its owner only, as the cache's rules demand
    if (file < 0)
        return;
    ::close(file);
    const auto time = seconds(modified);
    const bool written = gdk_pixbuf_save(pixbuf, temporary.c_str(), "png", nullptr, "tEXt::Thumb::URI",
        uri.c_str(), "tEXt::Thumb::MTime", time.c_str(), "tEXt::Software", "Tarrow Drive", "compression", "3",
        nullptr);
    if (!written || std::rename(temporary.c_str(), entryPath(folder, uri).c_str()) != 0) {
        op.warning("Cannot write a thumbnail below %@", folder);
        ::unlink(temporary.c_str());
    }
}

Pixbuf make(const std::string& folder, const std::string& path, platform::Date modified)
{
    auto picture = scaledPicture(path);
    if (picture)
        writeEntry(folder, picture.get(), uriOf(path), modified);
    return picture;
}

} // namespace

ThumbnailCache::ThumbnailCache(std::string folder)
    : _folder(std::move(folder))
{
}

std::string ThumbnailCache::sharedFolder()
{
    return std::string(g_get_user_cache_dir()) + "/thumbnails";
}

platform::ThumbnailMap ThumbnailCache::thumbnails(
    const platform::Url& url, platform::Date modified, IfMissing ifMissing) const
{
    auto picture = readEntry(_folder, uriOf(url.path()), modified);
    if (!picture && ifMissing == IfMissing::MakeFromPicture)
        picture = make(_folder, url.path(), modified);
    return picture ? platform::ThumbnailMap{{pixelSize, system::imageOf(picture.get(), 1)}}
                   : platform::ThumbnailMap{};
}

} // namespace host::drive
