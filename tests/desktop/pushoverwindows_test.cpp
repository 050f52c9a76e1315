#include "desktoptest.h"
#include "explorerpane.h"
#include "pushovertools.h"
#include "pushoverwindow.h"
#include "tempfolder.h"

#include "qm_rps/pushovercurvedampparamuser.h"
#include "qm_ui/evaluate/deskfields.h"
#include "qm_ui/plot/plotwidget.h"

#include <QAction>
#include <QFileInfo>
#include <QLabel>
#include <QListWidget>
#include <QRegularExpression>
#include <QSlider>
#include <QSpinBox>
#include <QToolButton>

using namespace desktop_test;

namespace {

constexpr const char* kFrame = "rc-frame-3-storey";

QByteArray Contents(const QString& path)
{
    return QByteArray::fromStdString(ReadText(path.toStdString()));
}

/// The first number after a text, on from another one.
double NumberAfter(const QByteArray& text, const char* from, const char* name)
{
    const QString rest = QString::fromUtf8(text.mid(text.indexOf(from)));
    const QRegularExpression pattern(QStringLiteral("\"%1\": ([-0-9.eE+]+)").arg(name));
    return pattern.match(rest).captured(1).toDouble();
}

class PushoverWindows : public DesktopTest {
protected:
    void OpenCurve(const char* example = kFrame)
    {
        ASSERT_TRUE(Open(example));
        Run("IDS_QM_UI_PUSH_CURVE");
        m_window = &CPushOverWindow::Show(m_main->Desktop());
        Settle();
    }
    CEvaluationDeskDlg& Model() { return m_window->Model(); }
    /// Chooses an evaluation in the list.
    void Choose(const char* name)
    {
        auto* list = qobject_cast<QListWidget*>(Field("list"));
        for (int row = 0; row < list->count(); ++row)
            if (list->item(row)->text().section(u'\n', 0, 0) == name) list->setCurrentRow(row);
        ASSERT_EQ(name, Result().eval.name);
    }
    QWidget* Tool(const char* name) { return m_window->findChild<QToolButton*>(name); }
    QWidget* Field(const char* name) { return m_window->Form().Find(name)->widget; }
    const T_PUSH_EVALUATION& Result() { return Model().Shown().Result(); }
    bool IsMarked(const char* name) { return m_window->Form().Find(name)->IsMarked(); }
    CPlotWidget& Plot() { return dynamic_cast<CDeskPane&>(*m_window->Form().Find("plot")).Plot(); }
    bool HasLabel(const char* text)
    {
        return std::ranges::any_of(Plot().Plot().labels,
                                   [&](const T_PLOT_LABEL& l) { return l.text == text; });
    }

    CPushOverWindow* m_window = nullptr;
};

/// Saves from the preview and closes it.
CAnswers::STEP SaveText()
{
    return [](QWidget& window) {
        auto& dialog = dynamic_cast<CDialogWindow&>(window);
        Click(desktop_test::Field(dialog, "save"));
        dialog.reject();
    };
}

} // namespace

