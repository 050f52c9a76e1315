#include "qm_ui/document/reportview.h"

#include "qm_base/say.h"
#include "qm_rps/reportdlg.h"
#include "qm_ui/document/documentfile.h"
#include "qm_ui/document/documentpictures.h"
#include "qm_ui/document/pagesview.h"

namespace {

using DLG = CReportDlg;

/// The pages of the latest document.
class CPagesField : public CFormField {
public:
    CPagesField(DLG& dlg, QWidget* parent) : m_dlg(dlg), m_view(new CPagesView(parent))
    {
        widget = m_view;
    }
    void Show() override
    {
        m_view->m_hint = QString::fromStdString(Say("IDS_QM_UI_REPORT_HINT"));
        if (!m_dlg.IsMade() || m_made == m_dlg.Times()) return;
        m_made = m_dlg.Times();
        m_view->SetPages(std::make_shared<const CDocumentPages>(
            m_dlg.Document(), [&doc = m_dlg.Doc()](const T_DOC_PICTURE& picture) {
                return DrawingOf(doc, picture);
            }));
    }
    std::size_t Pages() const { return m_view->Count(); }

private:
    DLG& m_dlg;
    CPagesView* m_view;
    int m_made = 0;
};

void AddHead(CFormView& form, DLG& d)
{
    form.Group(KeyText("IDS_QM_UI_REPORT_HEAD"));
    form.Text(KeyText("IDS_QM_REPORT_PROJECT"), Ref(d.m_head.project)).name = "project";
    form.Text(KeyText("IDS_QM_REPORT_AUTHOR"), Ref(d.m_head.author)).name = "author";
    form.Text(KeyText("IDS_QM_REPORT_CHECKER"), Ref(d.m_head.checker)).name = "checker";
    form.Text(KeyText("IDS_QM_REPORT_DATE"), Ref(d.m_head.date)).name = "date";
    form.EndGroup();
    form.Group(KeyText("IDS_QM_UI_REPORT_CHAPTERS"));
    for (std::size_t i = 0; i < d.m_chosen.size(); ++i)
        form.Flag([i] { return DLG::ChapterText(i); }, Ref(d.m_chosen[i])).name =
            kReportChapterNames[i];
    form.Integer(KeyText("IDS_QM_UI_REPORT_ROWS"), Ref(d.m_rows)).name = "rows";
    form.EndGroup();
}

void Build(CFormView& form, DLG& d)
{
    d.m_write = [&d](bool pdf, const std::string& path, std::string& error) {
        return pdf ? WriteDocumentPdf(d.Doc(), d.Document(), path, error)
                   : WriteDocumentHtml(d.Doc(), d.Document(), path, error);
    };
    form.Columns();
    AddHead(form, d);
    form.Button(KeyText("IDS_QM_UI_REPORT_MAKE"), [&d] { (void)d.OnMake(); }).name = "make";
    form.Button(KeyText("IDS_QM_UI_REPORT_PDF"), [&d] { (void)d.OnWrite(true); }).name = "pdf";
    form.Button(KeyText("IDS_QM_UI_REPORT_HTML"), [&d] { (void)d.OnWrite(false); }).name = "html";
    form.Space();
    form.NextColumn(1);
    auto pages = std::make_unique<CPagesField>(d, form.Host());
    const CPagesField& shown = *pages;
    CFormField& field = form.Custom({}, std::move(pages));
    field.name = "pages";
    field.widget->setMinimumSize(420, 300);
    form.Note([&d, &shown] { return d.StateText(shown.Pages()); }).name = "state";
    form.EndColumns();
}

} // namespace

void RegisterReportView(CViewFactory& factory)
{
    T_VIEW view;
    view.showsOnly = true;
    view.size = {1180, 860};
    factory.Register<DLG>(KeyText("IDS_QM_UI_REPORT_WINDOW"), Build, view);
}
