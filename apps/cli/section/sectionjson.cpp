#include "section/sectioncommands.h"
#include "json/tracejson.h"

#include <algorithm>
#include <cmath>
#include <numbers>

namespace {

using namespace solver;
constexpr T_DIM kDimCurvature{0, -1};
constexpr std::array<const char*, 4> kFibres{"none", "concrete", "steel", "bar"};
constexpr std::array<const char*, 4> kEnds{"strain limit", "moment loss", "no equilibrium",
                                           "as asked"};

/// Writes the results in units of the file; strains are ratios.
class CWriter {
public:
    CWriter(CJsonText& w, const T_UNITS& units) : m_w(w), m_units(units) {}

    void Answer(const T_SECTION_ANSWER& a);

private:
    double In(double si, T_DIM dim) const { return FromSi(si, m_units, dim) + 0.0; }
    static double Degrees(double direction) { return direction * 180.0 / std::numbers::pi; }

    void Forces(double axial, double My, double Mz)
    {
        m_w.Member("N", In(axial, kDimForce)).Member("My", In(My, kDimMoment));
        m_w.Member("Mz", In(Mz, kDimMoment));
    }
    void Fibre(const char* name, const T_FIBRE& fibre)
    {
        m_w.Key(name).Object(kJsonOneLine);
        m_w.Member("of", kFibres[static_cast<std::size_t>(fibre.kind)]);
        if (fibre.kind == FIBRE_KIND::Bar) m_w.Member("bar", fibre.index + 1);
        if (fibre.kind != FIBRE_KIND::None) m_w.Member("tension", fibre.tension);
        m_w.End();
    }
    /// Residual: see T_SECTION_STATE.
    void State(const T_SECTION_STATE& s)
    {
        Forces(s.axial, s.My, s.Mz);
        if (s.depth > 0.0)
            m_w.Member("neutral_axis_depth", In(s.depth, kDimLength));
        else
            m_w.Key("neutral_axis_depth").Value(nullptr);
        if (s.residual) {
            m_w.Key("strain_plane").Object(kJsonOneLine);
            m_w.Member("axial", s.plane.axial);
            m_w.Member("over_z", In(s.plane.overZ, kDimCurvature));
            m_w.Member("over_y", In(s.plane.overY, kDimCurvature));
            m_w.End();
            m_w.Member("strain_compressed_edge", s.top).Member("strain_other_edge", s.bottom);
        }
        Fibre("governs", s.governs);
        m_w.Member("residual", s.residual);
    }
    void Capacities(const T_SECTION_ANSWER& a);
    void Curvatures(const T_SECTION_ANSWER& a);
    void Interactions(const T_SECTION_ANSWER& a);
    void Contours(const T_SECTION_ANSWER& a);
    void Points(const std::vector<T_CAPACITY>& points);