// Every evaluation method, from File > Open to files on disk, against the command line program.
TEST_F(PushoverWindows, TheWholeJobGivesTheReportOfTheCommandLine)
{
    struct T_JOB {
        const char* stored; // opened, then:
        int spectrum;       // chosen in the list
        const char* same;   // evaluation of the case file with these settings
    };
    const T_JOB jobs[] = {{"PX_MODE1 ATC-40 B", 1, "PX_MODE1 ATC-40 B strong"},
                          {"PX_MODE1 FEMA440 A", 1, "PX_MODE1 FEMA440 A"},
                          {"PX_MODE1 EC8", 2, "PX_MODE1 EC8"},
                          {"PX_UNIFORM NTC2018", 3, "PX_UNIFORM NTC2018"}};
    AnswerFileName(Example(kFrame));
    Run("IDS_QM_UI_OPEN");
    Run("IDS_QM_UI_PUSH_CURVE");
    m_window = &CPushOverWindow::Show(m_main->Desktop());
    for (const T_JOB& job : jobs) {
        Choose(job.stored);
        ChooseIndex(Field("spectrum"), job.spectrum);
        AnswerFileName(File("window")); // .txt is appended
        for (const char* before : {"window.txt", "program.txt"})
            QFile::remove(File(before));
        {
            CAnswers answers({SaveText()});
            Click(Field("report"));
        }
        const QByteArray json = Program({"evaluate", Example(kFrame), "--only", job.same, "--json",
                                         "-", "--report", File("program.txt")});
        const QByteArray report = Contents(File("window.txt"));
        EXPECT_GT(report.size(), 1000) << job.same;
        QByteArray program = Contents(File("program.txt"));
        // The window names the evaluation that its settings began with.
        program.replace(QByteArray(": ") + job.same + '\n', QByteArray(": ") + job.stored + '\n');
        EXPECT_EQ(program, report) << job.same;
        const T_PUSH_EVALUATION& e = Result();
        EXPECT_EQ(NumberAfter(json, "\"factors\"", "gamma"), e.factors.gamma);
        if (e.IsTarget()) {
            EXPECT_EQ(NumberAfter(json, "\"limit_states\"", "demand"), e.limitStates[0].demand);
            continue;
        }
        ASSERT_TRUE(e.point) << job.same;
        for (const auto& [name, value] : {std::pair("D", e.point->D), std::pair("V", e.point->V),
                                          std::pair("T_eff", e.point->Teff)})
            EXPECT_EQ(NumberAfter(json, "\"performance_point\"", name), value) << name;
    }
    // Every edit of a stored evaluation is a step that can be taken back.
    while (m_main->Doc().Undo().CanUndo())
        Run("IDS_QM_UI_UNDO");
    EXPECT_EQ("ATC design", m_main->Doc().Data().Model().evaluations.at(1).spectrum);
}

TEST_F(PushoverWindows, TypingIsEvaluatedAtOnceAndWrongInputKeepsTheLastPicture)
{
    OpenCurve();
    const double first = Result().point->Sd;
    Type(Field("elasticDamping"), "8");
    const double softer = Result().point->Sd;
    EXPECT_LT(softer, first);
    EXPECT_EQ("", Model().Shown().Refusal());
    const T_PLOT before = Plot().Plot();
    for (const char* wrong : {"x", "101"}) {
        Type(Field("elasticDamping"), wrong);
        EXPECT_TRUE(IsMarked("elasticDamping")) << wrong;
        EXPECT_EQ(before, Plot().Plot()) << wrong;
        EXPECT_EQ(softer, Result().point->Sd) << wrong;
    }
    EXPECT_TRUE(qobject_cast<QLabel*>(Field("refusal"))->text().contains("0 to 100"));
    Type(Field("elasticDamping"), "5");
    EXPECT_EQ(first, Result().point->Sd);
    EXPECT_FALSE(Field("refusal")->isVisible());
}

TEST_F(PushoverWindows, TrialsAreSteppedThroughOneAtATime)
{
    OpenCurve();
    const int count = Model().Shown().TrialCount();
    ASSERT_EQ(2, count);
    auto* slider = Field("trial")->findChild<QSlider*>();
    ASSERT_EQ(count, slider->maximum());
    Plot().SetView({T_PLOT_RANGE{0.0, 5.0}, {}, {}}); // the person has zoomed in
    auto* table = qobject_cast<QTableView*>(Field("trials"));
    for (int k = 1; k <= count; ++k) {
        Key(slider, Qt::Key_Right);
        EXPECT_EQ(k, Model().Shown().Trial());
        EXPECT_TRUE(HasLabel(("trial " + std::to_string(k)).c_str()));
        EXPECT_EQ(5.0, Plot().View().x->hi);
        EXPECT_EQ(k - 1, table->currentIndex().row());
    }
    Key(Field("trial")->findChild<QSpinBox*>(), Qt::Key_Down);
    EXPECT_EQ(count - 1, Model().Shown().Trial());
    const double dpi = Result().trace[0].dpi;
    EXPECT_NEAR(dpi, table->model()->index(0, 0).data().toDouble(), 1e-5 * dpi);
}

// The picture and the fields that the method has follow the choice of the method.
TEST_F(PushoverWindows, EveryMethodAndPlotTypeHasItsPicture)
{
    OpenCurve();
    ChooseIndex(Field("method"), 2);
    EXPECT_EQ(PUSH_METHOD::Ec8Opcm, Model().m_settings.method);
    EXPECT_FALSE(Field("procedure")->isVisibleTo(m_window));
    EXPECT_TRUE(Field("masonry")->isVisibleTo(m_window));
    EXPECT_FALSE(Plot().Plot().guides.empty());
    Click(Field("guideLines"));
    EXPECT_TRUE(Plot().Plot().guides.empty());
    const char* const titles[] = {"Resultant Base Reaction (kips)", "Shear Coefficient",
                                  "Shear Coefficient", "Load Factor"};
    for (int type = 0; type < 4; ++type) {
        ChooseIndex(Field("plotType"), type);
        EXPECT_EQ(titles[type], Plot().Plot().y.title);
        EXPECT_EQ(Result().curve.x, Plot().Plot().series.at(0).x);
    }
}

