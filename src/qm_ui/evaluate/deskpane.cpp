#include "qm_base/say.h"
#include "qm_rps/desk/framescene.h"
#include "qm_ui/evaluate/deskfields.h"
#include "qm_ui/evaluate/deskplot.h"
#include "qm_ui/frame/frameview.h"
#include "qm_ui/plot/plotdrawing.h"
#include "qm_ui/plot/plotfile.h"
#include "qm_ui/plot/plotwidget.h"
#include "qm_ui/push/stepdrawings.h"
#include "qm_ui/report/printing.h"

#include <QClipboard>
#include <QGuiApplication>
#include <QHBoxLayout>
#include <QImage>
#include <QLabel>
#include <QMimeData>
#include <QPainter>
#include <QSplitter>
#include <QToolButton>
#include <QVBoxLayout>

struct CDeskPane::T_PARTS {
    QToolButton *whole = nullptr, *frame = nullptr;
    std::array<QToolButton*, 4> copies{}; // of kCopies
    QSplitter* split = nullptr;
    CPlotWidget* plot = nullptr;
    QWidget* frameBox = nullptr;
    CFrameView* frameView = nullptr;
    QLabel* frameNote = nullptr;
    const CPushOverHingeStateDlg* seen = nullptr; // that the camera was chosen for
};

namespace {

/// What can be done with the picture as it is seen.
struct T_COPY {
    const char *name, *key;
    void (CDeskPane::*run)();
};
constexpr std::array<T_COPY, 4> kCopies{
    {{"copyPicture", "IDS_QM_EVAL_COPY_PICTURE", &CDeskPane::CopyPicture},
     {"copyVector", "IDS_QM_EVAL_COPY_VECTOR", &CDeskPane::CopyVector},
     {"picture", "IDS_QM_UI_PUSH_PICTURE", &CDeskPane::SavePicture},
     {"print", "IDS_QM_UI_PUSH_PRINT", &CDeskPane::Print}}};

QToolButton* AddTool(QHBoxLayout& row, const char* name, bool checkable)
{
    auto* tool = new QToolButton;
    tool->setObjectName(QLatin1String(name));
    tool->setCheckable(checkable);
    tool->setFocusPolicy(Qt::StrongFocus);
    row.addWidget(tool);
    return tool;
}

} // namespace

CDeskPane::CDeskPane(CEvaluationDeskDlg& desk, ChangedFn changed, QWidget* parent)
    : m_desk(desk), m_parts(std::make_unique<T_PARTS>())
{
    T_PARTS& p = *m_parts;
    widget = new QWidget(parent);
    widget->setSizePolicy(QSizePolicy::Expanding, QSizePolicy::Expanding);
    auto* column = new QVBoxLayout(widget);
    column->setContentsMargins(0, 0, 0, 0);
    auto* tools = new QHBoxLayout;
    column->addLayout(tools);
    p.whole = AddTool(*tools, "whole", true);
    p.frame = AddTool(*tools, "frame", true);
    tools->addStretch(1);
    for (std::size_t i = 0; i < kCopies.size(); ++i) {
        p.copies[i] = AddTool(*tools, kCopies[i].name, false);
        QObject::connect(p.copies[i], &QToolButton::clicked,
                         [this, i] { (this->*kCopies[i].run)(); });
    }
    p.split = new QSplitter(Qt::Horizontal, widget);
    p.split->setChildrenCollapsible(false);
    column->addWidget(p.split, 1);
    p.plot = new CPlotWidget(p.split);
    p.plot->SetSizeHint({680, 420});
    p.frameBox = new QWidget(p.split);
    auto* frameColumn = new QVBoxLayout(p.frameBox);
    frameColumn->setContentsMargins(0, 0, 0, 0);
    p.frameView = new CFrameView(p.frameBox);
    p.frameNote = new QLabel(p.frameBox);
    p.frameNote->setWordWrap(true);
    frameColumn->addWidget(p.frameView, 1);
    frameColumn->addWidget(p.frameNote);
    p.split->setStretchFactor(0, 3);
    p.split->setStretchFactor(1, 2);
    QObject::connect(p.whole, &QToolButton::clicked, [this, changed](bool on) {
        m_desk.m_axes.whole = on;
        m_parts->plot->SetView({}); // not the part that was zoomed to
        changed();
    });
    QObject::connect(p.frame, &QToolButton::clicked, [this, changed](bool on) {
        m_desk.OnShowFrame(on);
        changed();
    });
    CDeskPane::Retranslate();
}

