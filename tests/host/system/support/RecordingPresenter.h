// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Dispatch.h"
#include "platform/FilePresenter.h"

#include <cerrno>
#include <memory>
#include <string>
#include <utility>
#include <vector>

namespace testing_support {

/// Records its calls with the item's name at that time, and answers as the test says.
class RecordingPresenter : public platform::FilePresenter {
public:
    RecordingPresenter(const std::string& path, std::shared_ptr<platform::OperationQueue> queue)
        : url(platform::Url::fileURL(path))
        , _queue(std::move(queue))
    {
    }
    platform::Url url;
    std::optional<platform::Error> answer;
    bool isSilent = false;
    std::vector<std::string> heard;
    std::vector<CompletionHandler> kept;

    std::optional<platform::Url> presentedItemURL() override { return url; }
    std::shared_ptr<platform::OperationQueue> presentedItemOperationQueue() override { return _queue; }
    void presentedItemDidChange() override { heard.emplace_back("changed"); }
    void presentedItemWillMoveToURL(const platform::Url& to) override
    {
        heard.push_back("moves to " + to.path());
    }
    void presentedItemDidMoveToURL(const platform::Url& to) override
    {
        heard.push_back("moved to " + to.path());
    }
    void accommodatePresentedItemDeletionWithCompletionHandler(CompletionHandler completion) override
    {
        heard.emplace_back("deletes");
        reply(std::move(completion));
    }
    void accommodatePresentedSubitemDeletionAtURLCompletionHandler(
        const platform::Url& item, CompletionHandler completion) override
    {
        heard.push_back("deletes " + item.lastPathComponent());
        reply(std::move(completion));
    }

private:
    void reply(CompletionHandler completion)
    {
        if (isSilent)
            return kept.push_back(std::move(completion));
        completion(answer);
        completion(platform::Error(platform::errorDomain::system, EIO)); // a second answer does not count
    }
    std::shared_ptr<platform::OperationQueue> _queue;
};

} // namespace testing_support
