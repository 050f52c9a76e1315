// Commands of the main window: one table makes menus, tool bar and keys.
#pragma once

#include <functional>
#include <string>
#include <vector>

/// A command with its place. The same menu key groups commands into one menu.
struct T_COMMAND {
    const char* menu = ""; // key of the menu's text
    const char* key = "";  // key of the command's text, with & before its letter; "": a line
    const char* keys = ""; // shortcut, as "Ctrl+S"; empty: none
    std::function<void()> run{};
    std::function<bool()> enabled{}; // empty: always
    std::function<bool()> checked{}; // not empty: it can be checked
};
using T_COMMANDS = std::vector<T_COMMAND>;
