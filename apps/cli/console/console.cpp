#include "console.h"

#include "qm_base/visibletext.h"

#include <array>
#include <atomic>
#include <cerrno>
#include <csignal>
#include <cstdio>
#include <unistd.h>
#include <utility>

namespace {

std::FILE* g_shown = nullptr; // the stream behind stdout while a console lives
std::FILE* g_before = nullptr;
std::atomic<bool> g_failed{false}; // a write has
std::atomic<bool> g_asked{false};  // by a signal

bool WriteAll(std::string_view bytes)
{
    while (!bytes.empty() && !g_failed) {
        const ssize_t count = write(STDOUT_FILENO, bytes.data(), bytes.size());
        if (count < 0 && errno == EINTR) continue;
        if (count <= 0) g_failed = true;
        if (count > 0) bytes.remove_prefix(static_cast<std::size_t>(count));
    }
    return !g_failed;
}

/// What a stream of stdio writes with. Never fails in its eyes: Flush tells.
ssize_t WriteShown(void*, const char* bytes, std::size_t count)
{
    static CVisibleText visible; // one standard output
    (void)WriteAll(visible.Next({bytes, count}));
    return static_cast<ssize_t>(count);
}

constexpr std::array<int, 3> kSignals{SIGINT, SIGTERM, SIGHUP};
std::array<struct sigaction, kSignals.size()> g_actions;

} // namespace

CConsole::CConsole()
{
    const cookie_io_functions_t functions{nullptr, WriteShown, nullptr, nullptr};
    g_failed = false;
    g_shown = fopencookie(nullptr, "w", functions);
    if (!g_shown) return; // no memory: the next allocation says so
    if (isatty(STDOUT_FILENO)) std::setvbuf(g_shown, nullptr, _IOLBF, BUFSIZ);
    g_before = std::exchange(stdout, g_shown);
}

CConsole::~CConsole()
{
    if (!g_shown) return;
    stdout = std::exchange(g_before, nullptr);
    std::fclose(std::exchange(g_shown, nullptr));
}

bool CConsole::Flush()
{
    return std::fflush(stdout) == 0 && !std::ferror(stdout) && !g_failed;
}

bool CConsole::WriteRaw(std::string_view bytes)
{
    return Flush() && WriteAll(bytes);
}

CInterrupt::CInterrupt()
{
    g_asked = false;
    struct sigaction action {};
    action.sa_handler = [](int) { g_asked = true; };
    action.sa_flags = SA_RESTART;
    for (std::size_t i = 0; i < kSignals.size(); ++i) {
        sigaction(kSignals[i], nullptr, &g_actions[i]);
        // A program that was started to outlive its terminal (nohup) goes on doing so.
        if (kSignals[i] == SIGHUP && g_actions[i].sa_handler == SIG_IGN) continue;
        sigaction(kSignals[i], &action, nullptr);
    }
}

CInterrupt::~CInterrupt()
{
    for (std::size_t i = 0; i < kSignals.size(); ++i)
        sigaction(kSignals[i], &g_actions[i], nullptr);
}

bool CInterrupt::IsAsked()
{
    return g_asked;
}
