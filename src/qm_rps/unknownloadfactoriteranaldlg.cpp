#include "qm_rps/unknownloadfactoriteranaldlg.h"

#include "qm_base/textformat.h"

#include <algorithm>
#include <cmath>

namespace {

std::optional<int> WholeNumber(const std::string& text)
{
    const std::optional<double> number = ParseFinite(text);
    constexpr double most = 1e6;
    if (!number || std::fabs(*number) > most || std::trunc(*number) != *number) return std::nullopt;
    return static_cast<int>(*number);
}

} // namespace

CUnknownLoadFactorIterAnalDlg::CUnknownLoadFactorIterAnalDlg(CUnknownLoadFactorIterAnal& settings)
    : m_required(std::to_string(settings.Settings().required)),
      m_tolerance(ShortestText(settings.Settings().tolerance)), m_settings(settings)
{
}

void CUnknownLoadFactorIterAnalDlg::OnSpin(int by)
{
    if (const std::optional<int> number = WholeNumber(m_required))
        m_required = std::to_string(std::clamp(*number + by, 0, CUnknownLoadFactorIterAnal::kMost));
}

bool CUnknownLoadFactorIterAnalDlg::Read(T_ULF_ITER_SETTINGS& out) const
{
    const std::optional<int> required = WholeNumber(m_required);
    const std::optional<double> tolerance = ParseFinite(m_tolerance);
    if (!required || !tolerance) return false;
    out = {*required, *tolerance};
    return true;
}

int CUnknownLoadFactorIterAnalDlg::CheckData()
{
    T_ULF_ITER_SETTINGS read;
    CUnknownLoadFactorIterAnal trial;
    if (Read(read) && trial.Set(read)) return 1;
    ShowMessage("IDS_QM_ULF_ITER_SETTINGS");
    return 0;
}

int CUnknownLoadFactorIterAnalDlg::OnOK()
{
    T_ULF_ITER_SETTINGS read;
    return CheckData() && Read(read) ? m_settings.Set(read) : 0;
}
