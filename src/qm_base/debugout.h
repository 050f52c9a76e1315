// Formatted debug trace; silent unless a sink is installed or QM_DEBUG=1 is set (then stderr).
#pragma once

#include <functional>
#include <string_view>

/// printf-style line (no line end needed) to the installed sink.
[[gnu::format(printf, 1, 2)]] void GDebugOut(const char* fmt, ...);

/// Installs a sink for the debug trace; an empty function restores the default.
void SetDebugSink(std::function<void(std::string_view)> sink);
