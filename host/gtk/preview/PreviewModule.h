// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/gtk/preview/PreviewLibraries.h"

#include <atomic>
#include <functional>
#include <memory>
#include <mutex>
#include <string>
#include <vector>

namespace platform {
class Dispatch;
class Queue;
} // namespace platform

namespace host::gtk {

/// Loads the libraries of the previews on first use and keeps them. When they are missing the program goes
/// on, and every operation that needs them answers an error.
///
/// The module is never unloaded, because the types that its libraries register with the toolkit cannot be. It
/// is linked with its libraries alone and finds everything else in the program, which exports its symbols for
/// that, so that there is one copy of every class and of all state.
class PreviewModule : public platform::PagedDocumentOpener,
                      public platform::TextDecoder,
                      public platform::ThumbnailMaker,
                      public std::enable_shared_from_this<PreviewModule> {
public:
    using Libraries = std::shared_ptr<const PreviewLibraries>;
    using Answer = std::function<void(const Libraries& libraries)>;

    /// Uses the libraries that `load` makes. It is called once, on any thread, and answers null for none.
    explicit PreviewModule(std::function<Libraries()> load);
    /// Uses the libraries of the module in a file.
    static std::shared_ptr<PreviewModule> inFile(const std::string& path);

    /// Loads the libraries at the first call, which takes tens of milliseconds; other threads wait for it.
    /// Answers null when they are missing, which one log line reports. Any thread, but rather not the main
    /// thread.
    Libraries load() const;
    /// Answers at once when the libraries are loaded, else from the main queue after a worker has loaded
    /// them. Main thread.
    void whenLoaded(Answer answer);

    /// Loads the libraries first. The error is missingError() when the module is missing, else one of the
    /// module's opener.
    platform::Result<std::shared_ptr<platform::PagedDocument>> open(const std::string& path) const override;
    platform::Result<std::shared_ptr<platform::PagedDocumentEditing>> openForEditing(
        std::shared_ptr<const std::string> bytes) const override;

    /// Loads the libraries first. Answers nothing when the module is missing, else what the module's decoder
    /// answers.
    std::optional<std::string> likelyEncoding(std::string_view bytes) const override;
    /// Loads the libraries first. When the module is missing, bytes that are not UTF-8 become replacement
    /// characters.
    std::string decode(
        std::string_view bytes, const std::string& encoding, platform::TextEnd end) const override;

    /// Loads the libraries first. The error is missingError() when the module is missing, else one of the
    /// module's maker.
    platform::Result<platform::Image> makeThumbnail(
        const std::string& path, platform::ThumbnailContent content, int pixelSize) const override;

    /// The sentence for the screen when the libraries are missing, and the error with that sentence.
    static std::string missingWords();
    static platform::Error missingError();

private:
    void loadOnWorker();
    void answerAll();

    mutable std::function<Libraries()> _load;
    mutable std::once_flag _once;
    mutable Libraries _libraries; ///< written once, before `_isLoaded`
    mutable std::atomic<bool> _isLoaded = false;
    std::vector<Answer> _waiting; ///< main thread only
    std::shared_ptr<platform::Queue> _queue; ///< made when a worker has to load; kept until then
};

} // namespace host::gtk
