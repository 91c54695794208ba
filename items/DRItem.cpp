// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "items/DRItem.h"

#include "platform/Localization.h"

#include <stdexcept>
#include <utility>

namespace tarrow {

namespace {

std::string textOrNull(const std::string& text)
{
    return platform::logText(text.empty() ? std::nullopt : std::optional(text));
}

} // namespace

std::shared_ptr<DRItem> DRItem::initWithURL(const Url& url)
{
    static constexpr Operation op{"-[DRItem initWithURL:]"};
    auto item = std::make_shared<DRItem>(Token(), url);
    if (item->cacheValues())
        return item;
    op.error("Failed to cache values for URL %@", url);
    return nullptr;
}

std::shared_ptr<DRItem> DRItem::init()
{
    throw std::invalid_argument(platform::formatText("Don't call %@.", {"-[DRItem init]"}));
}

DRItem::DRItem(Token, Url url)
    : _url(std::move(url))
{
}

void DRItem::setUrl(const Url& url)
{
    if (url == _url)
        return;
    _url = url;
    cacheValues();
}

bool DRItem::isPromise() const
{
    return _promiseURL && !(_resolvedURL && _promiseURL->isSameObject(*_resolvedURL));
}

// The text is formatted at the first question, because most records are read without anyone looking at their
// size.
std::string DRItem::friendlyFileSize() const
{
    if (!_friendlySize)
        return _friendlyFileSize;
    return services().formatters().byteCount(
        *_friendlySize, platform::ByteCountStyle::File, platform::ByteCountUnit::Included);
}

void DRItem::setFriendlyFileSize(std::string text)
{
    _friendlySize.reset();
    _friendlyFileSize = std::move(text);
}

std::optional<std::string> DRItem::friendlyDateStyle(const std::optional<Date>& date, DateStyle style)
{
    return date ? std::optional(services().formatters().date(*date, style, DateStyle::Short)) : std::nullopt;
}

std::optional<std::string> DRItem::friendlyCreationDate(DateStyle style) const
{
    return friendlyDateStyle(_creationDate, style);
}

std::optional<std::string> DRItem::friendlyContentModificationDate(DateStyle style) const
{
    return friendlyDateStyle(_contentModificationDate, style);
}

std::string DRItem::description() const
{
    const auto orSame = [&](const std::optional<Url>& url) {
        return url == _url ? "<same>" : platform::logText(url);
    };
    return platform::formatText("Name=%@, Size=%@, URL=%@, ResURL=%@, PromiseURL=%@, %@%@%@%@",
        {textOrNull(_localizedName), platform::logText(_fileSize), platform::logText(_url),
            orSame(_resolvedURL), orSame(_promiseURL), _isDirectory ? "Directory, " : "",
            _isPackage ? "Package, " : "", isPromise() ? "Promise, " : "Local,",
            _isSymlink ? "Symlink, " : ""});
}

} // namespace tarrow
