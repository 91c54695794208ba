// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/DocumentSharing.h"

#include <memory>
#include <optional>

namespace platform {
class OperationQueue;
class TypeRegistry;
} // namespace platform

namespace host::gtk {

class PreviewModule;
enum class PrintableKind : int;

/// Shares a document through the desktop: its clipboard, the mail program of "mailto" through xdg-email, the
/// file manager that answers org.freedesktop.FileManager1 (else the one that opens folders), and its print
/// dialog.
class DesktopSharing : public platform::DocumentSharing {
public:
    DesktopSharing(
        std::shared_ptr<const platform::TypeRegistry> types, std::shared_ptr<const PreviewModule> previews);

    void chooseFiles(Chosen chosen) override;
    void copyText(const std::string& text) override;
    void copyFiles(const std::vector<platform::Url>& files) override;
    bool canSendByMail() const override;
    void sendByMail(const platform::Url& document, Completion completion) override;
    void showInFileManager(const platform::Url& item, Completion completion) override;
    bool canPrint(const platform::Url& document) const override;
    void print(const platform::Url& document, Completion completion) override;

private:
    std::optional<PrintableKind> printableKind(const platform::Url& document) const;

    std::shared_ptr<const platform::TypeRegistry> _types;
    std::shared_ptr<const PreviewModule> _previews;
    std::shared_ptr<platform::OperationQueue> _queue; ///< made at the first printing
};

} // namespace host::gtk
