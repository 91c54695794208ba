// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Error.h"
#include "platform/Url.h"

#include <functional>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace platform {

/// The scheme of the URLs that lead into this program; the desktop entry claims it.
inline constexpr std::string_view applicationScheme = "tarrowdriveapp";

/// Answers the URL that shows an item of the drive in this program, wherever it is opened, as in
/// "tarrowdriveapp:///home/mira/Notes.txt". Its path is percent-encoded twice, because it is decoded once as
/// the path of this URL and once as the path of the item's own. Any thread.
std::string linkToItem(const Url& item);

/// Hands documents to other programs of the desktop, and takes files from them. Main thread only; no call
/// waits for another program.
class DocumentSharing {
public:
    /// Called once, on the main thread, after the call that it was given to has returned: with an error when
    /// the other program could not be reached, whose description is a sentence for the user, and otherwise
    /// with nothing. What the person then does in the other program is not waited for, except for printing,
    /// which ends with its dialog.
    using Completion = std::function<void(std::optional<Error>)>;

    virtual ~DocumentSharing() = default;

    /// Lets the person choose files of this machine. `chosen` is called once, later, with the local ones
    /// among what was chosen; with none when the person thought better of it.
    using Chosen = std::function<void(const std::vector<Url>& files)>;
    virtual void chooseFiles(Chosen chosen) = 0;

    /// Puts a text on the clipboard. Without a display nothing happens.
    virtual void copyText(const std::string& text) = 0;
    /// Puts files and folders on the clipboard, where file managers find them. The other program reads them
    /// when it pastes, so they must be here.
    virtual void copyFiles(const std::vector<Url>& files) = 0;

    /// Whether a mail program is set up that takes attachments. The answer may change while the program runs.
    virtual bool canSendByMail() const = 0;
    /// Begins a new message with the document attached and its name as the subject. The document must be
    /// here: the mail program reads the file by itself.
    virtual void sendByMail(const Url& document, Completion completion) = 0;

    /// Shows an item, selected, in the file manager. Where no file manager answers on the session bus, the
    /// folder that holds the item is opened instead.
    virtual void showInFileManager(const Url& item, Completion completion) = 0;

    /// Whether a document of this name can be printed, judged by the type of its extension (PDF, picture or
    /// text); the content is not looked at.
    virtual bool canPrint(const Url& document) const = 0;
    /// Reads the document in the background, shows the print dialog and prints. When the person cancels the
    /// dialog the completion is called with nothing, because that is no error. Errors:
    /// FileErrorCode::Unsupported for what cannot be printed, else those of reading the document.
    virtual void print(const Url& document, Completion completion) = 0;
};

} // namespace platform
