#include "qm_base/logfile.h"

#include <fstream>
#include <utility>

CLogFile::CLogFile(std::string path) : m_path(std::move(path)) {}

int CLogFile::Write(std::string_view text) const
{
    std::ofstream file(m_path, std::ios::app | std::ios::binary);
    file.write(text.data(), static_cast<std::streamsize>(text.size()));
    file.close();        // a full disk shows here at the latest
    return file ? 1 : 0; // not opened counts as failed too
}
