// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "fuzz/support/Fuzzing.h"

#include "tests/support/TemporaryDirectory.h"

#include <cstdint>
#include <cstdio>
#include <cstdlib>

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size);

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size)
{
    fuzzing::tryInput({reinterpret_cast<const char*>(data), size});
    return 0;
}

namespace fuzzing {

void require(bool holds, const char* rule)
{
    if (holds)
        return;
    std::fprintf(stderr, "This rule is broken: %s\n", rule);
    std::abort();
}

unsigned char Bytes::byte()
{
    if (_rest.empty())
        return 0;
    const auto first = static_cast<unsigned char>(_rest.front());
    _rest.remove_prefix(1);
    return first;
}

const std::string& folder()
{
    static const testing_support::TemporaryDirectory directory;
    static const std::string path = directory.path().string();
    return path;
}

std::string writeFile(const std::string& path, std::string_view content)
{
    std::ofstream(path, std::ios::binary | std::ios::trunc) << content;
    return path;
}

} // namespace fuzzing
