#include "qm_base/msgfunction.h"
#include "qm_rps/po_hingealphayspandlg.h"
#include "qm_rps/po_hingeintegrationpointdlg.h"
#include "qm_rps/po_hingelengthmphidlg.h"
#include "qm_rps/po_hingelengthmthetadlg.h"
#include "qm_rps/po_hingemasonrydlg.h"
#include "qm_ui/hinge/hingefieldsview.h"
#include "qm_ui/hinge/hingeviews.h"

namespace {

std::vector<TextFn> EndHeads()
{
    return {{}, KeyText("IDS_RPS_PO_LOCATION_I_end"), KeyText("IDS_RPS_PO_LOCATION_J_end")};
}

/// "My of L", "My (m)".
std::string LengthHead(const char* name, bool relative, const T_UNITS& units)
{
    return relative ? name + (" " + zql::lib::MMSGFunction::GetValue("IDS_QM_UI_HINGE_OF_L"))
                    : HeadWithUnit(name, kDimLength, units);
}

/// Lengths of an axis at both ends, in units of length or as fractions.
void AddLengthRow(CFormView& form, CPO_HingeLengthMThetaDlg& dlg, const char* name,
                  T_ENDS<double>& ends, bool fraction)
{
    const TextFn text = [&dlg, name, fraction] {
        return LengthHead(name, fraction, dlg.m_owner.units);
    };
    const auto shown = [&dlg, fraction] { return dlg.AbsoluteFieldsHidden() == fraction; };
    const std::string field = std::string(name) + (fraction ? ".relative." : ".");
    Set(form.Note(text), "", {}, shown);
    Set(form.Number(text, Ref(ends.I)), field + "I", {}, shown);
    Set(form.Number(text, Ref(ends.J)), field + "J", {}, shown);
}

void BuildMTheta(CFormView& form, CPO_HingeLengthMThetaDlg& dlg)
{
    form.Flag(KeyText("IDS_QM_UI_HINGE_RELATIVE"),
              {[&dlg] { return dlg.m_relative; },
               [&dlg](const bool& on) { dlg.OnBtnRelativeLength(on); }})
        .name = "relative";
    form.Cells(EndHeads());
    for (const bool fraction : {false, true}) {
        AddLengthRow(form, dlg, "My", dlg.m_My, fraction);
        AddLengthRow(form, dlg, "Mz", dlg.m_Mz, fraction);
    }
    form.EndCells();
}

void BuildMPhi(CFormView& form, CPO_HingeLengthMPhiDlg& dlg)
{
    form.Flag(KeyText("IDS_QM_UI_HINGE_RELATIVE"), Ref(dlg.m_relative)).name = "relative";
    form.Note(KeyText("IDS_QM_UI_HINGE_MPHI_NOTE"));
    form.Cells(EndHeads());
    // My first: its entry is that of every component.
    for (const std::size_t i : {4, 0, 1, 2, 3, 5}) {
        const auto c = static_cast<HINGE_COMPONENT>(i);
        const TextFn text = [&dlg, i] {
            return LengthHead(kComponentNames[i], dlg.m_relative, dlg.m_owner.units);
        };
        form.Note(text);
        for (const auto end : {HINGE_LOCATION::IEnd, HINGE_LOCATION::JEnd}) {
            const bool j = end == HINGE_LOCATION::JEnd;
            form.Number(text, {[&dlg, i, j] { return (j ? dlg.GetData().J : dlg.GetData().I)[i]; },
                               [&dlg, c, end](const double& v) { dlg.OnEnChange(c, end, v); }})
                .name = std::string(kComponentNames[i]) + (j ? ".J" : ".I");
        }
    }
    form.EndCells();
}

void BuildPoints(CFormView& form, CPO_HingeIntegrationPointDlg& dlg)
{
    form.Choice(
            KeyText("IDS_QM_UI_HINGE_POINTS"),
            {[&dlg] { return dlg.Selected(); }, [&dlg](const int& i) { (void)dlg.OnSelect(i); }},
            [] {
                std::vector<std::string> texts;
                for (const int n : CPO_HingeIntegrationPointDlg::kChoices)
                    texts.push_back(std::to_string(n));
                return texts;
            })
        .name = "integrationPoints";
    form.Note([&dlg] {
        return zql::lib::MMSGFunction::Format("IDS_QM_UI_HINGE_POINTS_NOTE",
                                              {std::to_string(dlg.GetValue())});
    });
}

void BuildSpan(CFormView& form, CPO_HingeAlphaYSpanDlg& dlg)
{
    form.Flag(KeyText("IDS_QM_UI_HINGE_AUTO_SPAN"), Ref(dlg.m_auto)).name = "auto";
    Set(form.Number(
            [&dlg] { return HeadWithUnit("IDS_RPS_PO_SKCV_Span", kDimLength, dlg.m_owner.units); },
            Ref(dlg.m_span)),
        "span", [&dlg] { return !dlg.m_auto; });
}

void BuildMasonry(CFormView& form, CPO_HingeMasonryDlg& dlg)
{
    T_MASONRY_HINGE& m = dlg.m_masonry;
    const auto head = [&dlg](const char* key, T_DIM dim) -> TextFn {
        return [&dlg, key, dim] { return HeadWithUnit(key, dim, dlg.m_owner.units); };
    };
    form.Choice(KeyText("IDS_QM_UI_HINGE_MASONRY_FORM"),
                {[&m] { return m.form - 1; }, [&m](const int& i) { m.form = i + 1; }},
                KeyTexts({"IDS_QM_UI_HINGE_MASONRY_FORM1", "IDS_QM_UI_HINGE_MASONRY_FORM2"}))
        .name = "form";
    form.Number(head("IDS_QM_UI_HINGE_COMP_STRENGTH", kDimStress), Ref(m.compStrength)).name =
        "compStrength";
    form.Number(head("IDS_QM_UI_HINGE_SHEAR_STRENGTH", kDimStress), Ref(m.shearStrength)).name =
        "shearStrength";
    Set(form.Number(head("IDS_QM_UI_HINGE_HP", kDimLength), Ref(m.Hp)), "Hp", {},
        [&m] { return m.form != 2; });
    Set(form.Number(head("IDS_QM_UI_HINGE_DISTRIBUTION", kDimNone), Ref(m.distribution)),
        "distribution", {}, [&m] { return m.form == 2; });
}

} // namespace

void RegisterHingeLengthViews(CViewFactory& factory)
{
    factory.Register<CPO_HingeLengthMThetaDlg>(KeyText("IDS_QM_UI_HINGE_LENGTH_TITLE"), BuildMTheta,
                                               {.size = {420, 0}});
    factory.Register<CPO_HingeLengthMPhiDlg>(KeyText("IDS_QM_UI_HINGE_LENGTH_TITLE"), BuildMPhi,
                                             {.size = {420, 0}});
    factory.Register<CPO_HingeIntegrationPointDlg>(KeyText("IDS_QM_UI_HINGE_POINTS_TITLE"),
                                                   BuildPoints, {.size = {380, 0}});
    factory.Register<CPO_HingeAlphaYSpanDlg>(KeyText("IDS_QM_UI_HINGE_SPAN_TITLE"), BuildSpan,
                                             {.size = {380, 0}});
    factory.Register<CPO_HingeMasonryDlg>(KeyText("IDS_QM_UI_HINGE_MASONRY_TITLE"), BuildMasonry,
                                          {.size = {420, 0}});
}
