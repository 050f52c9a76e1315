// Standard output and signals of the program.
#pragma once

#include <string_view>

/// While it lives, everything that is printed with stdio on standard output is shown as a terminal
/// may show it (CVisibleText): names in files come from anybody.
class CConsole {
public:
    CConsole();
    CConsole(const CConsole&) = delete;
    CConsole& operator=(const CConsole&) = delete;
    ~CConsole();

    /// Everything printed so far has reached its place. False: it could not all be written.
    [[nodiscard]] static bool Flush();
    /// Bytes as they are, after what was printed: results that another program reads. False as
    /// above.
    [[nodiscard]] static bool WriteRaw(std::string_view bytes);
};

/// While it lives, Ctrl-C, SIGTERM and SIGHUP ask for the end of a long run instead of ending the
/// process.
class CInterrupt {
public:
    CInterrupt();
    CInterrupt(const CInterrupt&) = delete;
    CInterrupt& operator=(const CInterrupt&) = delete;
    ~CInterrupt();
    static bool IsAsked();
};
