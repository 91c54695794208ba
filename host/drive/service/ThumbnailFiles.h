// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/system/desktop/PixbufImage.h"
#include "platform/Date.h"

#include <string>

namespace host::drive {

/// A version of a document: its URI, and its modification time in whole seconds.
struct ThumbnailVersion {
    std::string uri, time;

    ThumbnailVersion(const std::string& path, platform::Date modified);
};

/// The files of the desktop's shared thumbnail cache, which every program of the desktop reads and writes by
/// the same rules: a folder for each size, in it a picture for each document, named after the document's URI
/// and marked with its version. Any thread.
class ThumbnailFiles {
public:
    /// `folder` is the cache's root, `$XDG_CACHE_HOME/thumbnails`.
    explicit ThumbnailFiles(std::string folder);

    /// Answers the thumbnail of this size class (1024, 512, 256 or 128 pixels), or null when there is none of
    /// this version.
    system::Pixbuf read(const ThumbnailVersion& version, int pixelSize) const;
    /// Keeps a thumbnail of the size class 1024. Other programs never see half of it.
    void write(const ThumbnailVersion& version, GdkPixbuf* pixbuf) const;

    /// How often this program has begun to make the thumbnail of this version without bringing it to an end.
    int attempts(const ThumbnailVersion& version) const;
    /// Notes that number where the cache keeps failures; 0 removes the note.
    void noteAttempts(const ThumbnailVersion& version, int count) const;

private:
    std::string entryPath(const std::string& subfolder, const ThumbnailVersion& version) const;
    system::Pixbuf readEntry(const std::string& subfolder, const ThumbnailVersion& version) const;
    void writeEntry(const std::string& subfolder, const ThumbnailVersion& version, GdkPixbuf* pixbuf,
        const std::string& attempts) const;

    std::string _folder;
};

} // namespace host::drive
