// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/DocumentSharing.h"

#include <string>
#include <vector>

namespace testing_support {

/// Records what is handed to other programs. Each of them answers `answer` at once.
class RecordingSharing : public platform::DocumentSharing {
public:
    void copyText(const std::string& text) override { lines.push_back("copy " + text); }
    void copyFiles(const std::vector<platform::Url>& files) override
    {
        for (const auto& file : files)
            lines.push_back("copy file " + file.lastPathComponent());
    }
    bool canSendByMail() const override { return hasMailer; }
    void sendByMail(const platform::Url& document, Completion completion) override
    {
        record("mail", document, completion);
    }
    void showInFileManager(const platform::Url& item, Completion completion) override
    {
        record("show", item, completion);
    }
    bool canPrint(const platform::Url& document) const override { return document.pathExtension() == "pdf"; }
    void print(const platform::Url& document, Completion completion) override
    {
        record("print", document, completion);
    }

    void chooseFiles(Chosen chosen) override { asked = std::move(chosen); }

    Chosen asked; ///< waits for the files that a person chooses
    bool hasMailer = true;
    std::optional<platform::Error> answer;
    std::vector<std::string> lines;

private:
    void record(const std::string& what, const platform::Url& url, const Completion& completion)
    {
        lines.push_back(what + " " + url.lastPathComponent());
        completion(answer);
    }
};

} // namespace testing_support