    CJsonText& m_w;
    T_UNITS m_units;
};

void CWriter::Capacities(const T_SECTION_ANSWER& a)
{
    m_w.Key("capacities").List();
    for (const T_SECTION_CAPACITY_AT& c : a.capacities) {
        m_w.Object();
        m_w.Member("direction", Degrees(c.direction));
        State(c.at);
        m_w.End();
    }
    m_w.End();
}

void CWriter::Curvatures(const T_SECTION_ANSWER& a)
{
    m_w.Key("curves").List();
    for (const T_SECTION_CURVATURE& c : a.curvatures) {
        m_w.Object();
        m_w.Member("direction", Degrees(c.direction)).Member("N", In(c.axial, kDimForce));
        m_w.Member("end", kEnds[static_cast<std::size_t>(c.curve.end)]);
        const auto state = [&](const char* name, std::size_t at, const T_SECTION_STATE& s) {
            m_w.Key(name).Object();
            m_w.Member("curvature", In(c.curve.points[at].curvature, kDimCurvature));
            m_w.Member("moment", In(c.curve.points[at].moment, kDimMoment));
            State(s);
            m_w.End();
        };
        if (c.curve.yields.kind != FIBRE_KIND::None) state("yield", c.curve.yield, c.yield);
        state("ultimate", c.curve.points.size() - 1, c.ultimate);
        if (c.curve.idealised) {
            m_w.Key("idealised").Object(kJsonOneLine);
            m_w.Member("curvature", In(c.curve.idealCurvature, kDimCurvature));
            m_w.Member("moment", In(c.curve.idealMoment, kDimMoment));
            m_w.Member("ductility", c.curve.points.back().curvature / c.curve.idealCurvature);
            m_w.End();
        }
        m_w.Key("points").List();
        for (const T_CURVATURE_POINT& p : c.curve.points) {
            m_w.Object(kJsonOneLine);
            m_w.Member("curvature", In(p.curvature, kDimCurvature));
            m_w.Member("moment", In(p.moment, kDimMoment));
            m_w.Member("My", In(p.My, kDimMoment)).Member("Mz", In(p.Mz, kDimMoment));
            m_w.End();
        }
        m_w.End();
        m_w.End();
    }
    m_w.End();
}

void CWriter::Points(const std::vector<T_CAPACITY>& points)
{
    m_w.Key("points").List();
    for (const T_CAPACITY& p : points) {
        m_w.Object(kJsonOneLine);
        Forces(p.axial, p.My, p.Mz);
        m_w.End();
    }
    m_w.End();
}

void CWriter::Interactions(const T_SECTION_ANSWER& a)
{
    m_w.Key("curves").List();
    for (const T_SECTION_INTERACTION& c : a.interactions) {
        m_w.Object();
        m_w.Member("direction", Degrees(c.direction));
        const std::pair<const char*, long> marks[] = {{"largest_moment", c.curve.largest},
                                                      {"balanced", c.curve.balanced},
                                                      {"bending", c.curve.bending}};
        for (const auto& [name, at] : marks) // places in points, from 0
            m_w.Member(name, at < 0 ? std::nullopt : std::optional(static_cast<std::size_t>(at)));
        Points(c.curve.points);
        m_w.End();
    }
    m_w.End();
}

void CWriter::Contours(const T_SECTION_ANSWER& a)
{
    m_w.Key("contours").List();
    for (const T_SECTION_CONTOUR& c : a.contours) {
        m_w.Object();
        m_w.Member("N", In(c.axial, kDimForce));
        Points(c.points);
        m_w.End();
    }
    m_w.End();
}

void CWriter::Answer(const T_SECTION_ANSWER& a)
{
    m_w.Object();
    m_w.Member("section", a.section).Member("material", a.material);
    m_w.Member("values", kSectionValueNames[static_cast<std::size_t>(a.options.values)]);
    if (a.ofConcrete) {
        m_w.Member("law", kSectionLawNames[static_cast<std::size_t>(a.options.law)]);
        m_w.Member("confined", kSectionCoreNames[static_cast<std::size_t>(a.options.core)]);
    }
    m_w.Member("direction_of", a.ofMoment ? "moment" : "bending");
    if (a.compression > 0.0) m_w.Member("compression_strength", In(a.compression, kDimForce));
    if (a.compression > 0.0) m_w.Member("tension_strength", In(a.tension, kDimForce));
    WriteTrace(m_w, "trace", a.trace, m_units);
    WriteWarnings(m_w, a.warnings);
    switch (a.task) {
    case SECTION_TASK::Capacity:
        Capacities(a);
        break;
    case SECTION_TASK::Curvature:
        Curvatures(a);
        break;
    case SECTION_TASK::Interaction:
        Interactions(a);
        break;
    case SECTION_TASK::Surface:
        Contours(a);
        break;
    }
    m_w.End();
}

} // namespace

std::string SectionJson(const std::vector<T_SECTION_ANSWER>& answers, const T_UNITS& units)
{
    CJsonText w(JSON_REALS::Shortest);
    w.Object();
    w.Key("units").Object(kJsonOneLine);
    w.Member("force", NameOf(units.force)).Member("length", NameOf(units.length));
    w.End();
    w.Member("task", kSectionTaskNames[static_cast<std::size_t>(answers.front().task)]);
    w.Key("sections").List();
    for (const T_SECTION_ANSWER& answer : answers)
        CWriter(w, units).Answer(answer);
    w.End();
    w.End();
    return w.Text();
}
