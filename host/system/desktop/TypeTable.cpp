// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/system/desktop/TypeTable.h"

#include "host/system/files/DriveNames.h"

namespace host::system {

namespace {

// clang-format off
constexpr TypeRow rows[] = {
    // What things are made of.
    {"public.item", "", "", ""},
    {"public.content", "", "", ""},
    {"public.data", "public.item", "application/octet-stream", "bin dat"},
    {"public.directory", "public.item", "inode/directory", ""},
    {"public.volume", "public.directory", "inode/mount-point", ""},
    {"public.package", "public.directory", "", ""},
    {"public.bundle", "public.package", "", "bundle plugin framework"},
    {"public.symlink", "public.item", "inode/symlink", ""},
    {aliasType, "public.data", "", aliasExtension},
    {"app.tarrow.Drive.reference", "public.data", "", referenceExtension},
    {"public.composite-content", "public.content", "", ""},
    {"public.executable", "public.data", "application/x-executable application/x-sharedlib", "exe so"},
    {"public.archive", "public.data", "", ""},
    {"public.disk-image", "public.archive", "application/x-raw-disk-image", "img"},
    {"public.message", "public.data public.content", "", ""},
    {"public.contact", "public.data public.content", "", ""},
    {"public.calendar-event", "public.data public.content", "", ""},
    {"public.font", "public.data public.content", "", ""},
    {"public.database", "public.data", "", ""},
    {"public.3d-content", "public.data public.content", "", ""},
    {"public.spreadsheet", "public.composite-content", "", ""},
    {"public.presentation", "public.composite-content", "", ""},
    {"public.book", "public.composite-content", "", ""},
    {"public.audiovisual-content", "public.data public.content", "", ""},
    {"public.movie", "public.audiovisual-content", "", ""},
    {"public.video", "public.movie", "", ""},
    {"public.audio", "public.audiovisual-content", "", ""},
    {"public.playlist", "public.data", "audio/x-mpegurl application/vnd.apple.mpegurl audio/x-scpls", "m3u m3u8 pls"},
    {"public.image", "public.data public.content", "", ""},
    {"public.camera-raw-image", "public.image", "image/x-dcraw", ""},

    // Texts.
    {"public.text", "public.data public.content", "", ""},
    {"public.plain-text", "public.text", "text/plain", "txt text asc"},
    {"public.log", "public.plain-text", "text/x-log", "log"},
    {"public.markdown", "public.plain-text", "text/markdown", "md markdown mdown mkd"},
    {"public.delimited-values-text", "public.plain-text", "", ""},
    {"public.comma-separated-values-text", "public.delimited-values-text", "text/csv", "csv"},
    {"public.tab-separated-values-text", "public.delimited-values-text", "text/tab-separated-values", "tsv tab"},
    {"public.html", "public.text", "text/html", "html htm"},
    {"public.xml", "public.plain-text", "application/xml text/xml", "xml"},
    {"public.xhtml", "public.xml", "application/xhtml+xml", "xhtml xht"},
    {"public.xml-style-sheet", "public.xml", "application/xslt+xml", "xsl xslt"},
    {"public.rss", "public.xml", "application/rss+xml", "rss"},
    {"public.json", "public.plain-text", "application/json", "json"},
    {"public.geojson", "public.json", "application/geo+json", "geojson"},
    {"public.notebook", "public.json", "application/x-ipynb+json", "ipynb"},
    {"public.yaml", "public.plain-text", "application/x-yaml", "yaml yml"},
    {"public.toml", "public.plain-text", "application/toml", "toml"},
    {"public.configuration-text", "public.plain-text", "", "ini conf cfg"},
    {"public.patch", "public.plain-text", "text/x-patch", "patch diff"},
    {"public.tex", "public.plain-text", "text/x-tex", "tex ltx sty cls"},
    {"public.bibtex", "public.plain-text", "text/x-bibtex", "bib"},
    {"public.subtitles", "public.plain-text", "application/x-subrip text/vtt", "srt vtt"},
    {"public.rtf", "public.text", "application/rtf text/rtf", "rtf"},
    {"public.vcard", "public.text public.contact", "text/vcard", "vcf vcard"},
    {"public.ics", "public.text public.calendar-event", "text/calendar", "ics ical"},
    {"public.email-message", "public.message public.text", "message/rfc822", "eml"},

    // Programs.
    {"public.source-code", "public.plain-text", "", ""},
    {"public.script", "public.source-code", "", ""},
    {"public.c-source", "public.source-code", "text/x-csrc", "c"},
    {"public.c-header", "public.source-code", "text/x-chdr", "h"},
    {"public.c-plus-plus-source", "public.source-code", "text/x-c++src", "cpp cc cxx c++"},
    {"public.c-plus-plus-header", "public.source-code", "text/x-c++hdr", "hpp hh hxx h++"},
    {"public.objective-c-source", "public.source-code", "text/x-objcsrc", "m"},
    {"public.swift-source", "public.source-code", "text/x-swift", "swift"},
    {"public.rust-source", "public.source-code", "text/rust", "rs"},
    {"public.go-source", "public.source-code", "text/x-go", "go"},
    {"public.java-source", "public.source-code", "text/x-java", "java"},
    {"public.kotlin-source", "public.source-code", "text/x-kotlin", "kt kts"},
    {"public.c-sharp-source", "public.source-code", "text/x-csharp", "cs"},
    {"public.assembly-source", "public.source-code", "text/x-asm", "s asm"},
    {"public.haskell-source", "public.source-code", "text/x-haskell", "hs"},
    {"public.css", "public.source-code", "text/css", "css"},
    {"public.sql", "public.source-code", "application/sql", "sql"},
    {"public.typescript", "public.source-code", "", "ts tsx"},
    {"public.javascript", "public.script", "application/javascript text/javascript", "js mjs"},
    {"public.python-script", "public.script", "text/x-python3 text/x-python", "py"},
    {"public.shell-script", "public.script", "application/x-shellscript", "sh bash zsh"},
    {"public.perl-script", "public.script", "application/x-perl", "pl pm"},
    {"public.ruby-script", "public.script", "application/x-ruby", "rb"},
    {"public.php-script", "public.script", "application/x-php", "php"},
    {"public.lua-script", "public.script", "text/x-lua", "lua"},

    // Images.
    {"public.png", "public.image", "image/png", "png"},
    {"public.jpeg", "public.image", "image/jpeg", "jpg jpeg jpe"},
    {"public.gif", "public.image", "image/gif", "gif"},
    {"public.webp", "public.image", "image/webp", "webp"},
    {"public.svg-image", "public.image public.xml", "image/svg+xml", "svg"},
    {"public.svg-image-compressed", "public.image", "image/svg+xml-compressed", "svgz"},
    {"public.tiff", "public.image", "image/tiff", "tif tiff"},
    {"public.heif", "public.image", "image/heif", "heif"},
    {"public.heic", "public.heif", "image/heic", "heic"},
    {"public.avif", "public.image", "image/avif", "avif"},
    {"public.jpeg-xl", "public.image", "image/jxl", "jxl"},
    {"public.jpeg-2000", "public.image", "image/jp2", "jp2"},
    {"public.bmp", "public.image", "image/bmp", "bmp"},
    {"public.icon", "public.image", "image/vnd.microsoft.icon", "ico"},
    {"public.netpbm-image", "public.image", "image/x-portable-anymap image/x-portable-pixmap image/x-portable-bitmap image/x-portable-graymap", "pnm ppm pbm pgm"},
    {"public.layered-image", "public.image", "image/vnd.adobe.photoshop", "psd"},
    {"public.painting", "public.image", "image/x-xcf", "xcf"},
    {"public.digital-negative", "public.camera-raw-image", "image/x-adobe-dng", "dng"},
    {"public.camera-raw-file", "public.camera-raw-image", "image/x-canon-cr2 image/x-canon-cr3 image/x-nikon-nef image/x-sony-arw image/x-olympus-orf image/x-fuji-raf image/x-panasonic-rw2", "cr2 cr3 nef arw orf raf rw2"},

    // Sound.
    {"public.mp3", "public.audio", "audio/mpeg", "mp3"},
    {"public.mpeg-4-audio", "public.audio", "audio/mp4", "m4a m4b"},
    {"public.aac-audio", "public.audio", "audio/aac", "aac"},
    {"public.waveform-audio", "public.audio", "audio/x-wav audio/wav", "wav"},
    {"public.aiff-audio", "public.audio", "audio/x-aiff audio/x-aifc", "aif aiff aifc"},
    {"public.flac", "public.audio", "audio/flac", "flac"},
    {"public.ogg-audio", "public.audio", "audio/ogg audio/x-vorbis+ogg", "ogg oga"},
    {"public.opus-audio", "public.audio", "audio/x-opus+ogg", "opus"},
    {"public.midi-audio", "public.audio", "audio/midi", "mid midi"},
    {"public.windows-media-audio", "public.audio", "audio/x-ms-wma", "wma"},
    {"public.amr-audio", "public.audio", "audio/AMR", "amr"},
    {"public.core-audio", "public.audio", "audio/x-caf", "caf"},

    // Moving pictures.
    {"public.mpeg-4", "public.video", "video/mp4", "mp4 m4v"},
    {"public.webm", "public.video", "video/webm", "webm"},
    {"public.quicktime-movie", "public.video", "video/quicktime", "mov qt"},
    {"public.matroska", "public.video", "video/x-matroska", "mkv"},
    {"public.mpeg", "public.video", "video/mpeg", "mpg mpeg mpe"},
    {"public.mpeg-2-transport-stream", "public.video", "video/mp2t", "m2ts mts"},
    {"public.avi", "public.video", "video/x-msvideo", "avi"},
    {"public.ogg-video", "public.video", "video/ogg video/x-theora+ogg", "ogv"},
    {"public.3gpp", "public.video", "video/3gpp", "3gp"},
    {"public.3gpp2", "public.video", "video/3gpp2", "3g2"},
    {"public.windows-media-video", "public.video", "video/x-ms-wmv", "wmv"},
    {"public.flash-video", "public.video", "video/x-flv", "flv"},

    // Documents.
    {"public.pdf", "public.data public.composite-content", "application/pdf", "pdf"},
    {"public.postscript", "public.data public.composite-content", "application/postscript image/x-eps", "ps eps"},
    {"public.djvu", "public.data public.composite-content", "image/vnd.djvu image/vnd.djvu+multipage", "djvu djv"},
    {"public.epub", "public.data public.book", "application/epub+zip", "epub"},
    {"public.mobi-book", "public.data public.book", "application/x-mobipocket-ebook", "mobi"},
    {"public.word-document", "public.data public.composite-content", "application/msword", "doc dot"},
    {"public.word-open-document", "public.data public.composite-content", "application/vnd.openxmlformats-officedocument.wordprocessingml.document application/vnd.openxmlformats-officedocument.wordprocessingml.template", "docx dotx docm"},
    {"public.spreadsheet-document", "public.data public.spreadsheet", "application/vnd.ms-excel", "xls xlt"},
    {"public.spreadsheet-open-document", "public.data public.spreadsheet", "application/vnd.openxmlformats-officedocument.spreadsheetml.sheet application/vnd.openxmlformats-officedocument.spreadsheetml.template", "xlsx xltx xlsm"},
    {"public.presentation-document", "public.data public.presentation", "application/vnd.ms-powerpoint", "ppt pps pot"},
    {"public.presentation-open-document", "public.data public.presentation", "application/vnd.openxmlformats-officedocument.presentationml.presentation application/vnd.openxmlformats-officedocument.presentationml.slideshow", "pptx ppsx potx pptm"},
    {"public.opendocument", "public.data public.composite-content", "", ""},
    {"public.opendocument-text", "public.opendocument", "application/vnd.oasis.opendocument.text application/vnd.oasis.opendocument.text-template", "odt ott fodt"},
    {"public.opendocument-spreadsheet", "public.opendocument public.spreadsheet", "application/vnd.oasis.opendocument.spreadsheet application/vnd.oasis.opendocument.spreadsheet-template", "ods ots fods"},
    {"public.opendocument-presentation", "public.opendocument public.presentation", "application/vnd.oasis.opendocument.presentation application/vnd.oasis.opendocument.presentation-template", "odp otp fodp"},
    {"public.opendocument-drawing", "public.opendocument", "application/vnd.oasis.opendocument.graphics", "odg otg fodg"},
    {"public.vector-drawing", "public.data public.content", "application/illustrator", "ai"},

    // Archives.
    {"public.zip-archive", "public.archive", "application/zip", "zip"},
    {"public.tar-archive", "public.archive", "application/x-tar", "tar"},
    {"public.gzip-archive", "public.archive", "application/gzip", "gz"},
    {"public.gzip-tar-archive", "public.gzip-archive", "application/x-compressed-tar", "tgz"},
    {"public.bzip2-archive", "public.archive", "application/x-bzip application/x-bzip2", "bz2"},
    {"public.bzip2-tar-archive", "public.bzip2-archive", "application/x-bzip-compressed-tar", "tbz tbz2"},
    {"public.xz-archive", "public.archive", "application/x-xz", "xz"},
    {"public.xz-tar-archive", "public.xz-archive", "application/x-xz-compressed-tar", "txz"},
    {"public.zstandard-archive", "public.archive", "application/zstd", "zst"},
    {"public.7z-archive", "public.archive", "application/x-7z-compressed", "7z"},
    {"public.rar-archive", "public.archive", "application/vnd.rar", "rar"},
    {"public.java-archive", "public.zip-archive public.executable", "application/x-java-archive", "jar"},
    {"public.debian-package", "public.archive", "application/vnd.debian.binary-package", "deb"},
    {"public.iso-image", "public.disk-image", "application/x-cd-image", "iso"},
    {"public.compressed-disk-image", "public.disk-image", "application/x-apple-diskimage", "dmg"},

    // Others that are met.
    {"public.truetype-font", "public.font", "font/ttf", "ttf"},
    {"public.opentype-font", "public.font", "font/otf", "otf"},
    {"public.font-collection", "public.font", "font/collection", "ttc"},
    {"public.web-open-font", "public.font", "font/woff font/woff2", "woff woff2"},
    {"public.sqlite-database", "public.database", "application/vnd.sqlite3", "sqlite sqlite3"},
    {"public.wavefront-model", "public.3d-content", "model/obj", "obj"},
    {"public.stereolithography-model", "public.3d-content", "model/stl", "stl"},
    {"public.gl-transmission-model", "public.3d-content", "model/gltf+json model/gltf-binary", "gltf glb"},
    {"public.url-shortcut", "public.data", "application/x-mswinurl", "url"},
    {"public.desktop-entry", "public.plain-text", "application/x-desktop", "desktop"},
    {"public.torrent", "public.data", "application/x-bittorrent", "torrent"},

    // Folders that are documents.
    {"public.rtf-directory", "public.package public.composite-content", "", "rtfd"},
    {"public.text-bundle", "public.package public.composite-content", "", "textbundle"},
    {"public.pages-document", "public.package public.composite-content", "application/vnd.apple.pages", "pages"},
    {"public.numbers-document", "public.package public.spreadsheet", "application/vnd.apple.numbers", "numbers"},
    {"public.keynote-document", "public.package public.presentation", "application/vnd.apple.keynote", "key"},
    {"public.writing-project", "public.package public.composite-content", "", "scriv"},
    {"public.outline-document", "public.package public.composite-content", "", "oo3"},
    {"public.diagram-document", "public.package public.composite-content", "", "graffle"},
    {"public.application-bundle", "public.bundle public.executable", "", "app"},
};
// clang-format on

} // namespace

std::span<const TypeRow> typeTable()
{
    return rows;
}

} // namespace host::system
