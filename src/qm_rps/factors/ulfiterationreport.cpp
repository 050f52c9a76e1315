#include "qm_rps/factors/ulfiterationreport.h"

#include "qm_base/textformat.h"
#include "qm_db/filectrl.h"

#include <cmath>

namespace {

constexpr const char* kTitle = "QM RPS - Unknown Load Factor";
constexpr const char* kCompany = "QM RPS";
constexpr const char* kFrame =
    "         +============================================================+\n";
constexpr const char* kRule =
    "     ======================================================================\n";
constexpr const char* kHeads =
    "        NO                    Stage/Step              FACTOR   PRETENSION\n";
constexpr const char* kBanner[] = {
    "      ###   #   #      ####   ####    ####", "     #   #  ## ##      #   #  #   #  #    ",
    "     #   #  # # #      ####   ####    ### ", "     #  ##  #   #      #  #   #          #",
    "      ## #  #   #      #   #  #      #### ",
};
constexpr int kPlaceWidth = 30;

std::string Framed(const std::string& text)
{
    return FormatText("         |  %s  |\n", text.c_str());
}

bool StartsCharacter(char byte)
{
    return (static_cast<unsigned char>(byte) & 0xC0U) != 0x80U; // not a byte inside UTF-8
}

/// The first 30 characters, right-aligned: characters are counted, not bytes.
std::string PlaceText(const std::string& place)
{
    int count = 0;
    std::size_t end = 0;
    for (; end < place.size(); ++end)
        if (StartsCharacter(place[end]) && ++count > kPlaceWidth) {
            --count;
            break;
        }
    return std::string(static_cast<std::size_t>(kPlaceWidth - count), ' ') + place.substr(0, end);
}

std::string RowLine(std::size_t number, const T_ULF_ITER_ROW& row)
{
    return FormatText("     %5d%s%20.5f%13s\n", static_cast<int>(number),
                      PlaceText(row.place).c_str(), row.factor, row.pretension ? "YES" : "NO");
}

} // namespace

double UlfIterTolerance(const std::vector<T_ULF_ITER_ROW>& rows)
{
    double sum = 0.0;
    for (const T_ULF_ITER_ROW& row : rows)
        if (row.pretension) sum += (1.0 - row.factor) * (1.0 - row.factor);
    return std::sqrt(sum);
}

std::vector<double> UlfIterApplied(const std::vector<T_ULF_ITER_STEP>& history)
{
    if (history.empty()) return {};
    std::vector<double> applied(history.back().rows.size(), 1.0);
    for (std::size_t step = 0; step + 1 < history.size(); ++step)
        for (std::size_t row = 0; row < applied.size() && row < history[step].rows.size(); ++row)
            if (history[step].rows[row].pretension) applied[row] *= history[step].rows[row].factor;
    return applied;
}

std::string UlfIterHead(int required, double tolerance)
{
    std::string text = kFrame;
    for (const char* line : kBanner)
        text += Framed(FormatText("%-56s", line));
    text += kFrame + Framed(FormatText("%-40s%16s", kTitle, "Version " QM_RPS_VERSION)) +
            Framed(FormatText("%56s", kCompany)) + kFrame;
    return text + "\n\n" + kRule +
           FormatText("     Required Number of Iterations = %d\n", required) +
           FormatText("     Convergence Tolerance         = %f\n", tolerance) + kRule + "\n\n";
}

std::string UlfIterBlock(const T_ULF_ITER_STEP& step)
{
    std::string text = FormatText("     Iteration = %d\n", step.iteration) +
                       FormatText("     File Name = %s\n", step.file.c_str()) + kRule + kHeads +
                       kRule;
    for (std::size_t i = 0; i < step.rows.size(); ++i)
        text += RowLine(i + 1, step.rows[i]);
    return text + kRule + FormatText("     Current Tolerance = %f\n", step.tolerance) + kRule +
           "\n\n";
}

std::string UlfIterReportPath(const std::string& model)
{
    return FormatText("%s.%s", CFileCtrl::GetFilePathAndNameWithoutExtension(model).c_str(), "ulf");
}

std::string UlfIterCopyPath(const std::string& model, int iteration)
{
    const std::string base = CFileCtrl::GetFilePathAndNameWithoutExtension(model);
    const std::string extension = model.size() > base.size() ? model.substr(base.size() + 1) : "";
    return FormatText("%s_%02d.%s", base.c_str(), iteration, extension.c_str());
}
