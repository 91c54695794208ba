// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Error.h"
#include "platform/Url.h"

#include <functional>
#include <optional>
#include <string>
#include <string_view>

namespace platform {

/// The scheme of URLs that lead into this program.
inline constexpr std::string_view applicationScheme = "tarrowdriveapp";

/// The URL that shows an item of the drive in this program, wherever it is opened. Its path is encoded twice,
/// as the path is decoded once as a URL's and once as the item's.
std::string linkToItem(const Url& item);

/// Hands documents to other programs of the desktop. Main thread.
class DocumentSharing {
public:
    /// Called once, on the main queue, with why it could not be done, or nothing. What the person does in the
    /// other program is not waited for, except for printing, which ends with its dialog.
    using Completion = std::function<void(std::optional<Error>)>;

    virtual ~DocumentSharing() = default;

    virtual void copyText(const std::string& text) = 0;

    virtual bool canSendByMail() const = 0;
    /// Begins a new message with the document attached.
    virtual void sendByMail(const Url& document, Completion completion) = 0;

    /// Shows an item, selected, in the file manager.
    virtual void showInFileManager(const Url& item, Completion completion) = 0;

    /// Whether documents of this name's type can be printed; the content is not looked at.
    virtual bool canPrint(const Url& document) const = 0;
    /// Asks how, then prints. A person who thinks better of it is no error.
    virtual void print(const Url& document, Completion completion) = 0;
};

} // namespace platform
