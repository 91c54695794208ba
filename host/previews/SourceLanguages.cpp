// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/previews/SourceLanguages.h"

#include "platform/Dispatch.h"
#include "platform/Services.h"

#include <map>
#include <memory>
#include <mutex>
#include <utility>

namespace host::previews::SourceLanguages {

using gtk::ObjectRef;

namespace {

/// A language with everything that its colours need. It has a language manager of its own, because the
/// library's objects are not thread-safe: once the main thread has this, no worker touches it again.
struct Prepared {
    ObjectRef<GtkSourceLanguageManager> manager;
    ObjectRef<GtkSourceLanguage> language;
    ObjectRef<GtkSourceBuffer> keeper; ///< the language's description lives as long as some buffer uses it
};

using Languages = std::map<std::string, std::shared_ptr<const Prepared>>;

std::shared_ptr<const Prepared> prepare(const std::string& identifier)
{
    auto prepared = std::make_shared<Prepared>();
    prepared->manager = ObjectRef<GtkSourceLanguageManager>::adopt(gtk_source_language_manager_new());
    prepared->language = ObjectRef<GtkSourceLanguage>::retain(
        gtk_source_language_manager_get_language(prepared->manager.get(), identifier.c_str()));
    prepared->keeper = ObjectRef<GtkSourceBuffer>::adopt(gtk_source_buffer_new(nullptr));
    gtk_source_buffer_set_highlight_syntax(prepared->keeper.get(), FALSE);
    gtk_source_buffer_set_language(prepared->keeper.get(), prepared->language.get());
    return prepared;
}

/// Answers the language of a file name. Calls run one at a time. Prepared languages are kept, as the library
/// keeps its own.
std::shared_ptr<const Prepared> find(const std::string& fileName)
{
    static std::mutex mutex;
    static const auto names = ObjectRef<GtkSourceLanguageManager>::adopt(gtk_source_language_manager_new());
    // The map is never destroyed. At the end of the program the library has already released its objects, and
    // a buffer that is destroyed afterwards would report an error.
    static auto& known = *std::make_unique<Languages>().release();
    const std::lock_guard lock(mutex);
    auto* found = gtk_source_language_manager_guess_language(names.get(), fileName.c_str(), nullptr);
    if (!found)
        return nullptr;
    auto& prepared = known[gtk_source_language_get_id(found)];
    if (!prepared)
        prepared = prepare(gtk_source_language_get_id(found));
    return prepared;
}

} // namespace

void guess(const std::string& fileName, Answer answer)
{
    auto& dispatch = platform::services().dispatch();
    const auto queue = dispatch.makeSerialQueue("source languages");
    // The work keeps its queue alive until it has run.
    queue->async([queue, fileName, answer = std::move(answer), main = dispatch.mainQueue()] {
        main->async([queue, answer, prepared = find(fileName)] {
            answer(prepared ? prepared->language : ObjectRef<GtkSourceLanguage>());
        });
    });
}

} // namespace host::previews::SourceLanguages
