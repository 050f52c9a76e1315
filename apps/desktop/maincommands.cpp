// What the main window's own entries of the menus do.
#include "mainwindow.h"
#include "reporttools.h"

#include "qm_base/msgfunction.h"
#include "qm_ui/report/printing.h"

#include <QDockWidget>

using zql::lib::MMSGFunction;

namespace {

QString Text(const char* key)
{
    return QString::fromStdString(MMSGFunction::GetValue(key));
}

} // namespace

T_COMMANDS CMainWindow::FileCommands()
{
    constexpr const char* kMenu = "IDS_QM_UI_MENU_FILE";
    const auto open = [this] {
        const QString path =
            AskFileName(this, false, Text("IDS_QM_UI_OPEN_TITLE"), Text("IDS_QM_UI_OPEN_FILTER"));
        if (!path.isEmpty()) (void)Open(path);
    };
    const auto make = [this] {
        if (m_frame.OnNew()) Refresh();
    };
    const auto save = [this] {
        if (m_frame.SavePath().empty()) return SaveAs();
        (void)m_frame.OnSave();
        Refresh();
    };
    const auto exportCase = [this] {
        const QString path = AskFileName(this, true, Text("IDS_QM_UI_EXPORT_CASE_TITLE"),
                                         Text("IDS_QM_UI_CASE_FILTER"));
        if (!path.isEmpty()) (void)m_frame.OnExportCase(path.toStdString());
    };
    return {{kMenu, "IDS_QM_UI_NEW", "Ctrl+N", make},
            {kMenu, "IDS_QM_UI_OPEN", "Ctrl+O", open},
            {kMenu, "IDS_QM_UI_SAVE", "Ctrl+S", save},
            {kMenu, "IDS_QM_UI_SAVE_AS", "Ctrl+Shift+S", [this] { SaveAs(); }},
            {kMenu, "IDS_QM_UI_EXPORT_CASE", "", exportCase},
            {kMenu},
            {kMenu, "IDS_QM_UI_EXPORT_PICTURE", "Ctrl+E", [this] { ExportPicture(); }},
            {kMenu, "IDS_QM_UI_PRINT", "Ctrl+P",
             [this] { (void)PrintDrawing(this, m_framePane->Drawing()); }},
            ReportCommand(m_desktop),
            {kMenu},
            {kMenu, "IDS_QM_UI_EXIT", "Ctrl+Q", [this] { close(); }}};
}

T_COMMANDS CMainWindow::EditCommands()
{
    constexpr const char* kMenu = "IDS_QM_UI_MENU_EDIT";
    const auto undo = [this] {
        if (m_frame.OnUndo()) Refresh();
    };
    const auto redo = [this] {
        if (m_frame.OnRedo()) Refresh();
    };
    return {{kMenu, "IDS_QM_UI_UNDO", "Ctrl+Z", undo, [this] { return m_doc.Undo().CanUndo(); }},
            {kMenu, "IDS_QM_UI_REDO", "Ctrl+Y", redo, [this] { return m_doc.Undo().CanRedo(); }},
            {kMenu},
            {kMenu, "IDS_QM_UI_ADD_RECORD", "Ctrl+Ins", [this] { m_browser->Add(); }},
            {kMenu, "IDS_QM_UI_DELETE_RECORD", "Ctrl+Del", [this] { m_browser->Delete(); }}};
}

T_COMMANDS CMainWindow::ViewCommands()
{
    constexpr const char* kMenu = "IDS_QM_UI_MENU_VIEW";
    const auto look = [this](const T_CAMERA& camera) {
        return [this, camera] { m_framePane->View().SetCamera(camera); };
    };
    const auto flag = [this, kMenu](const char* key, const char* keys,
                                    bool T_FRAME_OPTIONS::*which) {
        return T_COMMAND{kMenu,
                         key,
                         keys,
                         [this, which] {
                             T_FRAME_OPTIONS options = m_framePane->View().Options();
                             options.*which = !(options.*which);
                             m_framePane->View().SetOptions(options);
                         },
                         {},
                         [this, which] { return m_framePane->View().Options().*which; }};
    };
    const auto pane = [this, kMenu](const char* key) {
        auto* dock = findChild<QDockWidget*>(QLatin1String(key));
        return T_COMMAND{kMenu,
                         key,
                         "",
                         [dock] {
                             dock->setVisible(dock->isHidden());
                             dock->raise(); // of those that share a place
                         },
                         {},
                         [dock] { return !dock->isHidden(); }};
    };
    using O = T_FRAME_OPTIONS;
    return {{kMenu, "IDS_QM_UI_VIEW_ISO", "Alt+1", look(kIsometric)},
            {kMenu, "IDS_QM_UI_VIEW_XZ", "Alt+2", look(kElevationXZ)},
            {kMenu, "IDS_QM_UI_VIEW_YZ", "Alt+3", look(kElevationYZ)},
            {kMenu, "IDS_QM_UI_VIEW_XY", "Alt+4", look(kPlanXY)},
            {kMenu},
            flag("IDS_QM_UI_VIEW_NODES", "Ctrl+Alt+N", &O::nodeNumbers),
            flag("IDS_QM_UI_VIEW_ELEMENTS", "Ctrl+Alt+E", &O::elementNumbers),
            flag("IDS_QM_UI_VIEW_SUPPORTS", "", &O::supports),
            flag("IDS_QM_UI_VIEW_HINGES", "", &O::hinges),
            flag("IDS_QM_UI_VIEW_DRIFTS", "", &O::drifts),
            flag("IDS_QM_UI_VIEW_BEFORE", "", &O::undeformed),
            {kMenu},
            pane("IDS_QM_UI_EXPLORER"),
            pane("IDS_QM_UI_PROPERTIES"),
            pane("IDS_QM_UI_TABLES"),
            pane("IDS_QM_UI_MESSAGES"),
            pane("IDS_QM_VIEW_RESULTS")};
}

T_COMMANDS CMainWindow::WindowCommands()
{
    constexpr const char* kAnalysis = "IDS_QM_UI_MENU_ANALYSIS";
    return {{kAnalysis, "IDS_QM_UI_ANALYSE", "F5", [this] { Analyse(); }}};
}
