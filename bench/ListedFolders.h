// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <algorithm>
#include <chrono>
#include <cstdlib>
#include <filesystem>
#include <map>
#include <random>
#include <string>
#include <vector>

namespace bench {

using Clock = std::chrono::steady_clock;

inline double milliseconds(Clock::duration duration)
{
    return std::chrono::duration<double, std::milli>(duration).count();
}

/// Answers the value below which a share (0 to 1) of the others lies.
inline double percentile(std::vector<double> values, double share)
{
    std::ranges::sort(values);
    return values[static_cast<std::size_t>(share * static_cast<double>(values.size() - 1))];
}

inline double median(const std::vector<double>& values)
{
    return percentile(values, 0.5);
}

/// Folders of documents with ordinary names, which are made once for each size and removed at the end.
class Folders {
public:
    ~Folders()
    {
        for (const auto& [size, path] : _paths)
            std::filesystem::remove_all(path);
    }
    const std::string& ofSize(int size)
    {
        auto& path = _paths[size];
        if (path.empty())
            path = make(size);
        return path;
    }

private:
    static std::string make(int size)
    {
        auto pattern = (std::filesystem::temp_directory_path() / "tarrow-bench-XXXXXX").string();
        if (!mkdtemp(pattern.data()))
            std::abort();
        static constexpr const char* stems[] = {
            "Invoice", "Minutes of the meeting", "IMG_", "Résumé", "photo"};
        static constexpr const char* extensions[] = {".pdf", ".txt", ".jpg", ".docx", ""};
        std::mt19937 random(1);
        for (int i = 0; i < size; ++i) {
            const auto name = pattern + '/' + stems[random() % 5] + ' ' + std::to_string(random() % 1'000'000)
                + ' ' + std::to_string(i) + extensions[random() % 5];
            if (i % 20 == 0)
                ::mkdir(name.c_str(), 0700);
            else
                ::close(::open(name.c_str(), O_CREAT | O_WRONLY | O_CLOEXEC, 0600));
        }
        return pattern;
    }
    std::map<int, std::string> _paths;
};

inline Folders& folders()
{
    static Folders instance;
    return instance;
}

} // namespace bench
