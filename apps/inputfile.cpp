#include "inputfile.h"

#include <array>
#include <cstdio>
#include <fstream>
#include <string_view>

bool IsModelFile(const std::string& path)
{
    if (path.ends_with(".qmdb")) return true;
    constexpr std::string_view kMagic = "SQLite format 3";
    std::array<char, kMagic.size()> head{};
    std::ifstream file(path, std::ios::binary);
    file.read(head.data(), head.size());
    return file && std::string_view(head.data(), head.size()) == kMagic;
}

EXIT_CODE ReportFileError(const T_FILE_ERROR& error)
{
    std::fprintf(stderr, "qm-rps: %s\n", error.text.c_str());
    return error.fault == FILE_FAULT::NoAccess ? EXIT_CODE::NoAccess : EXIT_CODE::BadInput;
}

EXIT_CODE OpenInput(CDBDoc& doc, const std::string& path)
{
    T_FILE_ERROR error;
    const int opened = IsModelFile(path) ? doc.OpenModel(path, OPEN_MODE::ReadOnly, error)
                                         : doc.ImportCase(path, error);
    return opened ? EXIT_CODE::Done : ReportFileError(error);
}
