// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "platform/Url.h"
#include "fuzz/support/Fuzzing.h"

#include <glib.h>

namespace {

using fuzzing::require;
using platform::Url;

bool isClean(const std::string& path)
{
    const auto ended = path + '/';
    return path.starts_with('/') && (path == "/" || !path.ends_with('/'))
        && (path == "/" || ended.find("//") == std::string::npos) && ended.find("/./") == std::string::npos
        && ended.find("/../") == std::string::npos;
}

void tryFileURL(const Url& url)
{
    require(isClean(url.path()), "the path of a file URL is clean");
    const auto text = url.absoluteString();
    const auto again = Url::parse(text);
    require(text.size() > Url::maximumLength || (again && *again == url), "its text reads the same");
    const auto parent = url.deletingLastPathComponent();
    require(url.isWithin(parent), "an item lies in its folder");
    require(url.path() == "/" || parent.appendingPathComponent(url.lastPathComponent()) == url,
        "a folder and a name make a path");
    std::string joined;
    for (const auto& name : url.pathComponents())
        joined += name == "/" ? "" : '/' + name;
    require(joined == (url.path() == "/" ? "" : url.path()), "the names make the path");
}

} // namespace

void fuzzing::tryInput(std::string_view input)
{
    if (const auto url = Url::parse(input)) {
        if (url->isFileURL())
            tryFileURL(*url);
        else
            require(Url::parse(url->absoluteString()) == url, "a URL's text reads the same");
        // Whoever makes a URL of the program encodes the path first, and then the URL.
        if (const auto path = platform::percentDecoded(url->path()); path && path->starts_with('/'))
            tryFileURL(Url::fileURL(*path));
    }
    if (input.find('\0') != std::string_view::npos)
        return;
    tryFileURL(Url::fileURL('/' + std::string(input)));
    require(platform::percentDecoded(platform::percentEncoded(input)) == input, "encoding can be undone");
    require(platform::isValidUtf8(input)
            == (g_utf8_validate(input.data(), static_cast<gssize>(input.size()), nullptr) != FALSE),
        "two readers of UTF-8 agree");
}
