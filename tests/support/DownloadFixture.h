// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/drive/changes/ContentCollection.h"
#include "host/drive/changes/DownloadWork.h"
#include "host/drive/changes/LocalCloudStore.h"
#include "host/drive/records/PromiseRecord.h"
#include "tests/support/DriveFixture.h"

#include <gtest/gtest.h>

namespace testing_support {

/// A drive whose documents are fetched and evicted, in a temporary folder.
class DownloadTest : public testing::Test, public DriveFixture {
protected:
    void SetUp() override { std::filesystem::create_directories(layout().cloud()); }
    std::string content(const std::string& name) const { return layout().cloud() + '/' + name; }
    platform::Url promise(const std::string& name, const std::string& text)
    {
        std::ofstream(content("content-" + name)) << text;
        host::drive::PromiseRecord record;
        record.size = text.size();
        record.modified = platform::Date{1'600'000'000'123'456'789};
        record.tags = {"Red", "Blue"};
        record.documentIdentifier = 42;
        record.role = platform::SharedItemRole::Participant;
        record.content = "content-" + name;
        return writePromise(name, record);
    }
    bool isIntact(const std::string& name, const std::string& text) const
    {
        return !std::filesystem::exists(url(name).path())
            && std::filesystem::exists(host::drive::PromiseRecord::pathFor(url(name).path()))
            && contentOf(content("content-" + name)) == text && !hasTraces();
    }
    std::unique_ptr<platform::ItemDownload> start(const platform::Url& item)
    {
        return cloud->items().startDownload(item,
            {[this](const platform::DownloadProgress& progress) {
                 heard.push_back(progress);
                 onProgress();
             },
                [this](const std::optional<platform::Error>& error) { ended.push_back(error); }});
    }
    /// Looks through the released contents until that is certain.
    host::drive::ContentCollection::Outcome collect()
    {
        constexpr int mostTries = 20;
        auto outcome = host::drive::ContentCollection::Outcome::Later;
        for (int tries = 0; tries < mostTries && outcome == host::drive::ContentCollection::Outcome::Later;
             ++tries) {
            std::filesystem::remove(
                layout().collection()); // else the next walk waits for as long as the last was slow
            outcome = host::drive::ContentCollection(layout()).run().value.value_or(outcome);
        }
        return outcome;
    }
    std::vector<platform::DownloadProgress> heard;
    std::vector<std::optional<platform::Error>> ended;
    std::function<void()> onProgress = [] {};
};

/// Does the steps of a change while nobody else is kept out.
inline const host::drive::KeepingOthersOut alone = [](const std::function<void()>& steps) {
    steps();
    return std::optional<platform::Error>();
};

/// Lets every download go on.
inline constexpr auto goOn = [](std::uint64_t, std::optional<std::uint64_t>) {
    return host::drive::CloudStore::Continue::Yes;
};

} // namespace testing_support
