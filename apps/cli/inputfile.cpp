#include "inputfile.h"

#include "qm_base/visibletext.h"

#include <cstdio>

bool IsModelFile(const std::string& path)
{
    return CModelStore::IsModelFile(path);
}

EXIT_CODE ReportFileError(const T_FILE_ERROR& error)
{
    std::fprintf(stderr, "qm-rps: %s\n", VisibleLine(error.text).c_str());
    switch (error.fault) {
    case FILE_FAULT::NoAccess:
    case FILE_FAULT::Changed:
        return EXIT_CODE::NoAccess;
    case FILE_FAULT::Misuse:
        return EXIT_CODE::Usage;
    case FILE_FAULT::BadInput:
    case FILE_FAULT::None:
        break;
    }
    return EXIT_CODE::BadInput;
}

EXIT_CODE OpenInput(CDBDoc& doc, const std::string& path)
{
    T_FILE_ERROR error;
    const int opened = IsModelFile(path) ? doc.OpenModel(path, OPEN_MODE::ReadOnly, error)
                                         : doc.ImportCase(path, error);
    return opened ? EXIT_CODE::Done : ReportFileError(error);
}
