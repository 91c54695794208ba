// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/gtk/preview/PrintRun.h"

#include "host/gtk/base/ObjectRef.h"
#include "host/system/texts/Translate.h"
#include "platform/Dispatch.h"
#include "platform/Services.h"

#include <chrono>
#include <future>
#include <utility>

namespace host::gtk {

namespace {

using Ended = std::function<void(std::optional<platform::Error>)>;

/// The state of one print operation, which lives as long as the operation.
struct PrintRun {
    std::shared_ptr<PrintablePages> pages;
    Ended ended;
    std::shared_ptr<platform::Queue> queue; ///< lays the pages out and draws them
    std::future<int> count; ///< of the pages, once the layout has begun
};

platform::Size sizeOf(GtkPrintContext* paper)
{
    return {gtk_print_context_get_width(paper), gtk_print_context_get_height(paper)};
}

platform::Error printError(const GError* error)
{
    return {platform::errorDomain::system, error ? error->code : 0,
        {{std::string(platform::errorKey::localizedDescription),
             system::translated("The document could not be printed.")},
            {std::string(platform::errorKey::localizedFailureReason),
                std::string(error ? error->message : "")}}};
}

/// Answers TRUE when the number of pages is known. The toolkit asks again and again until then, so each call
/// waits a little.
gboolean paginate(GtkPrintOperation* operation, GtkPrintContext* paper, gpointer data)
{
    constexpr auto turn = std::chrono::milliseconds(4);
    auto* run = static_cast<PrintRun*>(data);
    if (!run->count.valid()) {
        const auto count = std::make_shared<std::promise<int>>();
        run->count = count->get_future();
        run->queue->async(
            [pages = run->pages, size = sizeOf(paper), count] { count->set_value(pages->paginate(size)); });
    }
    if (run->count.wait_for(turn) != std::future_status::ready)
        return FALSE;
    gtk_print_operation_set_n_pages(operation, run->count.get());
    return TRUE;
}

/// Draws a page on the queue. The toolkit goes on with the next one when it is told of the end.
void drawPage(GtkPrintOperation* operation, GtkPrintContext* paper, int page, gpointer data)
{
    const auto* run = static_cast<PrintRun*>(data);
    gtk_print_operation_set_defer_drawing(operation);
    run->queue->async([pages = run->pages, cairo = gtk_print_context_get_cairo_context(paper),
                          size = sizeOf(paper), page, main = platform::services().dispatch().mainQueue(),
                          operation = ObjectRef<GtkPrintOperation>::retain(operation)]() mutable {
        pages->draw(cairo, size, page);
        // The operation ends on the main thread, because its window does.
        main->async(
            [operation = std::move(operation)] { gtk_print_operation_draw_page_finish(operation.get()); });
    });
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
    g_signal_connect(operation, "paginate", G_CALLBACK(paginate), run);
    g_signal_connect(operation, "draw-page", G_CALLBACK(drawPage), run);
    g_signal_connect(operation, "done", G_CALLBACK(done), run);
}

} // namespace

void startPrinting(
    std::shared_ptr<PrintablePages> pages, const std::string& name, const PrintTarget& target, Ended ended)
{
    const auto operation = ObjectRef<GtkPrintOperation>::adopt(gtk_print_operation_new());
    auto run = std::make_unique<PrintRun>(PrintRun{std::move(pages), std::move(ended),
        platform::services().dispatch().makeSerialQueue("printed pages"), {}});
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
