// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/gtk/preview/PrintRun.h"

#include "host/gtk/base/ObjectRef.h"
#include "host/system/texts/Translate.h"

#include <utility>

namespace host::gtk {

namespace {

using Ended = std::function<void(std::optional<platform::Error>)>;

/// The state of one print operation, which lives as long as the operation.
struct PrintRun {
    std::shared_ptr<PrintablePages> pages;
    Ended ended;
};

platform::Error printError(const GError* error)
{
    return {platform::errorDomain::system, error ? error->code : 0,
        {{std::string(platform::errorKey::localizedDescription),
             system::translated("The document could not be printed.")},
            {std::string(platform::errorKey::localizedFailureReason),
                std::string(error ? error->message : "")}}};
}

void beginPrint(GtkPrintOperation* operation, GtkPrintContext* paper, gpointer data)
{
    gtk_print_operation_set_n_pages(operation, static_cast<PrintRun*>(data)->pages->paginate(paper));
}

void drawPage(GtkPrintOperation*, GtkPrintContext* paper, int page, gpointer data)
{
    static_cast<PrintRun*>(data)->pages->draw(paper, page);
}

void done(GtkPrintOperation* operation, GtkPrintOperationResult result, gpointer data)
{
    auto* run = static_cast<PrintRun*>(data);
    GError* error = nullptr;
    if (result == GTK_PRINT_OPERATION_RESULT_ERROR)
        gtk_print_operation_get_error(operation, &error);
    const std::unique_ptr<GError, decltype(&g_error_free)> owned(error, g_error_free);
    if (const auto ended = std::exchange(run->ended, {}))
        ended(result == GTK_PRINT_OPERATION_RESULT_ERROR ? std::optional(printError(owned.get()))
                                                         : std::nullopt);
}

void connect(GtkPrintOperation* operation, PrintRun* run)
{
    // The operation deletes the run when it is destroyed.
    g_object_set_data_full(
        G_OBJECT(operation), "print-run", run, [](gpointer data) { delete static_cast<PrintRun*>(data); });
    g_signal_connect(operation, "begin-print", G_CALLBACK(beginPrint), run);
    g_signal_connect(operation, "draw-page", G_CALLBACK(drawPage), run);
    g_signal_connect(operation, "done", G_CALLBACK(done), run);
}

} // namespace

void startPrinting(
    std::shared_ptr<PrintablePages> pages, const std::string& name, const PrintTarget& target, Ended ended)
{
    const auto operation = ObjectRef<GtkPrintOperation>::adopt(gtk_print_operation_new());
    auto run = std::make_unique<PrintRun>(PrintRun{std::move(pages), std::move(ended)});
    connect(operation.get(), run.release());
    gtk_print_operation_set_job_name(operation.get(), name.c_str());
    gtk_print_operation_set_unit(operation.get(), GTK_UNIT_POINTS);
    gtk_print_operation_set_allow_async(operation.get(), TRUE);
    auto action = GTK_PRINT_OPERATION_ACTION_PRINT_DIALOG;
    if (!target.file.empty()) {
        gtk_print_operation_set_export_filename(operation.get(), target.file.c_str());
        action = GTK_PRINT_OPERATION_ACTION_EXPORT;
    }
    // The "done" signal reports how the operation ended.
    gtk_print_operation_run(operation.get(), action, target.dialogParent, nullptr);
}

} // namespace host::gtk
