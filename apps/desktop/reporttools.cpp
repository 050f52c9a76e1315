#include "reporttools.h"

#include "mainwindow.h"

#include "qm_base/msgfunction.h"
#include "qm_rps/reportdlg.h"
#include "qm_ui/document/documentfile.h"
#include "qm_ui/form/dialogwindow.h"

namespace {

QString Text(const char* key)
{
    return QString::fromStdString(zql::lib::MMSGFunction::GetValue(key));
}

/// Connects the model with the windows that ask and that show progress.
void Prepare(T_DESKTOP& desktop, CReportDlg& dialog)
{
    dialog.SetView(&desktop.view);
    dialog.m_fileHash = FileHash(desktop.doc.Path());
    dialog.m_askFile = [&desktop](bool pdf) {
        return AskFileName(
                   desktop.window, true, Text("IDS_QM_UI_REPORT_WINDOW"),
                   Text(pdf ? "IDS_QM_UI_REPORT_PDF_FILTER" : "IDS_QM_UI_REPORT_HTML_FILTER"))
            .toStdString();
    };
    dialog.m_run = [&desktop](const std::function<int(const CReportDlg::TELL_FN&)>& work) {
        return RunWithProgress(desktop.window, Text("IDS_QM_UI_REPORT_WINDOW"), [&](auto tell) {
            std::size_t done = 0;
            // What is made is not known beforehand: the bar comes nearer to its end with each part.
            return work([&](const std::string&) {
                ++done;
                return tell(done, done + kReportChapterNames.size());
            });
        });
    };
}

} // namespace

T_COMMAND ReportCommand(T_DESKTOP& desktop)
{
    const auto open = [&desktop] {
        CReportDlg dialog(desktop.doc);
        Prepare(desktop, dialog);
        (void)dialog.DoModal();
        desktop.changed(); // the settings of the report may be others
    };
    return {"IDS_QM_UI_MENU_FILE", "IDS_QM_UI_REPORT_COMMAND", "Ctrl+R", open};
}

std::vector<T_WINDOW_EXAMPLE> ReportWindowExamples()
{
    return {{"report", "rc-frame-3-storey", [](CMainWindow& main) -> std::unique_ptr<QWidget> {
                 auto dialog = std::make_unique<CReportDlg>(main.Doc());
                 dialog->m_head.project = "Office building, wing B";
                 dialog->m_head.author = "A. Engineer";
                 (void)dialog->OnMake();
                 const CViewFactory& factory = main.Desktop().factory;
                 const T_VIEW& view = *factory.Find(*dialog);
                 auto window = std::make_unique<CDialogWindow>(factory, view, *dialog, nullptr);
                 KeepWith(*window, std::move(dialog));
                 window->show();
                 window->resize(view.size);
                 return window;
             }}};
}
