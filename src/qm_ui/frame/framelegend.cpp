#include "qm_ui/frame/framelegend.h"

#include "qm_base/msgfunction.h"
#include "qm_base/textformat.h"
#include "qm_rps/push/pushatpointtext.h"
#include "qm_ui/form/localnumber.h"
#include "qm_ui/plot/plot.h"

#include <QFont>
#include <QFontMetricsF>
#include <QPainter>

#include <algorithm>
#include <array>
#include <cmath>
#include <functional>

namespace {

using zql::lib::MMSGFunction;

constexpr double kPad = 8.0;
constexpr double kSwatch = 26.0;
constexpr double kTextPx = 12.0;
constexpr double kDriftWidth = 190.0;

QString Text(const char* key)
{
    return QString::fromStdString(MMSGFunction::GetValue(key));
}

bool HasKind(const T_FRAME_SCENE& scene, ELEM_KIND kind)
{
    return std::ranges::any_of(scene.lines, [&](const auto& l) { return l.kind == kind; });
}

using T_ENTRY = T_LEGEND_ENTRY;

T_ENTRY LineEntry(const QString& text, const QPen& pen)
{
    return {text, [pen](QPainter& p, QPointF m) {
                p.setPen(pen);
                p.drawLine(m - QPointF(kSwatch / 2, 0), m + QPointF(kSwatch / 2, 0));
            }};
}

/// A filled circle up to C, a square beyond, a cross where the hinge has failed.
struct T_STATE_LOOK {
    QRgb color;
    double radius;
};
constexpr std::array<T_STATE_LOOK, kPushStateNames.size()> kStateLooks{{
    {0xffb0bec5, 3.0}, // elastic
    {0xff43a047, 4.5}, // B-IO
    {0xff1e88e5, 4.5}, // IO-LS
    {0xfffdd835, 5.0}, // LS-CP
    {0xfffb8c00, 5.0}, // CP-C
    {0xff00acc1, 4.5}, // B-C
    {0xffe53935, 4.5}, // C-D
    {0xff8e24aa, 4.5}, // D-E
    {0xff000000, 5.0}, // failed
}};

/// Every state of the run and how many hinges are in it now.
void AddStates(const T_HINGE_MARKS& marks, std::vector<T_ENTRY>& out)
{
    for (std::size_t i = 0; i < kPushStateNames.size(); ++i) {
        if (!marks.occurs[i]) continue;
        const auto state = static_cast<PUSH_STATE>(i);
        const auto count = std::ranges::count(marks.hinges, state, &T_HINGE_MARK::state);
        out.push_back({QString::fromStdString(PushStateText(state) + ": " + std::to_string(count)),
                       [state](QPainter& p, QPointF m) { DrawHingeState(p, m, state); }});
    }
}

/// Every band, so that the legend keeps its lines, and how many member ends are in it.
void AddBands(const T_RATIO_BANDS& bands, std::vector<T_ENTRY>& out)
{
    for (std::size_t band = 0; band < kBands; ++band) {
        const std::string text = BandText(band) + ": " + std::to_string(bands.count[band]);
        out.push_back(LineEntry(QString::fromStdString(text), BandPen(band)));
    }
}

std::vector<T_ENTRY> Entries(const T_FRAME_PICTURE& picture, const T_FRAME_OPTIONS& options)
{
    const T_FRAME_SCENE& scene = *picture.scene;
    std::vector<T_ENTRY> out;
    const std::pair<ELEM_KIND, const char*> kinds[] = {
        {ELEM_KIND::Beam, "IDS_QM_UI_FRAME_BEAMS"},
        {ELEM_KIND::Truss, "IDS_QM_UI_FRAME_TRUSSES"},
        {ELEM_KIND::Link, "IDS_QM_UI_FRAME_LINKS"}};
    for (const auto& [kind, key] : kinds)
        if (HasKind(scene, kind)) out.push_back(LineEntry(Text(key), FramePen(kind, false, true)));
    if (picture.displacement && options.undeformed)
        out.push_back(
            LineEntry(Text("IDS_QM_UI_FRAME_BEFORE"), FramePen(ELEM_KIND::Beam, true, true)));
    if (options.supports)
        out.push_back({Text("IDS_QM_UI_FRAME_SUPPORTS"), [](QPainter& p, QPointF m) {
                           p.fillRect(QRectF(m.x() - 5, m.y() - 3, 10, 6), kSupportColor);
                       }});
    if (picture.bands) AddBands(*picture.bands, out);
    const auto chosen = std::ranges::count(picture.chosen, true);
    if (chosen > 0)
        out.push_back({QString::fromStdString(MMSGFunction::Format("IDS_QM_UI_FRAME_CHOSEN",
                                                                   {std::to_string(chosen)})),
                       [](QPainter& p, QPointF m) {
                           p.setPen(QPen(kChosenColor, 7.0, Qt::SolidLine, Qt::RoundCap));
                           p.drawLine(m - QPointF(8, 0), m + QPointF(8, 0));
                       }});
    for (T_ENTRY& entry : CResultPainter::Legend(picture.results))
        out.push_back(std::move(entry));
    if (options.hinges && picture.marks) AddStates(*picture.marks, out);
    const bool hinged = !picture.marks && std::ranges::any_of(scene.lines, [](const auto& l) {
        return l.hingeI || l.hingeJ;
    });
    if (options.hinges && hinged && !picture.results.HasValues())
        out.push_back({Text("IDS_QM_UI_FRAME_HINGES"), [](QPainter& p, QPointF m) {
                           p.setPen(Qt::NoPen);
                           p.setBrush(kHingeColor);
                           p.drawEllipse(m, 3.0, 3.0);
                           p.setBrush(Qt::NoBrush);
                       }});
    return out;
}

/// In lines from the bottom up; the height that they take.
double DrawEntries(QPainter* painter, const QRectF& rect, const std::vector<T_ENTRY>& entries)
{
    const QFontMetricsF metrics(CPlot::Font(kTextPx, false));
    const double line = metrics.height() + 4;
    std::vector<std::vector<std::pair<double, const T_ENTRY*>>> rows(1);
    double x = rect.left() + kPad;
    for (const T_ENTRY& e : entries) {
        const double w = kSwatch + 6 + metrics.horizontalAdvance(e.text) + 16;
        if (x + w > rect.right() && !rows.back().empty()) {
            rows.emplace_back();
            x = rect.left() + kPad;
        }
        rows.back().emplace_back(x, &e);
        x += w;
    }
    const double height = kPad / 2 + line * static_cast<double>(rows.size());
    if (!painter) return height;
    double y = rect.bottom() - height;
    for (const auto& row : rows) {
        for (const auto& [at, entry] : row) {
            entry->swatch(*painter, {at + kSwatch / 2, y + line / 2});
            painter->setPen(Qt::black);
            painter->drawText(QRectF(at + kSwatch + 6, y, rect.right() - at, line),
                              Qt::AlignLeft | Qt::AlignVCenter, entry->text);
        }
        y += line;
    }
    return height;
}

double DrawTitles(QPainter* painter, const QRectF& rect, const T_FRAME_PICTURE& picture)
{
    double y = rect.top() + kPad / 2;
    const auto line = [&](const std::string& text, double px, bool bold) {
        if (text.empty()) return;
        const QFont font = CPlot::Font(px, bold);
        const QFontMetricsF metrics(font);
        if (painter) {
            painter->setFont(font);
            painter->setPen(Qt::black);
            painter->drawText(
                QRectF(rect.left() + kPad, y, rect.width() - 2 * kPad, metrics.height()),
                Qt::AlignHCenter | Qt::AlignVCenter,
                metrics.elidedText(QString::fromStdString(text), Qt::ElideRight,
                                   rect.width() - 2 * kPad));
        }
        y += metrics.height() + 1;
    };
    line(picture.scene->title, 15.0, true);
    line(picture.subtitle, 12.5, false);
    if (!picture.note.empty()) { // in as many lines as it takes
        const QFont font = CPlot::Font(kTextPx, false);
        const QRectF room(rect.left() + kPad, y, std::max(rect.width() - 2 * kPad, 40.0), 200.0);
        const QString text = QString::fromStdString(picture.note);
        constexpr int kFlags = Qt::AlignHCenter | Qt::AlignTop | Qt::TextWordWrap;
        const QRectF taken = QFontMetricsF(font).boundingRect(room, kFlags, text);
        if (painter) {
            painter->setFont(font);
            painter->setPen(Qt::black);
            painter->drawText(room, kFlags, text);
        }
        y += taken.height() + 1;
    }
    if (painter) painter->setFont(CPlot::Font(kTextPx, false));
    return y - rect.top();
}

/// Bars by storey, top storey first, in one scale with the largest one named.
void DrawDrifts(QPainter& painter, const QRectF& rect, const std::vector<T_SCENE_DRIFT>& drifts)
{
    double largest = 0.0;
    for (const T_SCENE_DRIFT& d : drifts)
        largest = std::max(largest, std::fabs(d.drift));
    const QFontMetricsF metrics(painter.font());
    painter.setPen(Qt::black);
    painter.drawText(QRectF(rect.left(), rect.top(), rect.width(), metrics.height()), Qt::AlignLeft,
                     Text("IDS_QM_UI_FRAME_DRIFTS"));
    const double row =
        std::min((rect.height() - metrics.height() - kPad) / static_cast<double>(drifts.size()),
                 3.0 * metrics.height());
    double y = rect.top() + metrics.height() + kPad;
    for (auto d = drifts.rbegin(); d != drifts.rend(); ++d, y += row) {
        const double w = largest > 0 ? std::fabs(d->drift) / largest * rect.width() : 0.0;
        painter.fillRect(QRectF(rect.left(), y + row * 0.55, w, row * 0.35),
                         QColor(0x90, 0xca, 0xf9));
        const QString text =
            QString::fromStdString(d->name) + ": " + LocalNumberText(FormatText("%.3g", d->drift));
        painter.drawText(QRectF(rect.left(), y, rect.width(), row * 0.55),
                         Qt::AlignLeft | Qt::AlignBottom, text);
    }
}

} // namespace

