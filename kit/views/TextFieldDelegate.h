// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <cstddef>
#include <string>

namespace kit {

class TextField;

/// A range of a text in characters (Unicode code points).
struct TextRange {
    std::size_t location = 0;
    std::size_t length = 0;
    bool operator==(const TextRange&) const = default;
};

/// Is asked and told about the editing of a text field. Main thread only.
class TextFieldDelegate {
public:
    virtual ~TextFieldDelegate() = default;

    virtual bool textFieldShouldBeginEditing(TextField&) { return true; }
    virtual void textFieldDidBeginEditing(TextField&) { }
    /// Answering false keeps the field in editing, whoever asked for the end.
    virtual bool textFieldShouldEndEditing(TextField&) { return true; }
    virtual void textFieldDidEndEditing(TextField&) { }
    /// The return key was pressed. The answer says whether the platform's default behaviour may follow; the
    /// kit has none.
    virtual bool textFieldShouldReturn(TextField&) { return true; }
    /// Asked once for every edit by the user, before the field's text changes. The range is in the old text.
    virtual bool textFieldShouldChangeCharactersInRangeReplacementString(
        TextField&, const TextRange& /*range*/, const std::string& /*replacement*/)
    {
        return true;
    }
};

} // namespace kit
