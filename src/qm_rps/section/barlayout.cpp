#include "qm_rps/section/barlayout.h"

#include "qm_base/say.h"
#include "qm_base/textformat.h"

#include <numbers>

namespace {

constexpr int kMostBars = 1000;
constexpr double kRounding = 1e-9; // of a diameter

int Refuse(std::string& reason, std::string words)
{
    reason = std::move(words);
    return 0;
}

/// The bars of a rectangle by their places on the line through the corners.
class CRectangle {
public:
    CRectangle(const T_SECT_D& s, double inset, double diameter)
        : m_z(0.5 * s.size[0] - inset), m_y(0.5 * s.size[1] - inset), m_area(BarArea(diameter))
    {
    }
    bool HasRoom() const { return m_y > 0.0 && m_z > 0.0; }
    void Corners()
    {
        for (const double z : {m_z, -m_z})
            for (const double y : {-m_y, m_y})
                bars.push_back({y, z, m_area});
    }
    /// A face parallel to y (top, bottom) or to z.
    void Face(bool alongY, double side, int count)
    {
        for (int i = 1; i <= count; ++i) {
            const double along = -1.0 + 2.0 * i / (count + 1);
            bars.push_back(
                {alongY ? along * m_y : side * m_y, alongY ? side * m_z : along * m_z, m_area});
        }
    }
    void Around(int count)
    {
        const int half = (count - 4) / 2; // of one pair of neighbouring faces
        int alongY = 0;
        for (int i = 1; i <= half; ++i)
            if (Unevenness(i, half) < Unevenness(alongY, half)) alongY = i;
        Corners();
        for (const double side : {1.0, -1.0}) {
            Face(true, side, alongY);
            Face(false, side, half - alongY);
        }
    }
    std::vector<T_REBAR> bars;

private:
    double Unevenness(int alongY, int half) const
    {
        return std::fabs(m_y / (alongY + 1) - m_z / (half - alongY + 1));
    }
    double m_z, m_y, m_area;
};

std::vector<T_REBAR> Ring(double radius, int count, double area)
{
    std::vector<T_REBAR> bars;
    for (int i = 0; i < count; ++i) {
        const double angle = 2.0 * std::numbers::pi * i / count;
        bars.push_back({radius * std::sin(angle), radius * std::cos(angle), area});
    }
    return bars;
}

bool IsCountSound(const T_SECT_D& section, const T_BAR_GROUP& group)
{
    if (group.place == BAR_PLACE::Corners) return true;
    if (group.count > kMostBars) return false;
    if (group.place != BAR_PLACE::Around) return group.count >= 1;
    if (section.shape == SECT_SHAPE::Circle) return group.count >= 3;
    return group.count >= 4 && group.count % 2 == 0;
}

/// The first bar that another one takes the place of.
const T_REBAR* Taken(const std::vector<T_REBAR>& placed, const std::vector<T_REBAR>& bars)
{
    const auto apart = [](const T_REBAR& a, const T_REBAR& b) {
        const double least = 0.5 * (BarDiameter(a) + BarDiameter(b));
        return std::hypot(a.y - b.y, a.z - b.z) >= least * (1.0 - kRounding);
    };
    for (std::size_t i = 0; i < bars.size(); ++i) {
        const auto free = [&](const T_REBAR& other) { return apart(bars[i], other); };
        if (!std::ranges::all_of(placed, free) ||
            !std::all_of(bars.begin(), bars.begin() + static_cast<std::ptrdiff_t>(i), free))
            return &bars[i];
    }
    return nullptr;
}

/// Empty: they have no room.
std::vector<T_REBAR> BarsOf(const T_SECT_D& section, const T_BAR_GROUP& group)
{
    const T_SECT_DETAIL& detail = *section.detailing;
    const double inset = detail.cover + detail.stirrupDiameter + 0.5 * group.diameter;
    if (section.shape == SECT_SHAPE::Circle) {
        const double radius = 0.5 * section.size[0] - inset;
        return radius > 0.0 ? Ring(radius, group.count, BarArea(group.diameter))
                            : std::vector<T_REBAR>();
    }
    CRectangle r(section, inset, group.diameter);
    if (!r.HasRoom()) return {};
    switch (group.place) {
    case BAR_PLACE::Corners:
        r.Corners();
        break;
    case BAR_PLACE::Top:
    case BAR_PLACE::Bottom:
        r.Face(true, group.place == BAR_PLACE::Top ? 1.0 : -1.0, group.count);
        break;
    case BAR_PLACE::Right:
    case BAR_PLACE::Left:
        r.Face(false, group.place == BAR_PLACE::Right ? 1.0 : -1.0, group.count);
        break;
    case BAR_PLACE::Around:
        r.Around(group.count);
        break;
    }
    return std::move(r.bars);
}

} // namespace

double BarDiameter(const T_REBAR& bar)
{
    return bar.area > 0.0 ? 2.0 * std::sqrt(bar.area / std::numbers::pi) : 0.0;
}

double BarArea(double diameter)
{
    return std::numbers::pi / 4.0 * diameter * diameter;
}

int LayBars(const T_SECT_D& section, const T_BAR_GROUP& group, std::vector<T_REBAR>& out,
            std::string& reason)
{
    const bool circle = section.shape == SECT_SHAPE::Circle;
    if (!circle && section.shape != SECT_SHAPE::Rectangle)
        return Refuse(reason, Say("IDS_QM_BARS_SHAPE"));
    if (circle && group.place != BAR_PLACE::Around)
        return Refuse(reason, Say("IDS_QM_BARS_CIRCLE"));
    if (!section.detailing) return Refuse(reason, Say("IDS_QM_BARS_DETAILING"));
    if (!(group.diameter > 0.0) || !std::isfinite(group.diameter))
        return Refuse(reason, Say("IDS_QM_BARS_DIAMETER"));
    if (!IsCountSound(section, group))
        return Refuse(reason, Say(group.place != BAR_PLACE::Around ? "IDS_QM_BARS_COUNT"
                                  : circle                         ? "IDS_QM_BARS_ROUND"
                                                                   : "IDS_QM_BARS_EVEN"));
    std::vector<T_REBAR> bars = BarsOf(section, group);
    if (bars.empty()) return Refuse(reason, Say("IDS_QM_BARS_ROOM"));
    if (const T_REBAR* bar = Taken(section.bars, bars))
        return Refuse(reason, Say("IDS_QM_BARS_TAKEN", FormatText("%.4g", bar->y + 0.0),
                                  FormatText("%.4g", bar->z + 0.0)));
    out = std::move(bars);
    return 1;
}
