#include "qm_rps/serviceagencyrps.h"

#include "qm_base/appbase.h"
#include "qm_rps/modelessdlgctrl.h"
#include "qm_rps/po_femastrlossfigure0dlg.h"
#include "qm_rps/po_femastrlossfigureedlg.h"
#include "qm_rps/po_femaunloadstifffigureedlg.h"
#include "qm_rps/po_hingeskcvtabfemaaxialdlg.h"
#include "qm_rps/po_hingeskcvtabfemadlg.h"

namespace {

int Assert(int line)
{
    if (CAppBase::IsReleaseAssert_ST())
        CAppBase::ReleaseAssertion_ST("src/qm_rps/serviceagencyrps", line);
    return 0;
}

zql::frx::IDialogView* CurrentView()
{
    CDBDoc* doc = CDBDoc::GetDocPoint();
    return doc ? CModelessDlgCtrl::Of(*doc).View() : nullptr;
}

int EditTimeHistoryHinge(const T_SERVICE_REQUEST& request)
{
    auto* record = static_cast<T_IEHP_D*>(request.record);
    T_PHGT_D type;
    if (!record || !CAttrCtrl::Convert_IehpToPhgt_FEMA(*record, request.index, type))
        return Assert(__LINE__);
    const auto c = static_cast<HINGE_COMPONENT>(request.index);
    T_HINGE_COMPONENT& component = type.components[static_cast<std::size_t>(request.index)];
    component.active = true; // one that the record has not got yet is made here
    CPO_HingeSkcvTabFemaDlg dialog;
    dialog.SetView(CurrentView());
    dialog.SetTimeHistory(1);
    if (!dialog.Data2Dlg(c, component) || !dialog.DoModal() || !dialog.Dlg2Data(c, component))
        return 0;
    return CAttrCtrl::Convert_PhgtToIehp_FEMA(type, request.index, *record);
}

int EditAxialForces(const T_SERVICE_REQUEST& request)
{
    auto* rows = static_cast<std::vector<T_SKEL_AXIAL>*>(request.rows);
    if (!rows) return Assert(__LINE__);
    CPO_HingeSkcvTabFemaAxialDlg dialog;
    dialog.SetView(CurrentView());
    if (CDBDoc* doc = CDBDoc::GetDocPoint()) dialog.m_units = doc->Unit().Units();
    if (!dialog.Data2Dlg(*rows) || !dialog.DoModal()) return 0;
    CServiceAgencyRps::T_AXIAL_VALUES old;
    for (const T_SKEL_AXIAL& row : *rows)
        old.emplace(row.axial, row.sides);
    *rows = CServiceAgencyRps::RebuildRows(dialog.Keys(), dialog.Values(), old);
    return 1;
}

template <class FIGURE>
int ShowFigure(const T_SERVICE_REQUEST&)
{
    FIGURE figure;
    figure.SetView(CurrentView());
    (void)figure.DoModal(); // it only shows
    return 0;
}

struct T_SERVICE {
    int kind;
    int (*serve)(const T_SERVICE_REQUEST&);
};
constexpr T_SERVICE kServices[] = {{1, EditTimeHistoryHinge},
                                   {2, EditAxialForces},
                                   {3, ShowFigure<CPO_FEMAStrLossFigure0Dlg>},
                                   {4, ShowFigure<CPO_FEMAStrLossFigureEDlg>},
                                   {5, ShowFigure<CPO_FEMAUnloadStiffFigureEDlg>}};

} // namespace

int CServiceAgencyRps::Service(const T_SERVICE_REQUEST& request)
{
    const T_SERVICE_REQUEST copy = request; // the caller may change its own while a dialog is open
    for (const T_SERVICE& service : kServices)
        if (service.kind == copy.kind) return service.serve(copy);
    return Assert(__LINE__);
}

std::vector<T_SKEL_AXIAL> CServiceAgencyRps::RebuildRows(const std::vector<double>& keys,
                                                         const T_AXIAL_VALUES& edited,
                                                         const T_AXIAL_VALUES& old)
{
    std::vector<T_SKEL_AXIAL> rows;
    for (const double axial : keys) {
        auto value = edited.find(axial);
        if (value == edited.end()) {
            value = old.find(axial);
            if (value == old.end()) {
                Assert(__LINE__);
                continue;
            }
        }
        rows.push_back({axial, value->second});
    }
    return rows;
}
