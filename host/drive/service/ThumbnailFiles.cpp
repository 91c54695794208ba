// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/service/ThumbnailFiles.h"

#include "platform/Log.h"

#include <unistd.h>

#include <cstdio>
#include <cstdlib>
#include <filesystem>
#include <utility>

namespace host::drive {

namespace {

using system::Pixbuf;

/// The number grows when the program learns to make thumbnails that failed before.
constexpr auto failures = "fail/tarrow-drive-1";
constexpr auto attemptsKey = "tEXt::Tarrow Attempts";

struct FreeText {
    void operator()(char* text) const { g_free(text); }
};
using Text = std::unique_ptr<char, FreeText>;

std::string uriOf(const std::string& path)
{
    const Text uri(g_filename_to_uri(path.c_str(), nullptr, nullptr));
    return uri ? uri.get() : "";
}

std::string folderOf(int pixelSize)
{
    switch (pixelSize) {
    case 1024:
        return "xx-large";
    case 512:
        return "x-large";
    case 256:
        return "large";
    default:
        return "normal";
    }
}

} // namespace

ThumbnailVersion::ThumbnailVersion(const std::string& path, platform::Date modified)
    : uri(uriOf(path))
    , time(std::to_string(modified.nanoseconds / 1'000'000'000))
{
}

ThumbnailFiles::ThumbnailFiles(std::string folder)
    : _folder(std::move(folder))
{
}

Pixbuf ThumbnailFiles::read(const ThumbnailVersion& version, int pixelSize) const
{
    return readEntry(folderOf(pixelSize), version);
}

void ThumbnailFiles::write(const ThumbnailVersion& version, GdkPixbuf* pixbuf) const
{
    writeEntry(folderOf(1024), version, pixbuf, {});
}

int ThumbnailFiles::attempts(const ThumbnailVersion& version) const
{
    const auto note = readEntry(failures, version);
    const char* count = note ? gdk_pixbuf_get_option(note.get(), attemptsKey) : nullptr;
    return count ? std::atoi(count) : 0;
}

void ThumbnailFiles::noteAttempts(const ThumbnailVersion& version, int count) const
{
    if (count == 0) {
        ::unlink(entryPath(failures, version).c_str());
        return;
    }
    const Pixbuf nothing(gdk_pixbuf_new(GDK_COLORSPACE_RGB, TRUE, 8, 1, 1));
    gdk_pixbuf_fill(nothing.get(), 0);
    writeEntry(failures, version, nothing.get(), std::to_string(count));
}

std::string ThumbnailFiles::entryPath(const std::string& subfolder, const ThumbnailVersion& version) const
{
    const Text name(g_compute_checksum_for_string(G_CHECKSUM_MD5, version.uri.c_str(), -1));
    return _folder + '/' + subfolder + '/' + name.get() + ".png";
}

// Answers the entry for this version of the file, or null when it is missing or was made from another
// version.
Pixbuf ThumbnailFiles::readEntry(const std::string& subfolder, const ThumbnailVersion& version) const
{
    const auto path = entryPath(subfolder, version);
    if (::access(path.c_str(), R_OK) != 0)
        return nullptr;
    Pixbuf entry(gdk_pixbuf_new_from_file(path.c_str(), nullptr));
    const char* time = entry ? gdk_pixbuf_get_option(entry.get(), "tEXt::Thumb::MTime") : nullptr;
    const char* name = entry ? gdk_pixbuf_get_option(entry.get(), "tEXt::Thumb::URI") : nullptr;
    return time && name && version.time == time && version.uri == name ? std::move(entry) : nullptr;
}

// Writes the entry under a temporary name first, so that other programs never read half of it.
void ThumbnailFiles::writeEntry(const std::string& subfolder, const ThumbnailVersion& version,
    GdkPixbuf* pixbuf, const std::string& attempts) const
{
    static constexpr platform::Operation op{"-[ThumbnailFiles writeEntry:]"};
    const auto folder = _folder + '/' + subfolder;
    std::error_code error;
    std::filesystem::create_directories(folder, error);
    std::filesystem::permissions(folder, std::filesystem::perms::owner_all, error);
    auto temporary = folder + "/.tarrow-XXXXXX";
    const int file = ::mkstemp(temporary.data()); // readable by its owner only, as the cache's rules demand
    if (file < 0)
        return;
    ::close(file);
    // A list of keys ends at the first null, so that the last pair is left out where there is no number.
    const bool written = gdk_pixbuf_save(pixbuf, temporary.c_str(), "png", nullptr, "tEXt::Thumb::URI",
        version.uri.c_str(), "tEXt::Thumb::MTime", version.time.c_str(), "tEXt::Software", "Tarrow Drive",
        "compression", "3", attempts.empty() ? nullptr : attemptsKey, attempts.c_str(), nullptr);
    if (!written || std::rename(temporary.c_str(), entryPath(subfolder, version).c_str()) != 0) {
        op.warning("Cannot write a thumbnail below %@", folder);
        ::unlink(temporary.c_str());
    }
}

} // namespace host::drive
