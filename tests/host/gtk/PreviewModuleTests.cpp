// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "WindowFixture.h"
#include "host/gtk/preview/PrintablePages.h"
#include "host/system/queues/GLibDispatch.h"
#include "screens/preview/PreviewMediaView.h"
#include "screens/preview/PreviewTextView.h"
#include "tests/support/SimplePdf.h"
#include "tests/support/TemporaryDirectory.h"

#include <filesystem>

namespace {

using host::gtk::PreviewModule;
using screens::PreviewMediaView;
using screens::PreviewTextView;
using screens::PreviewView;

struct BadModule {
    const char* name;
    const char* contentOf; ///< the file whose content the module gets; empty: there is no module
};

void PrintTo(const BadModule& row, std::ostream* stream)
{
    *stream << row.name;
}

class MissingPreviews : public testing_support::WindowFixture,
                        public ::testing::WithParamInterface<BadModule> {
protected:
    MissingPreviews()
    {
        installed.dispatch = std::make_shared<host::system::GLibDispatch>();
        platform::installServices(installed);
        if (*GetParam().contentOf)
            std::filesystem::copy_file(GetParam().contentOf, folder.at("previews.so"));
        previews = PreviewModule::inFile(folder.at("previews.so"));
        host = std::make_shared<host::gtk::GtkWindowHost>(
            nullptr, host::gtk::WindowSize{400, 700, false}, previews);
        kit::WindowHost::install(host);
    }
    std::string wordsOf(const std::shared_ptr<PreviewView>& view)
    {
        std::string words;
        view->setOnFailure([&words](const std::string& said) { words = said; });
        const auto screen = testing_support::makeScreen("Preview");
        screen->setView(view);
        show(screen);
        waitFor([&] { return !words.empty(); }, "what is missing");
        return words;
    }

    testing_support::TemporaryDirectory folder;
    std::shared_ptr<PreviewModule> previews;
};

TEST_P(MissingPreviews, AreSaidToBeMissing)
{
    const auto path = folder.write("One.pdf", testing_support::simplePdf({"one"}));
    const auto opened = previews->open(path);
    ASSERT_TRUE(opened.error);
    EXPECT_EQ(opened.error->text(platform::errorKey::localizedDescription), PreviewModule::missingWords());
    EXPECT_EQ(previews->makeThumbnail(path, platform::ThumbnailContent::Pages, 64)
                  .error->text(platform::errorKey::localizedDescription),
        PreviewModule::missingWords());
    EXPECT_EQ(host::gtk::readPrintablePages(path, host::gtk::PrintableKind::Pdf, *previews)
                  .error->text(platform::errorKey::localizedDescription),
        PreviewModule::missingWords());
    EXPECT_EQ(wordsOf(std::make_shared<PreviewTextView>()), PreviewModule::missingWords());
    EXPECT_EQ(wordsOf(std::make_shared<PreviewMediaView>()), PreviewModule::missingWords());
}

INSTANTIATE_TEST_SUITE_P(Modules, MissingPreviews,
    ::testing::Values(BadModule{"NoFile", ""}, BadModule{"NoModule", "/etc/passwd"},
        BadModule{"AnotherModule", TRW_ANOTHER_MODULE}),
    [](const auto& row) { return row.param.name; });

} // namespace
