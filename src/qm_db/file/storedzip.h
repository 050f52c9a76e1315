// A zip archive in memory, of files that are stored as they are.
#pragma once

#include <cstdint>
#include <string>
#include <string_view>

/// Format: APPNOTE.TXT 6.3, without compression, encryption and 64-bit sizes. Dates are 1980-01-01,
/// so the same files give the same bytes.
class CStoredZip {
public:
    /// False where the archive would be larger than 4 GiB.
    [[nodiscard]] bool Add(std::string_view name, std::string_view bytes);
    /// The whole archive; nothing may be added any more.
    std::string Take();

private:
    std::string m_bytes;     // local headers and files
    std::string m_directory; // central directory
    std::uint16_t m_count = 0;
};
