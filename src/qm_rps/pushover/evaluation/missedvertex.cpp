#include "qm_rps/pushover/evaluation/missedvertex.h"

#include "qm_rps/pushover/adrsformulas.h"

#include <algorithm>
#include <cmath>
#include <limits>

namespace {

struct T_PLACE {
    double d = 0.0, V = 0.0;
};

/// Of a point from the piece a-b.
double Distance(const T_PLACE& p, const T_PLACE& a, const T_PLACE& b)
{
    const double x = b.d - a.d, y = b.V - a.V, square = x * x + y * y;
    const double along = (p.d - a.d) * x + (p.V - a.V) * y;
    const double t = square > 0.0 ? std::clamp(along / square, 0.0, 1.0) : 0.0;
    return std::hypot(p.d - a.d - t * x, p.V - a.V - t * y);
}

double Largest(const std::vector<T_PLACE>& places, double T_PLACE::*member)
{
    double most = 0.0;
    for (const T_PLACE& p : places)
        most = std::max(most, std::fabs(p.*member));
    return most;
}

} // namespace

int FindMissedVertex(IPushRun& run, int controlNode, T_MISSED_VERTEX& out)
{
    std::vector<T_RUN_STEP> steps;
    std::vector<T_RUN_EVENT> events;
    std::vector<double> moved;
    if (!run.ReadSteps(steps) || !run.ReadEvents(events) ||
        !run.ReadDisplacements(controlNode, moved) || steps.empty() || moved.empty())
        return 0;
    const double start = steps.front().displacement - moved.front();
    const double reaction = run.Head().startReaction;
    std::vector<T_PLACE> line{{}}, vertices; // line: from where the push starts
    for (const T_RUN_STEP& s : steps)
        line.push_back({s.displacement - start, s.baseReaction - reaction});
    double furthest = 0.0; // what steps back from there is the inside of a drop, not of the curve
    for (const T_RUN_EVENT& e : events) {
        const T_PLACE vertex{e.displacement - start, e.baseReaction - reaction};
        if (e.stage != steps.back().stage || std::fabs(vertex.d) < furthest * (1.0 - kSameOnCurve))
            continue;
        furthest = std::fabs(vertex.d);
        vertices.push_back(vertex);
    }
    const double d = Largest(line, &T_PLACE::d), V = Largest(line, &T_PLACE::V);
    if (!(d > 0.0) || !(V > 0.0)) return 0;
    const auto scaled = [=](const T_PLACE& p) { return T_PLACE{p.d / d, p.V / V}; };
    T_MISSED_VERTEX worst;
    worst.steps = steps.size();
    for (const T_PLACE& vertex : vertices) {
        double nearest = std::numeric_limits<double>::max();
        for (std::size_t i = 1; i < line.size(); ++i)
            nearest =
                std::min(nearest, Distance(scaled(vertex), scaled(line[i - 1]), scaled(line[i])));
        if (!(nearest > worst.share)) continue;
        worst.share = nearest;
        worst.displacement = vertex.d;
        worst.baseReaction = vertex.V;
    }
    out = worst;
    return 1;
}
