// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <memory>
#include <string>

namespace host::gtk {

/// A server of GTK's own that shows the program's window in a web browser, for machines without a display. It
/// listens on the loopback address only, and ends with this object and with the process.
class BroadwayServer {
public:
    /// Starts one on a free port and points the toolkit's environment to it. Null: it is not installed, or
    /// did not start within five seconds.
    static std::unique_ptr<BroadwayServer> start();
    ~BroadwayServer();
    BroadwayServer(const BroadwayServer&) = delete;
    BroadwayServer& operator=(const BroadwayServer&) = delete;

    const std::string& address() const { return _address; } ///< for a web browser

private:
    struct Process;
    BroadwayServer(std::unique_ptr<Process> process, std::string address);

    std::unique_ptr<Process> _process;
    std::string _address;
};

} // namespace host::gtk
