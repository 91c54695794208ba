// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/gtk/app/DesktopSharing.h"

#include "host/gtk/base/LocalFiles.h"
#include "host/gtk/base/ObjectRef.h"
#include "host/gtk/base/SignalConnection.h"
#include "host/gtk/preview/PrintRun.h"
#include "host/gtk/preview/PrintablePages.h"
#include "host/system/texts/Translate.h"
#include "platform/Dispatch.h"
#include "platform/Services.h"
#include "platform/TypeRegistry.h"

#include <gio/gio.h>
#include <gtk/gtk.h>

#include <utility>

namespace host::gtk {

using host::system::translated;
using platform::Error;
using platform::Url;

namespace {

using Completion = platform::DocumentSharing::Completion;
using OwnedError = std::unique_ptr<GError, decltype(&g_error_free)>;

/// One call to another program: the message for a failure, and the completion.
struct Call {
    std::string words;
    Completion completion;
    std::string folder{}; ///< the item's folder, for the file manager
};

Error failureOf(const Call& call, const GError* error)
{
    return {platform::errorDomain::system, error ? error->code : 0,
        {{std::string(platform::errorKey::localizedDescription), call.words},
            {std::string(platform::errorKey::localizedFailureReason),
                std::string(error ? error->message : "")}}};
}

void end(const Call& call, const GError* error)
{
    call.completion(error ? std::optional(failureOf(call, error)) : std::nullopt);
}

void mailerEnded(GObject* process, GAsyncResult* result, gpointer data)
{
    const std::unique_ptr<Call> call(static_cast<Call*>(data));
    GError* error = nullptr;
    g_subprocess_wait_check_finish(G_SUBPROCESS(process), result, &error);
    end(*call, OwnedError(error, g_error_free).get());
}

void folderWasOpened(GObject*, GAsyncResult* result, gpointer data)
{
    const std::unique_ptr<Call> call(static_cast<Call*>(data));
    GError* error = nullptr;
    g_app_info_launch_default_for_uri_finish(result, &error);
    end(*call, OwnedError(error, g_error_free).get());
}

void itemWasShown(GObject* bus, GAsyncResult* result, gpointer data)
{
    std::unique_ptr<Call> call(static_cast<Call*>(data));
    GError* error = nullptr;
    auto* answer = g_dbus_connection_call_finish(G_DBUS_CONNECTION(bus), result, &error);
    const OwnedError owned(error, g_error_free);
    if (answer) {
        g_variant_unref(answer);
        end(*call, nullptr);
        return;
    }
    // No file manager answers on the bus, so at least the folder is opened.
    const auto folder = call->folder;
    g_app_info_launch_default_for_uri_async(
        folder.c_str(), nullptr, nullptr, folderWasOpened, call.release());
}

GtkWindow* activeWindow()
{
    auto* application = g_application_get_default();
    return GTK_IS_APPLICATION(application) ? gtk_application_get_active_window(GTK_APPLICATION(application))
                                           : nullptr;
}

} // namespace

DesktopSharing::DesktopSharing(
    std::shared_ptr<const platform::TypeRegistry> types, std::shared_ptr<const PreviewModule> previews)
    : _types(std::move(types))
    , _previews(std::move(previews))
{
}

void DesktopSharing::chooseFiles(Chosen chosen)
{
    auto* chooser = gtk_file_chooser_native_new(translated("Add Files").c_str(), activeWindow(),
        GTK_FILE_CHOOSER_ACTION_OPEN, translated("Add").c_str(), nullptr);
    gtk_file_chooser_set_select_multiple(GTK_FILE_CHOOSER(chooser), TRUE);
    gtk_native_dialog_set_modal(GTK_NATIVE_DIALOG(chooser), TRUE);
    connectForLife<void(int)>(chooser, "response", [chooser, chosen = std::move(chosen)](int response) {
        std::vector<Url> files;
        if (response == GTK_RESPONSE_ACCEPT) {
            const auto list =
                ObjectRef<GListModel>::adopt(gtk_file_chooser_get_files(GTK_FILE_CHOOSER(chooser)));
            files = LocalFiles::of(list.get()).files;
        }
        const auto told = chosen;
        g_object_unref(chooser);
        told(files);
    });
    gtk_native_dialog_show(GTK_NATIVE_DIALOG(chooser));
}

void DesktopSharing::copyText(const std::string& text)
{
    if (auto* display = gdk_display_get_default())
        gdk_clipboard_set_text(gdk_display_get_clipboard(display), text.c_str());
}

void DesktopSharing::copyFiles(const std::vector<Url>& files)
{
    auto* display = gdk_display_get_default();
    if (!display)
        return;
    const auto content = ObjectRef<GdkContentProvider>::adopt(contentOf(files));
    gdk_clipboard_set_content(gdk_display_get_clipboard(display), content.get());
}

bool DesktopSharing::canSendByMail() const
{
    const std::unique_ptr<char, decltype(&g_free)> program(g_find_program_in_path("xdg-email"), g_free);
    const auto mailer = ObjectRef<GAppInfo>::adopt(g_app_info_get_default_for_uri_scheme("mailto"));
    return program && mailer;
}

void DesktopSharing::sendByMail(const Url& document, Completion completion)
{
    auto call =
        std::make_unique<Call>(Call{translated("No mail program could be started."), std::move(completion)});
    GError* error = nullptr;
    const auto subject = document.lastPathComponent();
    const auto process =
        ObjectRef<GSubprocess>::adopt(g_subprocess_new(G_SUBPROCESS_FLAGS_STDOUT_SILENCE, &error, "xdg-email",
            "--utf8", "--subject", subject.c_str(), "--attach", document.path().c_str(), nullptr));
    const OwnedError owned(error, g_error_free);
    if (process)
        g_subprocess_wait_check_async(process.get(), nullptr, mailerEnded, call.release());
    else
        platform::services().dispatch().mainQueue()->async(
            [failure = failureOf(*call, owned.get()), told = call->completion] { told(failure); });
}

void DesktopSharing::showInFileManager(const Url& item, Completion completion)
{
    auto call = std::make_unique<Call>(Call{translated("No file manager could be started."),
        std::move(completion), item.deletingLastPathComponent().absoluteString()});
    const auto bus = ObjectRef<GDBusConnection>::adopt(g_bus_get_sync(G_BUS_TYPE_SESSION, nullptr, nullptr));
    if (!bus) {
        const auto folder = call->folder;
        g_app_info_launch_default_for_uri_async(
            folder.c_str(), nullptr, nullptr, folderWasOpened, call.release());
        return;
    }
    const auto uri = item.absoluteString();
    const char* uris[] = {uri.c_str(), nullptr};
    g_dbus_connection_call(bus.get(), "org.freedesktop.FileManager1", "/org/freedesktop/FileManager1",
        "org.freedesktop.FileManager1", "ShowItems", g_variant_new("(^ass)", uris, ""), nullptr,
        G_DBUS_CALL_FLAGS_NONE, -1, nullptr, itemWasShown, call.release());
}

std::optional<PrintableKind> DesktopSharing::printableKind(const Url& document) const
{
    namespace type = platform::typeIdentifier;
    const auto found = _types->typeForExtension(document.pathExtension());
    if (!found)
        return std::nullopt;
    if (_types->conformsTo(*found, type::pdf))
        return PrintableKind::Pdf;
    if (_types->conformsTo(*found, type::image))
        return PrintableKind::Picture;
    if (_types->conformsTo(*found, type::text))
        return PrintableKind::Text;
    return std::nullopt;
}

bool DesktopSharing::canPrint(const Url& document) const
{
    return printableKind(document).has_value();
}

void DesktopSharing::print(const Url& document, Completion completion)
{
    const auto kind = printableKind(document);
    auto& dispatch = platform::services().dispatch();
    const auto main = dispatch.mainQueue();
    if (!kind) {
        main->async([told = std::move(completion)] { told(Error(platform::FileErrorCode::Unsupported)); });
        return;
    }
    if (!_queue)
        _queue = dispatch.makeOperationQueue("printing", platform::QualityOfService::UserInitiated);
    _queue->addOperation([path = document.path(), name = document.lastPathComponent(), kind = *kind, main,
                             previews = _previews, told = std::move(completion)] {
        auto pages = readPrintablePages(path, kind, *previews);
        main->async([pages = std::move(pages), name, told] {
            if (pages)
                startPrinting(*pages, name, {activeWindow()}, told);
            else
                told(pages.error);
        });
    });
}

} // namespace host::gtk
