#include "qm_rps/create/spectrumedit.h"

#include "qm_base/say.h"
#include "qm_base/textformat.h"
#include "qm_db/recordfacts.h"
#include "qm_rps/create/spectrumtext.h"

namespace {

constexpr double kFivePercent = 5.0;

} // namespace

/// Sound values of every kind, so that a preview stands from the start.
CSpectrumEdit::CSpectrumEdit() : m_name(SpectrumNameOf(Ec8))
{
    constexpr T_SPFC_NTC_STATE kFirst{0.25, 2.4, 0.35};
    m_atc40.Ca = 0.4;
    m_atc40.Cv = 0.4;
    m_ec8.ag = m_ec8Old.ag = 0.25;
    m_ec8.soil = m_ec8Old.soil = m_ntc.soil = 'B';
    m_ntc.states[static_cast<std::size_t>(LIMIT_STATE::SLV)] = kFirst;
    m_states.fill(kFirst);
    m_user.T = {0.0, 0.15, 0.5, 2.0};
    m_user.Sa = {0.25, 0.625, 0.625, 0.15625};
}

std::vector<std::string> CSpectrumEdit::KindTexts()
{
    return {"ATC-40 / ASCE 41", "EN 1998-1:2004", "ENV 1998-1:1994", "NTC 2008 / 2018",
            Say("IDS_QM_UI_SPECTRUM_USER")};
}

void CSpectrumEdit::OnKind(int kind)
{
    if (kind < Atc40 || kind > User) return;
    if (m_name == SpectrumNameOf(static_cast<std::size_t>(m_kind)))
        m_name = SpectrumNameOf(static_cast<std::size_t>(kind));
    m_kind = kind;
}

T_SPFC_D CSpectrumEdit::Record() const
{
    T_SPFC_D record;
    record.name = m_name;
    switch (m_kind) {
    case Atc40:
        record.data = m_atc40;
        break;
    case Ec8:
        record.data = m_ec8;
        break;
    case Ec8Old:
        record.data = m_ec8Old;
        break;
    case Ntc:
        record.data = m_ntc;
        break;
    default:
        record.data = m_user;
    }
    return record;
}

void CSpectrumEdit::Take(const T_SPFC_D& record)
{
    m_name = record.name;
    m_kind = static_cast<int>(record.data.index());
    const auto into = std::tie(m_atc40, m_ec8, m_ec8Old, m_ntc, m_user);
    std::visit(
        [&into](const auto& data) { std::get<std::remove_cvref_t<decltype(data)>&>(into) = data; },
        record.data);
}

char& CSpectrumEdit::SoilOf()
{
    return m_kind == Ntc ? m_ntc.soil : m_kind == Ec8Old ? m_ec8Old.soil : m_ec8.soil;
}

std::vector<std::string> CSpectrumEdit::SoilTexts() const
{
    constexpr std::ptrdiff_t kOld = 3; // classes of ENV 1998-1:1994
    return {kSoils.begin(), m_kind == Ec8Old ? kSoils.begin() + kOld : kSoils.end()};
}

int CSpectrumEdit::Soil() const
{
    return (m_kind == Ntc ? m_ntc.soil : m_kind == Ec8Old ? m_ec8Old.soil : m_ec8.soil) - 'A';
}

void CSpectrumEdit::OnSoil(int index)
{
    if (index >= 0 && index < std::ssize(SoilTexts())) SoilOf() = static_cast<char>('A' + index);
}

void CSpectrumEdit::OnAg(double ag)
{
    (m_kind == Ec8Old ? m_ec8Old.ag : m_ec8.ag) = ag;
}

double CSpectrumEdit::Damping() const
{
    const auto& own = m_kind == Ntc      ? m_ntc.damping
                      : m_kind == Ec8Old ? m_ec8Old.damping
                                         : m_ec8.damping;
    return own.value_or(kFivePercent);
}

void CSpectrumEdit::OnDamping(double percent)
{
    auto& own = m_kind == Ntc ? m_ntc.damping : m_kind == Ec8Old ? m_ec8Old.damping : m_ec8.damping;
    if (own || percent != kFivePercent) own = percent; // left out it is 5
}

void CSpectrumEdit::OnState(std::size_t state, bool on)
{
    auto& own = m_ntc.states.at(state);
    if (on == own.has_value()) return;
    if (own) m_states[state] = *own;
    own = on ? std::optional(m_states[state]) : std::nullopt;
}

int CSpectrumEdit::OnTable(const std::string& text)
{
    m_refusal = {};
    return UserSpectrum(text, m_user, m_refusal);
}

std::string CSpectrumEdit::Cell(std::size_t row, std::size_t column) const
{
    const std::vector<double>& values = column == 0 ? m_user.T : m_user.Sa;
    return row < values.size() ? ShortestText(values[row]) : std::string();
}

int CSpectrumEdit::SetCell(std::size_t row, std::size_t column, const std::string& text)
{
    std::vector<double>& values = column == 0 ? m_user.T : m_user.Sa;
    const std::optional<double> value = ParseFinite(text);
    if (!value || row >= values.size()) return 0;
    values[row] = *value;
    return 1;
}

void CSpectrumEdit::OnAddRow()
{
    constexpr double kStep = 0.5; // s
    m_user.T.push_back(m_user.T.empty() ? 0.0 : m_user.T.back() + kStep);
    m_user.Sa.push_back(m_user.Sa.empty() ? 0.0 : m_user.Sa.back());
}

void CSpectrumEdit::OnDeleteRow(std::size_t row)
{
    if (row >= m_user.T.size()) return;
    m_user.T.erase(m_user.T.begin() + static_cast<std::ptrdiff_t>(row));
    m_user.Sa.erase(m_user.Sa.begin() + static_cast<std::ptrdiff_t>(row));
}