TEST_F(PushoverWindows, PictureAndCurveAreWrittenAndBadNamesAreRefused)
{
    OpenCurve();
    AnswerFileName(File("a.png"));
    Click(Tool("picture"));
    EXPECT_GT(QFileInfo(File("a.png")).size(), 1000);
    AnswerFileName(File("curve.txt"));
    CAnswers answers({SaveText(), CAnswers::Accept(), SaveText(), CAnswers::Accept()});
    Click(Field("curveFile"));
    EXPECT_TRUE(Contents(File("curve.txt")).contains("step"));
    EXPECT_FALSE(Contents(File("curve.txt")).contains("Performance Point"));
    AnswerFileName(File("a.gif"));
    Click(Tool("picture"));
    AnswerFileName(File("no folder/report"));
    Click(Field("report"));
    EXPECT_TRUE(answers.m_texts.value(0).contains("a.gif"));
    EXPECT_TRUE(answers.m_texts.value(1).contains("can't be created"));
}

TEST_F(PushoverWindows, UserDampingIsRefusedAndAccepted)
{
    OpenCurve();
    ChooseIndex(Field("behavior"), 3);
    const auto fill = [](const char* beta1, const char* beta2) {
        return [=](CDialogWindow& dialog) {
            Enter(dialog, "beta1", beta1);
            Enter(dialog, "beta2", beta2);
        };
    };
    CAnswers answers({CAnswers::Fill(fill("30", "10")), CAnswers::Accept(), // the message
                      CAnswers::Fill(fill("10", "30"))});
    Click(Field("userDamping"));
    EXPECT_TRUE(answers.m_texts.value(0).contains("beta1"));
    EXPECT_EQ(10.0, Model().m_settings.userDamping.value()[0]);
    EXPECT_EQ(30.0, Model().m_settings.userDamping.value()[2]);
    EXPECT_EQ(Model().m_settings.userDamping,
              Result().eval.userDamping); // evaluated with them
}

TEST_F(PushoverWindows, StoredEvaluationsAndStepsAreVisibleActions)
{
    OpenCurve();
    const auto& model = m_main->Doc().Data().Model();
    const auto count = model.evaluations.size();
    Type(Field("name"), "mine");
    ChooseIndex(Field("method"), 2);
    EXPECT_FALSE(m_main->Doc().Data().IsModified());
    Click(Field("store"));
    ASSERT_EQ(count + 1, model.evaluations.size());
    EXPECT_EQ("mine", model.evaluations.rbegin()->second.name);
    EXPECT_TRUE(m_main->windowTitle().contains('*'));
    Run("IDS_QM_UI_UNDO");
    EXPECT_EQ(count, model.evaluations.size());
    EXPECT_TRUE(model.poverSteps.empty());
    Click(Field("storeSteps"));
    EXPECT_EQ(1U, model.poverSteps.size());
    Type(Field("name"), "");
    CAnswers answers({CAnswers::Accept()});
    Click(Field("store"));
    EXPECT_TRUE(answers.m_texts.value(0).contains("name"));
}

TEST_F(PushoverWindows, AdditionalStepsAndPointsAreListedAndDrawn)
{
    OpenCurve();
    for (const char* step : {"3", "40"}) {
        Type(Field("addStepNumber"), step);
        Click(Field("addStep"));
    }
    EXPECT_EQ(2U, Result().additionalSteps.size());
    EXPECT_TRUE(HasLabel("step 40"));
    Type(Field("addStepNumber"), "100000");
    {
        CAnswers answers({CAnswers::Accept()});
        Click(Field("addStep"));
        EXPECT_TRUE(answers.m_texts.value(0).contains("100000"));
    }
    ChooseIndex(Field("addPointSpectrum"), 1);
    Click(Field("addPoint"));
    EXPECT_EQ(1U, Result().additionalPoints.size());
    qobject_cast<QTableView*>(Field("steps"))->selectRow(0);
    Click(Field("removeStep"));
    ASSERT_EQ(1U, Result().additionalSteps.size());
    EXPECT_EQ(40, Result().additionalSteps[0].step);
}