/// The widgets may outlive the field: nothing of it is called any more.
CDeskPane::~CDeskPane()
{
    m_parts->whole->disconnect();
    m_parts->frame->disconnect();
    for (QToolButton* tool : m_parts->copies)
        tool->disconnect();
}

void CDeskPane::Retranslate()
{
    const auto write = [](QToolButton* tool, const char* key) {
        tool->setText(QString::fromStdString(Say(key)));
    };
    write(m_parts->whole, "IDS_QM_EVAL_WHOLE");
    write(m_parts->frame, "IDS_QM_EVAL_FRAME");
    for (std::size_t i = 0; i < kCopies.size(); ++i)
        write(m_parts->copies[i], kCopies[i].key);
}

void CDeskPane::Show()
{
    m_parts->whole->setChecked(m_desk.m_axes.whole);
    m_parts->frame->setChecked(m_desk.IsFrameShown());
    m_parts->plot->UpdatePlot(DeskPlot(m_desk));
    ShowFrame();
}

void CDeskPane::ShowFrame()
{
    T_PARTS& p = *m_parts;
    p.frameBox->setVisible(m_desk.IsFrameShown());
    CPushOverHingeStateDlg* const frame = m_desk.Frame();
    if (frame && frame != p.seen) {
        p.frameView->SetCamera(CameraFor(CFrameScene::FlatAxis(frame->Scene())));
        p.frameView->SetPicture(
            StatePicture(*frame, CFrameScene::RoundScale(frame->Scene(), frame->Moves())));
    }
    if (!frame && p.seen) p.frameView->SetPicture({});
    p.seen = frame;
    p.frameView->setVisible(frame != nullptr);
    p.frameNote->setText(QString::fromStdString(m_desk.FrameNote()));
}

CPlotWidget& CDeskPane::Plot()
{
    return *m_parts->plot;
}

T_PLOT CDeskPane::AsSeen()
{
    T_PLOT plot = m_parts->plot->Plot();
    const T_PLOT_VIEW& view = m_parts->plot->View();
    if (view.x) plot.x.range = view.x;
    if (view.y) plot.y.range = view.y;
    return plot;
}

void CDeskPane::CopyPicture()
{
    constexpr double kSharp = 2.0; // px per px at 96 dpi
    const T_PLOT plot = AsSeen();
    const T_DRAWING drawing = DrawingOf(plot);
    QImage image((drawing.size * kSharp).toSize(), QImage::Format_RGB32);
    image.fill(Qt::white);
    QPainter painter(&image);
    painter.scale(kSharp, kSharp);
    drawing.draw(painter, QRectF({0, 0}, drawing.size));
    painter.end();
    QGuiApplication::clipboard()->setImage(image);
}

void CDeskPane::CopyVector()
{
    const T_PLOT plot = AsSeen();
    auto* data = new QMimeData; // the clipboard owns it
    data->setData("image/svg+xml", QByteArray::fromStdString(SvgText(DrawingOf(plot))));
    QGuiApplication::clipboard()->setMimeData(data);
}

void CDeskPane::SavePicture()
{
    const std::string path = m_desk.AskPath("IDS_QM_UI_PICTURE_FILTER");
    std::string error;
    if (!path.empty() && !WritePlotFile(AsSeen(), path, error)) m_desk.SayNotWritten(error);
}

void CDeskPane::Print()
{
    const T_PLOT plot = AsSeen();
    (void)PrintDrawing(widget, DrawingOf(plot));
}

T_TEXT_TABLE TableOnShow(const T_GRID_BINDING& grid)
{
    T_TEXT_TABLE table;
    for (const T_GRID_COLUMN& column : grid.columns)
        table.columns.push_back({column.head(), column.kind == CELL_KIND::Number});
    const std::size_t rows = grid.rows();
    for (std::size_t r = 0; r < rows; ++r) {
        std::vector<std::string>& row = table.rows.emplace_back();
        for (std::size_t c = 0; c < grid.columns.size(); ++c)
            row.push_back(grid.text(r, c));
    }
    return table;
}
