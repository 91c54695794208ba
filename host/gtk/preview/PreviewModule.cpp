// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/gtk/preview/PreviewModule.h"

#include "host/system/texts/DisplayableText.h"
#include "host/system/texts/Translate.h"
#include "platform/Dispatch.h"
#include "platform/Log.h"
#include "platform/Services.h"
#include "platform/Weakly.h"

#include <dlfcn.h>

#include <cerrno>
#include <utility>

namespace host::gtk {

namespace {

/// Loads the module. All of its symbols are resolved at once, so that a missing one means a missing module
/// and not a crash later. The module is never unloaded, because the types that it registers stay.
PreviewModule::Libraries loadFile(const std::string& path)
{
    static constexpr platform::Operation op{"PreviewModule::loadFile"};
    auto* module = ::dlopen(path.c_str(), RTLD_NOW | RTLD_LOCAL | RTLD_NODELETE);
    auto* make =
        module ? reinterpret_cast<MakePreviewLibraries*>(::dlsym(module, makePreviewLibrariesName)) : nullptr;
    std::shared_ptr<PreviewLibraries> made;
    if (make)
        make(made);
    else
        op.error("The module of the previews cannot be loaded: %s", std::string(::dlerror()));
    return made;
}

} // namespace

PreviewModule::PreviewModule(std::function<Libraries()> load)
    : _load(std::move(load))
{
}

std::shared_ptr<PreviewModule> PreviewModule::inFile(const std::string& path)
{
    return std::make_shared<PreviewModule>([path] { return loadFile(path); });
}

PreviewModule::Libraries PreviewModule::load() const
{
    std::call_once(_once, [this] {
        _libraries = std::exchange(_load, {})();
        _isLoaded = true;
    });
    return _libraries;
}

void PreviewModule::whenLoaded(Answer answer)
{
    if (_isLoaded && _libraries) {
        answer(_libraries);
        return;
    }
    _waiting.push_back(std::move(answer));
    if (!_queue)
        loadOnWorker();
}

void PreviewModule::loadOnWorker()
{
    auto& dispatch = platform::services().dispatch();
    _queue = dispatch.makeSerialQueue("preview libraries");
    _queue->async(
        [loading = platform::weakly(this, &PreviewModule::load),
            answering = platform::weakly(this, &PreviewModule::answerAll), main = dispatch.mainQueue()] {
            loading();
            main->async(answering);
        });
}

void PreviewModule::answerAll()
{
    _queue.reset();
    for (const auto& answer : std::exchange(_waiting, {}))
        answer(_libraries);
}

platform::Result<std::shared_ptr<platform::PagedDocument>> PreviewModule::open(const std::string& path) const
{
    if (const auto libraries = load())
        return libraries->pagedDocuments().open(path);
    return missingError();
}

platform::Result<std::shared_ptr<platform::PagedDocumentEditing>> PreviewModule::openForEditing(
    std::shared_ptr<const std::string> bytes) const
{
    if (const auto libraries = load())
        return libraries->pagedDocuments().openForEditing(std::move(bytes));
    return missingError();
}

std::optional<std::string> PreviewModule::likelyEncoding(std::string_view bytes) const
{
    const auto libraries = load();
    return libraries ? libraries->textDecoder().likelyEncoding(bytes) : std::nullopt;
}

std::string PreviewModule::decode(
    std::string_view bytes, const std::string& encoding, platform::TextEnd end) const
{
    const auto libraries = load();
    return libraries ? libraries->textDecoder().decode(bytes, encoding, end)
                     : host::system::displayableText(bytes);
}

platform::Result<platform::Image> PreviewModule::makeThumbnail(
    const std::string& path, platform::ThumbnailContent content, int pixelSize) const
{
    const auto libraries = load();
    return libraries ? libraries->thumbnails().makeThumbnail(path, content, pixelSize) : missingError();
}

std::string PreviewModule::missingWords()
{
    return system::translated("The part of the program that shows such documents is missing.");
}

platform::Error PreviewModule::missingError()
{
    return {platform::errorDomain::system, ENOSYS,
        {{std::string(platform::errorKey::localizedDescription), missingWords()}}};
}

} // namespace host::gtk
