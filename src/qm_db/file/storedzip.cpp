#include "qm_db/file/storedzip.h"

#include <array>
#include <limits>

namespace {

constexpr std::uint32_t kLocal = 0x04034b50, kCentral = 0x02014b50, kEnd = 0x06054b50;
constexpr std::uint16_t kVersion = 20, kUtf8Names = 0x0800, kFirstDay = 0x0021; // 1980-01-01

void Put16(std::string& out, std::uint16_t value)
{
    out += static_cast<char>(value & 0xFFU);
    out += static_cast<char>(value >> 8U);
}

void Put32(std::string& out, std::uint32_t value)
{
    Put16(out, static_cast<std::uint16_t>(value & 0xFFFFU));
    Put16(out, static_cast<std::uint16_t>(value >> 16U));
}

constexpr std::array<std::uint32_t, 256> CrcTable()
{
    constexpr std::uint32_t kPolynomial = 0xEDB88320; // IEEE 802.3, reflected
    std::array<std::uint32_t, 256> table{};
    for (std::uint32_t i = 0; i < table.size(); ++i) {
        table[i] = i;
        for (int bit = 0; bit < 8; ++bit)
            table[i] = (table[i] >> 1U) ^ ((table[i] & 1U) ? kPolynomial : 0U);
    }
    return table;
}

std::uint32_t Crc32(std::string_view bytes)
{
    static constexpr std::array<std::uint32_t, 256> kTable = CrcTable();
    std::uint32_t crc = 0xFFFFFFFF;
    for (const char c : bytes)
        crc = (crc >> 8U) ^ kTable[(crc ^ static_cast<unsigned char>(c)) & 0xFFU];
    return ~crc;
}

/// What local header and central directory say alike of a file.
std::string Facts(std::string_view name, std::string_view bytes)
{
    std::string facts;
    for (const std::uint16_t value : {kVersion, kUtf8Names, std::uint16_t{0} /* stored */,
                                      std::uint16_t{0} /* time */, kFirstDay})
        Put16(facts, value);
    Put32(facts, Crc32(bytes));
    const auto size = static_cast<std::uint32_t>(bytes.size());
    Put32(facts, size); // compressed
    Put32(facts, size);
    Put16(facts, static_cast<std::uint16_t>(name.size()));
    Put16(facts, 0); // extra field
    return facts;
}

} // namespace

bool CStoredZip::Add(std::string_view name, std::string_view bytes)
{
    constexpr std::size_t kMost = std::numeric_limits<std::uint32_t>::max();
    constexpr std::size_t kHeads = 1000; // more than headers and end take
    if (bytes.size() > kMost - kHeads ||
        m_bytes.size() + m_directory.size() > kMost - kHeads - bytes.size())
        return false;
    const std::string facts = Facts(name, bytes);
    const auto offset = static_cast<std::uint32_t>(m_bytes.size());
    Put32(m_bytes, kLocal);
    m_bytes.append(facts).append(name).append(bytes);
    Put32(m_directory, kCentral);
    Put16(m_directory, kVersion);
    m_directory += facts;
    for (int i = 0; i < 3; ++i)
        Put16(m_directory, 0); // comment, disk, internal attributes
    Put32(m_directory, 0);     // external attributes
    Put32(m_directory, offset);
    m_directory += name;
    ++m_count;
    return true;
}

std::string CStoredZip::Take()
{
    const auto offset = static_cast<std::uint32_t>(m_bytes.size());
    m_bytes += m_directory;
    Put32(m_bytes, kEnd);
    Put16(m_bytes, 0); // this disk, and the one of the directory
    Put16(m_bytes, 0);
    Put16(m_bytes, m_count);
    Put16(m_bytes, m_count);
    Put32(m_bytes, static_cast<std::uint32_t>(m_directory.size()));
    Put32(m_bytes, offset);
    Put16(m_bytes, 0); // comment
    return std::move(m_bytes);
}
