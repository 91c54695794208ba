// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/gtk/app/BroadwayServer.h"

#include "host/gtk/base/ObjectRef.h"

#include <gio/gio.h>

#include <arpa/inet.h>
#include <csignal>
#include <netinet/in.h>
#include <sys/prctl.h>
#include <sys/socket.h>
#include <unistd.h>

#include <optional>

namespace host::gtk {

namespace {

constexpr int startAttempts = 250;
constexpr gulong attemptPause = 20'000; ///< microseconds
constexpr int displays = 100;

/// A socket on the loopback address, which is closed with the object.
class LoopbackSocket {
public:
    LoopbackSocket()
        : _descriptor(::socket(AF_INET, SOCK_STREAM | SOCK_CLOEXEC, 0))
    {
        _address.sin_family = AF_INET;
        _address.sin_addr.s_addr = htonl(INADDR_LOOPBACK);
    }
    ~LoopbackSocket()
    {
        if (_descriptor >= 0)
            ::close(_descriptor);
    }
    LoopbackSocket(const LoopbackSocket&) = delete;
    LoopbackSocket& operator=(const LoopbackSocket&) = delete;

    std::optional<int> bindToFreePort()
    {
        socklen_t length = sizeof _address;
        auto* address = reinterpret_cast<sockaddr*>(&_address);
        if (::bind(_descriptor, address, length) != 0 || ::getsockname(_descriptor, address, &length) != 0)
            return std::nullopt;
        return ntohs(_address.sin_port);
    }
    bool connectsTo(int port)
    {
        _address.sin_port = htons(static_cast<std::uint16_t>(port));
        return ::connect(_descriptor, reinterpret_cast<sockaddr*>(&_address), sizeof _address) == 0;
    }

private:
    int _descriptor;
    sockaddr_in _address{};
};

std::string socketPath(int display)
{
    return std::string(g_get_user_runtime_dir()) + "/broadway" + std::to_string(display + 1) + ".socket";
}

/// Answers a display number whose socket does not exist.
std::optional<int> freeDisplay()
{
    for (int display = 0; display < displays; ++display) {
        if (::access(socketPath(display).c_str(), F_OK) != 0)
            return display;
    }
    return std::nullopt;
}

} // namespace

struct BroadwayServer::Process {
    ObjectRef<GSubprocess> child;
    std::string socket;

    Process(GSubprocess* started, std::string socketOfDisplay)
        : child(ObjectRef<GSubprocess>::adopt(started))
        , socket(std::move(socketOfDisplay))
    {
    }
    Process(const Process&) = delete;
    Process& operator=(const Process&) = delete;
    ~Process()
    {
        g_subprocess_send_signal(child.get(), SIGTERM);
        g_subprocess_wait(child.get(), nullptr, nullptr);
        ::unlink(socket.c_str());
    }
    bool isReady(int port) const
    {
        return ::access(socket.c_str(), F_OK) == 0 && LoopbackSocket().connectsTo(port);
    }
    bool hasExited() const { return g_subprocess_get_identifier(child.get()) == nullptr; }
};

std::unique_ptr<BroadwayServer> BroadwayServer::start()
{
    const auto port = LoopbackSocket().bindToFreePort();
    const auto display = freeDisplay();
    if (!port || !display)
        return nullptr;
    const std::string displayName = ":" + std::to_string(*display);
    const auto launcher =
        ObjectRef<GSubprocessLauncher>::adopt(g_subprocess_launcher_new(static_cast<GSubprocessFlags>(
            G_SUBPROCESS_FLAGS_STDOUT_SILENCE | G_SUBPROCESS_FLAGS_STDERR_SILENCE)));
    g_subprocess_launcher_set_child_setup(
        launcher.get(), [](gpointer) { ::prctl(PR_SET_PDEATHSIG, SIGTERM); }, nullptr, nullptr);
    const std::string portText = std::to_string(*port);
    auto* child = g_subprocess_launcher_spawn(launcher.get(), nullptr, "gtk4-broadwayd", "--address",
        "127.0.0.1", "--port", portText.c_str(), displayName.c_str(), nullptr);
    if (!child)
        return nullptr;
    auto process = std::make_unique<Process>(child, socketPath(*display));
    for (int attempt = 0; attempt < startAttempts && !process->hasExited(); ++attempt) {
        if (process->isReady(*port)) {
            g_setenv("GDK_BACKEND", "broadway", TRUE);
            g_setenv("BROADWAY_DISPLAY", displayName.c_str(), TRUE);
            return std::unique_ptr<BroadwayServer>(
                new BroadwayServer(std::move(process), "http://127.0.0.1:" + portText + "/"));
        }
        g_usleep(attemptPause);
    }
    return nullptr;
}

BroadwayServer::BroadwayServer(std::unique_ptr<Process> process, std::string address)
    : _process(std::move(process))
    , _address(std::move(address))
{
}

BroadwayServer::~BroadwayServer() = default;

} // namespace host::gtk
