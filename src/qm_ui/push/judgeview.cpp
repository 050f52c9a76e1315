#include "qm_ui/push/judgeview.h"

#include "qm_rps/pushoverjudgementdlg.h"
#include "qm_ui/form/formview.h"
#include "qm_ui/frame/frameview.h"
#include "qm_ui/push/judgedrawing.h"

namespace {

using MODEL = CPushOverJudgementDlg;

class CJudgedFrame : public CFormField {
public:
    CJudgedFrame(MODEL& judged, QWidget* parent) : m_judged(judged), m_view(new CFrameView(parent))
    {
        widget = m_view;
        m_view->SetCamera(CameraFor(CFrameScene::FlatAxis(judged.Scene())));
        m_view->SetOptions({.hinges = false});
    }
    void Show() override
    {
        if (const T_JUDGED_STATE* const state = m_judged.State())
            m_view->SetPicture(
                JudgementPicture(m_judged.Scene(), m_judged.Bands(), m_judged.Judgement(), *state));
    }

private:
    MODEL& m_judged;
    CFrameView* m_view;
};

void Build(CFormView& form, MODEL& d)
{
    form.Note([&d] { return d.TitleText(); });
    // One below the other: beside each other their texts are cut in a narrow window.
    form.Choice(KeyText("IDS_QM_JUDGE_LIMIT_STATE"),
                {[&d] { return d.StateIndex(); },
                 [&d](const int& index) { d.OnSelChangeState(index); }},
                [&d] { return d.StateTexts(); })
        .name = "state";
    form.Choice(
            KeyText("IDS_QM_UI_JUDGE_CODE"),
            {[&d] { return d.CodeIndex(); }, [&d](const int& index) { d.OnSelChangeCode(index); }},
            [&d] { return d.CodeTexts(); })
        .name = "code";
    form.Note([&d] { return d.VerdictText(); });
    form.Note([&d] { return d.CountText(); });
    CFormField& frame = form.Custom({}, std::make_unique<CJudgedFrame>(d, form.Host()));
    frame.name = "frame";
    frame.widget->setMinimumSize(420, 200);
    T_GRID_BINDING table = GridOf([&d] { return d.Table(); });
    table.tone = [&d](std::size_t row, std::size_t) {
        const VERDICT verdict = d.VerdictAt(row);
        if (verdict == VERDICT::NotFulfilled) return CELL_TONE::Fault;
        return verdict == VERDICT::NotChecked ? CELL_TONE::Notice : CELL_TONE::Plain;
    };
    CFormField& grid = form.Grid(std::move(table));
    grid.name = "ends";
    grid.widget->setMinimumHeight(150);
    form.Button(KeyText("IDS_QM_UI_JUDGE_EXPORT"), [&d] { (void)d.OnExport(); }).name = "export";
    form.Note([&d] { return d.LimitsText(); });
    form.Note([&d] { return d.NotesText(); });
}

} // namespace

void RegisterJudgementView(CViewFactory& factory)
{
    T_VIEW view;
    view.showsOnly = true;
    view.size = {1240, 900};
    factory.Register<MODEL>(KeyText("IDS_QM_UI_JUDGE_TITLE"), Build, view);
}
