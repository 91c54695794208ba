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

/// Loads the libraries of the previews when they are first wanted, and keeps them. Without them the program
/// goes on: what needs them says that they are missing.
///
/// The module is never unloaded, because the types that its libraries register with the toolkit cannot be. It
/// is linked with its libraries alone and finds everything else in the program, which exports its symbols for
/// that: so there is one copy of every class and of all state.
class PreviewModule : public platform::PagedDocumentOpener,
                      public platform::TextDecoder,
                      public std::enable_shared_from_this<PreviewModule> {
public:
    using Libraries = std::shared_ptr<const PreviewLibraries>;
    using Answer = std::function<void(const Libraries& libraries)>;

    /// Those that `load` makes; it is called once, on any thread, and answers null for none.
    explicit PreviewModule(std::function<Libraries()> load);
    /// Those of the module in a file.
    static std::shared_ptr<PreviewModule> inFile(const std::string& path);

    /// Loads them at the first call, which takes tens of milliseconds; others wait for it. Null: they are
    /// missing, as one log line says. Any thread, but rather not the main thread.
    Libraries load() const;
    /// Answers at once when they are there, else from the main queue after a worker has loaded them. Main
    /// thread.
    void whenLoaded(Answer answer);

    /// Loads first. Errors: that the module is missing, in words; else as the opener of the module.
    platform::Result<std::shared_ptr<platform::PagedDocument>> open(const std::string& path) const override;
    platform::Result<std::shared_ptr<platform::PagedDocumentEditing>> openForEditing(
        std::shared_ptr<const std::string> bytes) const override;

    /// Loads first. Nothing where the module is missing; else as the decoder of the module.
    std::optional<std::string> decode(std::string_view bytes, platform::TextEnd end) const override;

    /// What is said where the libraries are missing, and the error that says so.
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
    std::shared_ptr<platform::Queue> _queue; ///< made when a worker has to load; kept until it has
};

} // namespace host::gtk
