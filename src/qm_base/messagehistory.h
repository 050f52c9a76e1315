// Message history: the lines that tool windows leave for the user, oldest first.
#pragma once

#include <functional>
#include <string>
#include <string_view>
#include <vector>

/// Appends a printf-style line (no line end needed) to the message history, which keeps the
/// latest 1,000 lines of this process, and hands it to the sink, if one is installed.
[[gnu::format(printf, 1, 2)]] void GSaveHistoryFormatNF(const char* fmt, ...);

/// The lines written since the last call, oldest first; the history is emptied.
std::vector<std::string> TakeMessageHistory();

/// Shows each line as it is written; an empty function removes the sink.
void SetMessageHistorySink(std::function<void(std::string_view)> sink);
