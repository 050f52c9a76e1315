#include "qm_rps/pushoverhingedatatype.h"

#include "qm_base/textformat.h"
#include "qm_rps/hinge/curvefindings.h"
#include "qm_rps/hinge/hingemirror.h"
#include "qm_rps/hinge/hingetable.h"
#include "qm_rps/po_hingeskcvtabfemadlg.h"
#include "qm_rps/po_hingetypelistdlg.h"

#include <algorithm>
#include <cmath>

namespace {

constexpr T_SKEL_POINT T_SKEL_SIDE::*kPoints[] = {&T_SKEL_SIDE::B, &T_SKEL_SIDE::C, &T_SKEL_SIDE::D,
                                                  &T_SKEL_SIDE::E};
constexpr double T_SKEL_SIDE::*kValues[] = {&T_SKEL_SIDE::IO, &T_SKEL_SIDE::LS, &T_SKEL_SIDE::CP};
constexpr std::size_t kOrigin = 4; // the row of A

/// Below this a yield deformation counts as none, as the conversion has it.
constexpr double kNoYield = 1e-7;
bool KnowsYield(const T_SKEL_SIDE& side)
{
    return std::fabs(side.yieldDeform) >= kNoYield;
}

} // namespace

int CPushOverHingeDataType::Data2Dlg(int key, HINGE_COMPONENT component)
{
    T_PHGT_D type;
    const bool exists = m_doc.Attr().GetPhgt(key, type) != 0;
    if (const auto fault = CPO_HingeTypeListDlg::ChoiceFault(key, exists)) {
        ShowMessage(fault->key, fault->text);
        return 0;
    }
    const T_HINGE_COMPONENT& c = At(type, component);
    if (!std::holds_alternative<T_SKEL_FEMA>(c.curves.I)) return 0;
    m_key = key;
    m_component = component;
    m_type = m_given = type;
    m_taken = true;
    return 1;
}

int CPushOverHingeDataType::ChooseFirst()
{
    const T_TABLE<T_PHGT_D>& types = m_doc.Data().Model().hingeTypes;
    for (const auto& [key, type] : types)
        for (std::size_t c = 0; c < type.components.size(); ++c)
            if (type.components[c].active && type.components[c].type == SKEL_TYPE::Fema)
                return Data2Dlg(key, static_cast<HINGE_COMPONENT>(c));
    if (types.empty()) return Data2Dlg(0, m_component);
    m_key = types.begin()->first;
    return 1;
}

void CPushOverHingeDataType::OnSelChange(int key, HINGE_COMPONENT component)
{
    const bool edited = m_taken && m_type != m_given;
    if (edited && !AskYesNo("IDS_QM_UI_HINGE_LOSE_EDITS")) return;
    if (Data2Dlg(key, component)) return;
    m_key = key;
    m_component = component;
    m_taken = false;
}

bool CPushOverHingeDataType::IsSymmetric() const
{
    const T_SKEL_FEMA* curve = Shown();
    return curve && curve->symmetric;
}

const T_SKEL_FEMA* CPushOverHingeDataType::Shown() const
{
    if (!m_taken) return nullptr;
    return std::get_if<T_SKEL_FEMA>(&At(m_type, m_component).curves.I);
}

void CPushOverHingeDataType::OnEdited()
{
    if (!m_taken) return;
    T_HINGE_COMPONENT& c = At(m_type, m_component);
    c = MirroredComponent(c);
}

std::string CPushOverHingeDataType::PointField(std::size_t row)
{
    if (row == kOrigin || row >= kRows.size()) return {};
    const std::string side = row > kOrigin ? "sides.pos." : "sides.neg.";
    return side + kRows[std::max(row, 2 * kOrigin - row)] + ".";
}

T_SKEL_FEMA* CPushOverHingeDataType::Curve()
{
    if (!m_taken) return nullptr;
    return std::get_if<T_SKEL_FEMA>(&At(m_type, m_component).curves.I);
}

int CPushOverHingeDataType::OnMeasureRdo(SKEL_MEASURE measure)
{
    T_SKEL_FEMA* curve = Curve();
    if (!curve) return 0;
    if (curve->measure == measure) return 1;
    if (!KnowsYield(curve->sides.pos) || !KnowsYield(curve->sides.neg)) {
        ShowMessage("IDS_QM_UI_HINGE_NO_DY");
        return 0;
    }
    return measure == SKEL_MEASURE::Plastic
               ? CPO_HingeSkcvTabFemaDlg::ConvertHingeParamPR2DDy(*curve)
               : CPO_HingeSkcvTabFemaDlg::ConvertHingeParamDDy2PR(*curve);
}

std::string CPushOverHingeDataType::OtherMeasureText(std::size_t row) const
{
    const T_SKEL_FEMA* curve = Shown();
    if (!curve || row == kOrigin || row >= kRows.size()) return {};
    const bool positive = row > kOrigin;
    const T_SKEL_SIDE& side = positive ? curve->sides.pos : curve->sides.neg;
    if (!KnowsYield(side)) return "-";
    const double value = (side.*kPoints[positive ? row - kOrigin - 1 : kOrigin - 1 - row]).deform;
    const double sign = positive ? 1.0 : -1.0; // magnitudes are converted
    const auto convert = curve->measure == SKEL_MEASURE::DDy
                             ? CPO_HingeSkcvTabFemaDlg::ConvertParamPR2DDy
                             : CPO_HingeSkcvTabFemaDlg::ConvertParamDDy2PR;
    return FormatText("%.6g", sign * convert(sign * value, std::fabs(side.yieldDeform)) + 0.0);
}

T_SKEL_POINT* CPushOverHingeDataType::Point(std::size_t row)
{
    T_SKEL_FEMA* curve = Curve();
    if (!curve || row == kOrigin || row >= kRows.size()) return nullptr;
    T_SKEL_SIDE& side = row > kOrigin ? curve->sides.pos : curve->sides.neg;
    return &(side.*kPoints[row > kOrigin ? row - kOrigin - 1 : kOrigin - 1 - row]);
}

double* CPushOverHingeDataType::Criterion(std::size_t index, bool positive)
{
    T_SKEL_FEMA* curve = Curve();
    if (!curve || index >= kCriteria.size()) return nullptr;
    T_SKEL_SIDE& side = positive ? curve->sides.pos : curve->sides.neg;
    return &(side.*kValues[index]);
}

std::vector<T_FINDING> CPushOverHingeDataType::Findings() const
{
    const T_SKEL_FEMA* curve = Shown();
    return curve ? DiagramFindings(*curve, m_component) : std::vector<T_FINDING>();
}

int CPushOverHingeDataType::OnOK()
{
    if (!m_taken) ShowMessage("IDS_QM_UI_HINGE_NO_FEMA");
    if (!m_taken || !CheckData()) return 0;
    const bool exists = m_doc.Data().Model().hingeTypes.contains(m_key);
    if (const auto fault = CPO_HingeTypeListDlg::ChoiceFault(m_key, exists)) {
        ShowMessage(fault->key, fault->text);
        return 0;
    }
    T_HINGE_COMPONENT& c = At(m_type, m_component);
    c = MirroredComponent(c);
    return StoreHingeType(m_doc, m_key, m_type);
}
