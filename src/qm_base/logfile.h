// Append-only text log: every Write opens the file, appends and closes it again.
#pragma once

#include <string>
#include <string_view>

class CLogFile {
public:
    explicit CLogFile(std::string path);

    /// Appends the text as it is (no line end added). 1 done; 0 the file can't be written.
    [[nodiscard]] int Write(std::string_view text) const;

private:
    std::string m_path;
};
