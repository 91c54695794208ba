// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <string>
#include <string_view>

namespace host::system {

/// Searches the bytes of a JPEG file, as they arrive, for the marker that ends the picture. A file without it
/// is truncated, although the decoder fills the missing part and reports no error.
class JpegEnd {
public:
    void feed(std::string_view piece);
    /// Answers whether this is a JPEG file whose end has not arrived.
    bool isMissing() const { return _place != Place::Elsewhere && _place != Place::Ended; }

private:
    enum class Place { Start, Segments, Picture, Ended, Elsewhere };

    void skipSegments();
    void lookForEnd();

    Place _place = Place::Start;
    std::string _bytes; ///< the bytes that were not searched yet
};

} // namespace host::system