TEST_F(PushoverWindows, TheComparisonShowsEveryMethodAndIsExported)
{
    ASSERT_TRUE(Open(kFrame));
    AnswerFileName(File("all.svg"));
    const auto look = [](CDialogWindow& dialog) {
        QAbstractItemModel& table =
            *qobject_cast<QTableView*>(desktop_test::Field(dialog, "table"))->model();
        EXPECT_EQ(8, table.rowCount());
        const QString first = Cell(table, 7, 1);
        ChooseIndex(desktop_test::Field(dialog, "spectrum"), 3);
        EXPECT_NE(first, Cell(table, 7, 1));
        Click(desktop_test::Field(dialog, "picture"));
        dialog.reject();
    };
    CAnswers answers({CAnswers::Fill(look, false)});
    Run("IDS_QM_UI_PUSH_COMPARE_ALL");
    EXPECT_TRUE(Contents(File("all.svg")).contains("NTC2018 SLV"));
}

TEST_F(PushoverWindows, ControlOptionsAndStepsHaveWindowsOfTheirOwn)
{
    OpenCurve();
    {
        CAnswers answers({CAnswers::Fill([](CDialogWindow& d) { Enter(d, "node2", "99999"); }),
                          CAnswers::Accept(), // there is no such node
                          CAnswers::Fill([](CDialogWindow& d) {
                              Enter(d, "node2", "31");
                              Enter(d, "weight", "1000");
                          })});
        Click(Field("control"));
        EXPECT_TRUE(answers.m_texts.value(0).contains("not in the model"));
    }
    EXPECT_EQ(1000.0, Result().eval.weight);
    ASSERT_EQ(1U, Result().curve.monitored.size());
    EXPECT_TRUE(Result().curve.monitored[0].hasResults);
    {
        CAnswers answers({CAnswers::Fill([](CDialogWindow& d) {
            for (const char* step : {"5", "7"}) {
                Enter(d, "step", step);
                Push(d, "add");
            }
        })});
        Click(Field("stepsDlg"));
    }
    ASSERT_EQ(2U, Result().additionalSteps.size());
    EXPECT_EQ(7, Result().additionalSteps[1].step);
}

TEST_F(PushoverWindows, TheLoadCaseIsChosenAndTheReportDataAreThoseOfTheCommandLine)
{
    OpenCurve();
    {
        CAnswers answers({CAnswers::Fill([](CDialogWindow& d) { Grid(d, "rows").selectRow(1); })});
        Run("IDS_QM_UI_PUSH_CHOOSE_CASE");
    }
    EXPECT_EQ(m_main->Doc().Data().Model().pushovers.at(2).name, Result().eval.push);
    AnswerFileName(File("data.json"));
    Run("IDS_QM_UI_REPORT_DATA");
    EXPECT_EQ(Program({"report-data", Example(kFrame)}), Contents(File("data.json")));
}

TEST_F(PushoverWindows, OneWindowFollowsTheDocumentAndTheLanguage)
{
    ASSERT_TRUE(Open(kFrame));
    m_main->Explorer().Choose(EXPLORER_TABLE::Evaluations);
    ASSERT_TRUE(OpenPushoverRecord(m_main->Desktop(), EXPLORER_TABLE::Evaluations, 6));
    m_window = &CPushOverWindow::Show(m_main->Desktop());
    EXPECT_EQ(m_window, &CPushOverWindow::Show(m_main->Desktop()));
    EXPECT_EQ("PX_MODE1 EC8", Result().eval.name);
    m_main->SetLanguage("it");
    EXPECT_EQ("&Salva", m_main->Action("IDS_QM_UI_SAVE")->text());
    EXPECT_EQ("Curva pushover", m_window->windowTitle());
    EXPECT_TRUE(QString::fromStdString(Plot().Plot().x.title).startsWith("Spostamento spettrale"));
    m_main->SetLanguage("en");
    ASSERT_TRUE(Open("first-steps"));
    (void)CPushOverWindow::Show(m_main->Desktop());
    const auto& pushes = m_main->Doc().Data().Model().pushovers;
    EXPECT_EQ(pushes.begin()->second.name, Result().loadCase.name);
    EXPECT_FALSE(OpenPushoverRecord(m_main->Desktop(), EXPLORER_TABLE::Nodes, 1));
}
