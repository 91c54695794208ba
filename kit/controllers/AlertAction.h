// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <functional>
#include <memory>
#include <string>

namespace kit {

enum class AlertActionStyle { Default, Cancel, Destructive };

/// A button of an alert.
class AlertAction : public std::enable_shared_from_this<AlertAction> {
public:
    using Handler = std::function<void(const std::shared_ptr<AlertAction>& action)>;

    /// The handler is called once, after the alert has closed.
    AlertAction(std::string title, AlertActionStyle style, Handler handler = {});

    const std::string& title() const { return _title; }
    AlertActionStyle style() const { return _style; }
    bool isEnabled() const { return _enabled; }
    void setEnabled(bool enabled);

    /// The function is asked at every press, before the alert closes. When it answers false, the alert stays
    /// open and the handler is not called.
    void setShouldClose(std::function<bool()> shouldClose) { _shouldClose = std::move(shouldClose); }

    // The alert that holds the action calls these.
    bool mayClose() const { return !_shouldClose || _shouldClose(); }
    void run();
    void setOnChange(std::function<void()> onChange) { _onChange = std::move(onChange); }

private:
    std::string _title;
    AlertActionStyle _style;
    Handler _handler;
    std::function<bool()> _shouldClose;
    std::function<void()> _onChange;
    bool _enabled = true;
};

} // namespace kit
