// What lies at a place of the picture that was drawn last.
#include "qm_ui/frame/framepainter.h"

#include <algorithm>

namespace {

constexpr double kHit = 10.0; // px

double Distance(QPointF place, QPointF a, QPointF b)
{
    const QPointF along = b - a, from = place - a;
    const double square = QPointF::dotProduct(along, along);
    const double t =
        square > 0.0 ? std::clamp(QPointF::dotProduct(from, along) / square, 0.0, 1.0) : 0.0;
    return QLineF(place, a + t * along).length();
}

} // namespace

long CFramePainter::NodeAt(const T_FRAME_SCENE& scene, QPointF place) const
{
    long nearest = -1;
    double distance = kHit;
    for (std::size_t n = 0; n < std::min(m_moved.size(), scene.nodes.size()); ++n) {
        const double d = QLineF(place, m_moved[n]).length();
        if (d >= distance || !scene.nodes[n].shown) continue;
        distance = d;
        nearest = static_cast<long>(n);
    }
    return nearest;
}

long CFramePainter::HingeAt(QPointF place) const
{
    long nearest = -1;
    double distance = kHit;
    for (auto m = m_order.rbegin(); m != m_order.rend(); ++m) {
        if (*m >= m_hinges.size()) continue;
        const double d = QLineF(place, m_hinges[*m]).length();
        if (d >= distance) continue;
        distance = d;
        nearest = static_cast<long>(*m);
    }
    return nearest;
}

long CFramePainter::LineAt(const T_FRAME_SCENE& scene, QPointF place) const
{
    long nearest = -1;
    double distance = kHit;
    for (std::size_t l = 0; l < scene.lines.size(); ++l) {
        double d = kHit;
        if (l + 1 < m_bentAt.size())
            for (std::size_t k = m_bentAt[l]; k + 1 < m_bentAt[l + 1]; ++k)
                d = std::min(d, Distance(place, m_bent[k], m_bent[k + 1]));
        else
            d = Distance(place, m_moved.at(scene.lines[l].i), m_moved.at(scene.lines[l].j));
        if (d >= distance) continue;
        distance = d;
        nearest = static_cast<long>(l);
    }
    return nearest;
}

std::vector<std::size_t> CFramePainter::LinesIn(const T_FRAME_SCENE& scene, const QRectF& box) const
{
    std::vector<std::size_t> lines;
    for (std::size_t l = 0; l < scene.lines.size(); ++l)
        if (box.contains(m_moved.at(scene.lines[l].i)) &&
            box.contains(m_moved.at(scene.lines[l].j)))
            lines.push_back(l);
    return lines;
}

std::vector<std::size_t> CFramePainter::NodesIn(const T_FRAME_SCENE& scene, const QRectF& box) const
{
    std::vector<std::size_t> nodes;
    for (std::size_t n = 0; n < scene.nodes.size(); ++n)
        if (scene.nodes[n].shown && box.contains(m_moved.at(n))) nodes.push_back(n);
    return nodes;
}
