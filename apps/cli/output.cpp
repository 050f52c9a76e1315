#include "output.h"

#include "console/console.h"
#include "inputfile.h"
#include "qm_base/say.h"
#include "qm_base/visibletext.h"

#ifdef QM_UI
#include "qm_ui/plot/plotfile.h"
#endif

#include <cstdio>

EXIT_CODE Complain(EXIT_CODE code, const std::string& text)
{
    std::fprintf(stderr, "qm-rps: %s\n", VisibleLine(text).c_str());
    return code;
}

void ShowOnTerminal(const std::string& text, bool last)
{
    std::fprintf(stderr, "\rqm-rps: %s%s", VisibleLine(text).c_str(), last ? "\n" : "");
    std::fflush(stderr);
}

EXIT_CODE CheckPlotName(const std::string& path)
{
    if (path.empty()) return EXIT_CODE::Done;
#ifdef QM_UI
    for (const char* extension : {".svg", ".pdf", ".png", ".jpg", ".jpeg", ".bmp"}) {
        if (path.ends_with(extension)) return EXIT_CODE::Done;
    }
    return Complain(EXIT_CODE::Usage, path + ": " + Say("IDS_QM_CLI_PICTURE_NAME"));
#else
    return Complain(EXIT_CODE::Usage, path + ": " + Say("IDS_QM_CLI_NO_PICTURES"));
#endif
}

EXIT_CODE CheckOutputs(const std::string& input, const std::vector<T_OUTPUT>& outputs,
                       bool overwrite)
{
    T_FILE_ERROR error;
    return CFileCtrl::CheckOutputs(std::span(&input, 1), outputs, overwrite, error)
               ? EXIT_CODE::Done
               : ReportFileError(error);
}

EXIT_CODE WriteOutput(const std::string& path, std::string_view text)
{
    if (path == "-") {
        return CConsole::WriteRaw(text)
                   ? EXIT_CODE::Done
                   : Complain(EXIT_CODE::NoAccess, Say("IDS_QM_CLI_NO_STDOUT"));
    }
    T_FILE_ERROR error;
    return CFileCtrl::WriteWholeFile(path, text, error) ? EXIT_CODE::Done : ReportFileError(error);
}

std::string NumberedPath(const std::string& path, std::size_t index, std::size_t count)
{
    if (count == 1) return path;
    const std::string stem = CFileCtrl::GetFilePathAndNameWithoutExtension(path);
    return stem + "-" + std::to_string(index + 1) + path.substr(stem.size());
}

#ifdef QM_UI
EXIT_CODE WritePicture(const T_PLOT& plot, const std::string& path)
{
    std::string error;
    if (path.empty() || WritePlotFile(plot, path, error)) return EXIT_CODE::Done;
    return Complain(EXIT_CODE::NoAccess, error);
}
#endif

EXIT_CODE SaveDocument(CDBDoc& doc, const std::string& path)
{
    if (const std::string fault = doc.Data().Fault(); !fault.empty())
        return Complain(EXIT_CODE::Usage, fault);
    T_FILE_ERROR error;
    const int done =
        CFileCtrl::IsModelName(path) ? doc.SaveModelAs(path, error) : doc.ExportCase(path, error);
    return done ? EXIT_CODE::Done : ReportFileError(error);
}
