// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "fuzz/support/Fuzzing.h"
#include "host/system/files/JsonUserDefaults.h"
#include "tests/support/VirtualDispatch.h"

#include <nlohmann/json.hpp>

#include <filesystem>
#include <fstream>

namespace {

std::string content(const std::string& path)
{
    std::ifstream file(path, std::ios::binary);
    return {std::istreambuf_iterator<char>(file), {}};
}

} // namespace

void fuzzing::tryInput(std::string_view input)
{
    const auto path = writeFile(folder() + "/defaults.json", input);
    const auto dispatch = testing_support::VirtualDispatch::create();
    const platform::Data value{std::byte{1}};
    std::optional<platform::Data> before, after;
    {
        host::system::JsonUserDefaults defaults(path, *dispatch);
        before = defaults.data("other");
        defaults.setData("mine", value);
    }
    {
        const host::system::JsonUserDefaults defaults(path, *dispatch);
        after = defaults.data("other");
        require(content(path) == input || defaults.data("mine") == value, "what is set is stored");
    }
    require(before == after, "other values stay");
    require(
        host::system::parseJson(input) || content(path + ".damaged") == input, "what cannot be read is kept");
    std::filesystem::remove(path + ".damaged");
}
