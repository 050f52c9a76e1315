#include "qm_rps/hingeoptionsdlg.h"

#include "qm_db/editscope.h"
#include "qm_rps/hinge/hingechoices.h"

#include <algorithm>

namespace {

std::vector<std::string> WithInUse(std::vector<std::string> codes, const std::string& inUse)
{
    if (std::ranges::find(codes, inUse) == codes.end()) codes.push_back(inUse);
    return codes;
}

/// A pair of default ratios as it is checked.
struct T_RATIO_CHECK {
    double value;
    HINGE_SIDE side;
};
using R = T_RATIO_CHECK;
bool NotNegative(const R& r)
{
    return NotAbove(0, r.value);
}
constexpr const char* kRatio = "IDS_QM_HINGE_DEFAULT_RATIO";
constexpr T_HINGE_RULE<R> kAlpha1[] = {
    {{.message = kRatio,
      .key = {"IDS_DB_1ST_STIF_REDU_RATIO_POS", "IDS_DB_1ST_STIF_REDU_RATIO_NEG"},
      .field = "alpha1.pos"},
     NotNegative}};
constexpr T_HINGE_RULE<R> kAlpha2[] = {
    {{.message = kRatio,
      .key = {"IDS_DB_2ND_STIF_REDU_RATIO_POS", "IDS_DB_2ND_STIF_REDU_RATIO_NEG"},
      .field = "alpha2.pos"},
     NotNegative}};

std::array<R, 2> SidesOf(const std::array<double, 2>& ratios)
{
    return {{{ratios[0], HINGE_SIDE::Positive}, {ratios[1], HINGE_SIDE::Negative}}};
}

std::optional<std::string> CodeOrNone(const std::string& name)
{
    return name.empty() ? std::nullopt : std::optional(name);
}

} // namespace

CHingeOptionsDlg::CHingeOptionsDlg(CDBDoc& doc) : m_doc(doc)
{
    const T_STYP_D& styp = doc.Data().Model().styp;
    m_alternativeHysteresis = styp.alternativeHysteresis;
    m_wallStrengthDegradation = styp.wallStrengthDegradation;
    m_gsd = styp.gsd;
    m_concreteCode = styp.designCodes.concrete.value_or("");
    m_steelCode = styp.designCodes.steel.value_or("");
    m_alpha1 = styp.defaultAlpha1;
    m_alpha2 = styp.defaultAlpha2;
}

std::vector<std::string> CHingeOptionsDlg::ConcreteCodes(const std::string& inUse)
{
    return WithInUse({"", "Eurocode2", "Eurocode2:04", "AIJ-WSD99"}, inUse);
}

std::vector<std::string> CHingeOptionsDlg::SteelCodes(const std::string& inUse)
{
    return WithInUse({"", "Eurocode3", "Eurocode3:05", "AIJ-ASD02"}, inUse);
}

std::string CHingeOptionsDlg::ModeText() const
{
    return YieldCodeText(m_concreteCode, m_steelCode);
}

std::vector<T_FINDING> CHingeOptionsDlg::Findings() const
{
    std::vector<T_FINDING> out;
    WalkRulesBySide(kAlpha1, SidesOf(m_alpha1), {}, out);
    WalkRulesBySide(kAlpha2, SidesOf(m_alpha2), {}, out);
    return out;
}

int CHingeOptionsDlg::OnOK()
{
    if (!CheckData()) return 0;
    T_STYP_D styp;
    if (!m_doc.Attr().GetStyp(styp)) return 0;
    styp.alternativeHysteresis = m_alternativeHysteresis;
    styp.wallStrengthDegradation = m_wallStrengthDegradation;
    styp.gsd = m_gsd;
    styp.designCodes = {CodeOrNone(m_concreteCode), CodeOrNone(m_steelCode)};
    styp.defaultAlpha1 = m_alpha1;
    styp.defaultAlpha2 = m_alpha2;
    CEditScope edit(m_doc, "hinge options");
    if (edit.PutStyp(styp) && edit.Commit()) return 1;
    ShowMessage("IDS_QM_HINGE_NOT_STORED");
    return 0;
}