QPen FramePen(ELEM_KIND kind, bool faint, bool thick)
{
    if (faint) return {QColor(0xb0, 0xb0, 0xb0), thick ? 1.0 : 0.0};
    const double width = thick ? 1.6 : 0.0;
    switch (kind) {
    case ELEM_KIND::Truss:
        return {QColor(0x00, 0x89, 0x7b), width};
    case ELEM_KIND::Link:
        return {QColor(0x8e, 0x24, 0xaa), width, Qt::DashLine};
    default:
        return {QColor(0x15, 0x4e, 0x8c), width};
    }
}

QPen BandPen(std::size_t band)
{
    // Up to 0.5, 0.8, 1 and 1.5; beyond; not checked.
    constexpr std::array<QRgb, kBands> kColors{0xff2e7d32, 0xff9e9d24, 0xfff9a825,
                                               0xffe64a19, 0xff7f0000, 0xff90a4ae};
    return {QColor(kColors[band]), 3.6, Qt::SolidLine, Qt::FlatCap};
}

QColor HingeStateColor(PUSH_STATE state)
{
    return QColor(kStateLooks[static_cast<std::size_t>(state)].color);
}

void DrawHingeState(QPainter& painter, QPointF at, PUSH_STATE state)
{
    const T_STATE_LOOK& look = kStateLooks[static_cast<std::size_t>(state)];
    const double r = look.radius;
    const QRectF box(at.x() - r, at.y() - r, 2 * r, 2 * r);
    const QColor color(look.color);
    if (state == PUSH_STATE::Failed) {
        painter.setPen(QPen(color, 2.2));
        painter.drawLine(box.topLeft(), box.bottomRight());
        painter.drawLine(box.topRight(), box.bottomLeft());
        return;
    }
    painter.setPen(QPen(color.darker(150), 0.8));
    painter.setBrush(color);
    if (state == PUSH_STATE::CtoD || state == PUSH_STATE::DtoE)
        painter.drawRect(box);
    else
        painter.drawEllipse(box);
    painter.setBrush(Qt::NoBrush);
}

QRectF DrawFrameLegend(QPainter* painter, const QRectF& rect, const T_FRAME_PICTURE& picture,
                       const T_FRAME_OPTIONS& options)
{
    const double above = DrawTitles(painter, rect, picture);
    const double below = DrawEntries(painter, rect, Entries(picture, options));
    QRectF area = rect.adjusted(0, above, 0, -below);
    if (options.drifts && !picture.drifts.empty() && area.width() > 2.5 * kDriftWidth) {
        const QRectF side(area.right() - kDriftWidth, area.top() + kPad, kDriftWidth - kPad,
                          area.height() - 2 * kPad);
        if (painter) DrawDrifts(*painter, side, picture.drifts);
        area.setRight(side.left() - kPad);
    }
    return area;
}
