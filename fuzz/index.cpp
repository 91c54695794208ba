// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "fuzz/support/Fuzzing.h"
#include "host/drive/identity/DocumentIndex.h"

#include <fstream>
#include <iterator>

namespace {

using fuzzing::folder;
using host::drive::DocumentIndex;

constexpr std::uint32_t documents = 300;

/// Answers the bytes of an index with some hundred documents, in several pages.
const std::string& wholeIndex()
{
    static const std::string bytes = [] {
        const auto path = folder() + "/whole.sqlite";
        std::vector<host::drive::IdentifiedPlace> all;
        for (std::uint32_t i = 1; i <= documents; ++i)
            all.push_back({i, {"Documents/folder " + std::to_string(i % 7) + "/" + std::to_string(i), 1, i}});
        fuzzing::require(DocumentIndex(path).complete(all), "an index can be made");
        std::ifstream file(path, std::ios::binary);
        return std::string(std::istreambuf_iterator<char>(file), {});
    }();
    return bytes;
}

/// Damages the bytes as the input says: a place, a length and the bytes that come there.
void damage(std::string& index, fuzzing::Bytes& input)
{
    while (!input.rest().empty()) {
        const auto place = input.pair() % index.size();
        for (auto length = input.byte() % 8U + 1; length > 0; --length)
            index[(place + length) % index.size()] = static_cast<char>(input.byte());
    }
}

} // namespace

/// The first byte says whether the input is the file or damages a whole one, whether it is cut, and whether
/// there is a write-ahead log.
void fuzzing::tryInput(std::string_view input)
{
    Bytes bytes(input);
    const auto choice = bytes.byte();
    auto content = wholeIndex();
    if ((choice & 2U) != 0)
        content.resize(bytes.pair() % content.size());
    const auto log = (choice & 4U) != 0 ? bytes.rest() : std::string_view();
    if ((choice & 1U) != 0 || content.empty())
        content = bytes.rest();
    else
        damage(content, bytes);
    const auto path = folder() + "/index.sqlite";
    for (const auto* suffix : {"", "-wal", "-shm"})
        std::remove((path + suffix).c_str());
    writeFile(path, content);
    if (!log.empty())
        writeFile(path + "-wal", log);

    DocumentIndex index(path);
    for (const std::uint32_t identifier : {1U, 150U, documents, documents + 1})
        index.lookUp(identifier);
    index.documentsWithin("Documents/folder 3");
    index.note(documents + 1, {"Documents/new", 1, 1});
    index.noteMove("Documents/folder 3", "Documents/folder 4");
    index.noteRemoval(1);
    index.lookUp(1, host::drive::IndexDatabase::Use::Writing);
    index.complete({{7, {"Documents/last", 1, 7}}});
}
