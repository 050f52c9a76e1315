#include "qm_rps/factors/optdump.h"

#include "qm_base/logfile.h"
#include "qm_base/textformat.h"
#include "qm_db/filectrl.h"

#include <filesystem>

namespace {

constexpr const char* kRule =
    "      ============================================================\n";
constexpr const char* kIndent = "                      ";

std::string Listed(const char* name, const std::vector<double>& values)
{
    std::string text;
    for (std::size_t i = 0; i < values.size(); ++i)
        text += FormatText("      %s(%d) = %f\n", name, static_cast<int>(i) + 1, values[i]);
    return text;
}

} // namespace

std::string OptDumpText(const T_OPT_SYSTEM& s, bool exact, int iobj, int isign)
{
    std::string text = kRule;
    text += std::string(kIndent) + "UNKNOWN LOAD FACTOR : " + (exact ? "SOLVE" : "OPTIMIZED") +
            "\n" + kIndent + "QM RPS\n" + kRule;
    text +=
        FormatText("      NVAR  = %d\n      NCON  = %d\n      NEQ   = %d\n", s.nvar, s.ncon, s.neq);
    text += FormatText("      IOBJ  = %d\n      ISIGN = %d\n\n\n", iobj, isign);
    text += Listed("RHS8", s.rhs) + "\n\n";
    text += Listed("WGTFAC", s.weights) + "\n\n";
    return text + Listed("COEFVEC", s.matrix);
}

std::string OptDumpPath(const std::string& modelPath, bool exact)
{
    return FormatText("%s_%s.%s", CFileCtrl::GetFilePathAndNameWithoutExtension(modelPath).c_str(),
                      exact ? "[EXACT]" : "[OPTIMIZE]", "out");
}

void WriteOptDump(const T_OPT_DUMP& dump, const T_OPT_ANSWER& answer, int iobj, int isign)
{
    const std::string path = OptDumpPath(dump.modelPath, answer.exact);
    const std::string text = OptDumpText(answer.system, answer.exact, iobj, isign);
    std::error_code ignored;
    const bool add =
        std::filesystem::exists(path, ignored) && !(dump.overwrite && dump.overwrite());
    T_FILE_ERROR error;
    if (add ? CLogFile(path).Write(text) : CFileCtrl::WriteWholeFile(path, text, error)) return;
}
