#include "hingetools.h"

#include "qm_base/say.h"
#include "qm_rps/codehingedlg.h"
#include "qm_rps/hingeoptionsdlg.h"
#include "qm_rps/po_hingetypelistdlg.h"
#include "qm_rps/pushoverhingedatatype.h"
#include "qm_rps/pushoverhingelistdlg.h"
#include "qm_rps/sectioncurvesdlg.h"
#include "qm_ui/hinge/hingeviews.h"
#include "qm_ui/section/sectionviews.h"

namespace {

constexpr const char* kMenu = "IDS_QM_UI_MENU_HINGES";

void RunTypeList(T_DESKTOP& desktop)
{
    CPO_HingeTypeListDlg list(desktop.doc);
    list.SetView(&desktop.view);
    (void)list.DoModal();
    desktop.changed();
}

void RunHingeList(T_DESKTOP& desktop, int selected)
{
    CPushOverHingeListDlg list(desktop.doc);
    list.SetView(&desktop.view);
    list.m_selected = selected;
    (void)list.DoModal();
    desktop.changed();
}

void RunCodeHinges(T_DESKTOP& desktop)
{
    CCodeHingeDlg dialog(desktop.doc);
    dialog.SetView(&desktop.view);
    dialog.m_withProgress = [&desktop](const auto& work) {
        return RunWithProgress(desktop.window, QString::fromStdString(Say("IDS_QM_UI_GEN_PUSHING")),
                               work);
    };
    (void)dialog.DoModal();
    desktop.changed();
}

void RunTable(T_DESKTOP& desktop)
{
    CPushOverHingeDataType table(desktop.doc);
    table.SetView(&desktop.view);
    if (!table.ChooseFirst()) return;
    (void)table.DoModal();
    desktop.changed();
}

void RunOptions(T_DESKTOP& desktop)
{
    CHingeOptionsDlg options(desktop.doc);
    options.SetView(&desktop.view);
    if (options.DoModal()) desktop.changed();
}

/// section: key of the one to begin with; 0: the first.
void RunSectionCurves(T_DESKTOP& desktop, int section)
{
    CSectionCurvesDlg curves(desktop.doc);
    curves.SetView(&desktop.view);
    const auto ask = [&desktop](bool save) {
        const auto text = [](const char* key) { return QString::fromStdString(Say(key)); };
        return AskFileName(desktop.window, save, text("IDS_QM_UI_SECC_TITLE"),
                           text(save ? "IDS_QM_UI_SECC_FILES" : "IDS_QM_UI_SECK_FILES"))
            .toStdString();
    };
    curves.m_askFile = [&ask] { return ask(true); };
    curves.m_askSets = [&ask] { return ask(false); };
    curves.OnOpenSection(section);
    (void)curves.DoModal();
}

void RunTypeEditor(T_DESKTOP& desktop, int key)
{
    CPO_HingeTypeListDlg list(desktop.doc);
    list.SetView(&desktop.view);
    list.m_selected = key;
    (void)list.OnModify();
    desktop.changed();
}

} // namespace

void RegisterHingeViews(CViewFactory& factory)
{
    for (const auto add :
         {RegisterHingeListViews, RegisterHingeTypeView, RegisterHingeFemaViews,
          RegisterHingeMultiView, RegisterHingeEuroView, RegisterHingeInteractionViews,
          RegisterHingeLengthViews, RegisterHingeStrengthViews, RegisterHingeOptionsView,
          RegisterSectionViews, RegisterCodeHingeView})
        add(factory);
}

T_COMMANDS HingeCommands(T_DESKTOP& desktop)
{
    return {{kMenu, "IDS_QM_UI_HINGE_TYPES", "Ctrl+Shift+H", [&desktop] { RunTypeList(desktop); }},
            {kMenu, "IDS_QM_UI_HINGES_GENERATED", "Ctrl+Shift+G",
             [&desktop] { RunHingeList(desktop, 0); }},
            {kMenu, "IDS_QM_UI_GEN_MENU", "", [&desktop] { RunCodeHinges(desktop); },
             [&desktop] { return !desktop.doc.Data().Model().elements.empty(); }},
            {kMenu, "IDS_QM_UI_HINGE_TABLE", "", [&desktop] { RunTable(desktop); }},
            {kMenu, "IDS_QM_UI_SECC_CMD", "", [&desktop] { RunSectionCurves(desktop, 0); }},
            {kMenu, "IDS_QM_UI_HINGE_OPTIONS_CMD", "", [&desktop] { RunOptions(desktop); }}};
}

bool OpenHingeRecord(T_DESKTOP& desktop, EXPLORER_TABLE table, int key)
{
    if (table == EXPLORER_TABLE::HingeTypes)
        RunTypeEditor(desktop, key);
    else if (table == EXPLORER_TABLE::Hinges)
        RunHingeList(desktop, key);
    else if (table == EXPLORER_TABLE::Sections)
        RunSectionCurves(desktop, key);
    else
        return false;
    return true;
}
