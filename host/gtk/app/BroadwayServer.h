// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <memory>
#include <string>

namespace host::gtk {

/// A process of GTK's own server that shows the program's window in a web browser, for machines without a
/// display. It listens on the loopback address only, and ends with this object and with this process.
class BroadwayServer {
public:
    /// Starts a server on a free port and points the toolkit's environment variables to it. Answers null when
    /// it is not installed or did not start within five seconds.
    static std::unique_ptr<BroadwayServer> start();
    ~BroadwayServer();
    BroadwayServer(const BroadwayServer&) = delete;
    BroadwayServer& operator=(const BroadwayServer&) = delete;

    const std::string& address() const { return _address; } ///< the address to open in a web browser

private:
    struct Process;
    BroadwayServer(std::unique_ptr<Process> process, std::string address);

    std::unique_ptr<Process> _process;
    std::string _address;
};

} // namespace host::gtk
