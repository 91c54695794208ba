// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <string>
#include <string_view>

namespace host::system {

/// Looks through the bytes of a JPEG file as they come, for the mark that ends the picture. A file without it
/// breaks off, though the decoder fills up what is missing and calls it whole.
class JpegEnd {
public:
    void feed(std::string_view piece);
    /// Whether this is a JPEG file whose end has not come.
    bool isMissing() const { return _place != Place::Elsewhere && _place != Place::Ended; }

private:
    enum class Place { Start, Segments, Picture, Ended, Elsewhere };

    void skipSegments();
    void lookForEnd();

    Place _place = Place::Start;
    std::string _bytes; ///< not looked at yet
};

} // namespace host::system
