#include "host/previews/SourceLanguages.h"

#include "platform/Dispatch.h"
#include "platform/Services.h"

#include <memory>
#include <utility>

namespace host::previews::SourceLanguages {

using gtk::ObjectRef;

namespace {

/// Used by the one queue below alone until it is handed to the main thread, which then only reads.
GtkSourceLanguageManager* manager()
{
    static const auto shared = ObjectRef<GtkSourceLanguageManager>::adopt(gtk_source_language_manager_new());
    return shared.get();
}

} // namespace

void guess(const std::string& fileName, Answer answer)
{
    auto& dispatch = platform::services().dispatch();
    const auto queue = dispatch.makeSerialQueue("source languages");
    // The work keeps its own queue until it has run.
    queue->async([queue, fileName, answer = std::move(answer), main = dispatch.mainQueue()] {
        auto* found = gtk_source_language_manager_guess_language(manager(), fileName.c_str(), nullptr);
        main->async(
            [queue, answer, language = ObjectRef<GtkSourceLanguage>::retain(found)] { answer(language); });
    });
}

} // namespace host::previews::SourceLanguages
