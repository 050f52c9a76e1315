#include "qm_rps/po_inelastichingedlg.h"

#include "qm_base/msgfunction.h"
#include "qm_base/serviceheadoffice.h"
#include "qm_rps/desk/recordnames.h"

using zql::lib::MMSGFunction;

namespace {

constexpr const char* kTitle = "IDS_QM_UI_IEHP_TITLE";
constexpr int kCurve = 1, kAxialForces = 2; // kinds of service

int Ask(T_SERVICE_REQUEST request)
{
    CServiceAgency* agency = CServiceHeadOffice::Instance()->GetAgency("rps");
    return agency ? agency->Service(request) : 0;
}

} // namespace

void CPO_InelasticHingeDlg::SetDoc(CDBDoc* doc)
{
    CRPSDlgBase::SetDoc(doc);
    TakeOneOf(Names(), m_name);
}

std::vector<std::string> CPO_InelasticHingeDlg::Names() const
{
    return Doc() ? NamesOf(Doc()->Data().Model().inelasticHinges) : std::vector<std::string>();
}

std::vector<std::string> CPO_InelasticHingeDlg::Components()
{
    return {kComponentNames.begin(), kComponentNames.end()};
}

int CPO_InelasticHingeDlg::Key() const
{
    if (!Doc()) return 0;
    for (const auto& [key, record] : Doc()->Data().Model().inelasticHinges)
        if (record.name == m_name) return key;
    return 0;
}

T_TEXT_TABLE CPO_InelasticHingeDlg::Cells() const
{
    T_TEXT_TABLE t{{{MMSGFunction::GetValue("IDS_QM_UI_IEHP_COMPONENT")},
                    {MMSGFunction::GetValue("IDS_QM_UI_IEHP_CURVE")},
                    {MMSGFunction::GetValue("IDS_QM_UI_IEHP_FORCES"), true}},
                   {}};
    T_IEHP_D record;
    if (Key() == 0 || !Doc()->Attr().Get(Key(), record)) return t;
    for (std::size_t i = 0; i < record.components.size(); ++i) {
        const auto& curve = record.components[i];
        t.rows.push_back({kComponentNames[i],
                          MMSGFunction::GetValue(curve ? "IDS_QM_UI_YES" : "IDS_QM_UI_NO"),
                          curve ? std::to_string(curve->curves.size()) : "-"});
    }
    return t;
}

int CPO_InelasticHingeDlg::Store(const T_IEHP_D& record)
{
    return Edit(kTitle, [&](CEditScope& edit) { return edit.Put(Key(), record) != 0; });
}

int CPO_InelasticHingeDlg::OnNew()
{
    if (!Doc()) return 0;
    T_IEHP_D fresh;
    const std::vector<std::string> taken = Names();
    for (int i = 1; fresh.name.empty() || Contains(taken, fresh.name); ++i)
        fresh.name = MMSGFunction::Format("IDS_QM_UI_IEHP_NEW_NAME", {std::to_string(i)});
    const int key = NextKey(Doc()->Data().Model().inelasticHinges);
    const int done = Edit(kTitle, [&](CEditScope& edit) { return edit.Put(key, fresh) != 0; });
    if (done) m_name = fresh.name;
    return done;
}

int CPO_InelasticHingeDlg::OnCurve()
{
    T_IEHP_D record;
    if (Key() == 0 || !Doc()->Attr().Get(Key(), record)) {
        ShowMessage("IDS_QM_UI_IEHP_NONE");
        return 0;
    }
    return Ask({.kind = kCurve, .index = m_component, .key = Key(), .record = &record})
               ? Store(record)
               : 0;
}

int CPO_InelasticHingeDlg::OnAxialForces()
{
    T_IEHP_D record;
    auto& components = record.components;
    const auto at = static_cast<std::size_t>(m_component);
    if (Key() == 0 || !Doc()->Attr().Get(Key(), record) || !components.at(at)) {
        ShowMessage("IDS_QM_UI_IEHP_NO_CURVE");
        return 0;
    }
    return Ask({.kind = kAxialForces, .rows = &components[at]->curves}) ? Store(record) : 0;
}
