#include "qm_rps/create/curvecase.h"

#include "qm_base/say.h"
#include "qm_base/textformat.h"
#include "qm_db/attrctrl.h"
#include "qm_db/recordfacts.h"
#include "qm_rps/create/buildingparts.h"
#include "qm_rps/create/createfault.h"
#include "qm_rps/create/headerunits.h"
#include "qm_rps/create/spectrumtext.h"
#include "qm_rps/create/spectrumvalues.h"

#include <algorithm>
#include <array>
#include <cmath>
#include <numbers>
#include <numeric>

namespace {

constexpr double kGravity = 9.80665; // m/s2, of a model that states none

bool AreAbove0(const std::vector<double>& values)
{
    return std::ranges::all_of(values, [](double v) { return v > 0.0 && std::isfinite(v); });
}

/// Mass in kg of one unit of what was given.
double KilogramsPer(MASS_GIVEN given, const T_UNITS& units)
{
    switch (given) {
    case MASS_GIVEN::Tonnes:
        return 1000.0;
    case MASS_GIVEN::Kilograms:
        return 1.0;
    case MASS_GIVEN::Weight:
        return SiFactor(units, kDimForce) / kGravity;
    case MASS_GIVEN::Model:
        break;
    }
    return SiFactor(units, kDimMass);
}

double Dot(const std::vector<double>& a, const std::vector<double>& b)
{
    return std::inner_product(a.begin(), a.end(), b.begin(), 0.0);
}

/// Makes the case in steps that may each refuse.
class CCurveCaseMaker {
public:
    CCurveCaseMaker(const T_CURVE_CASE& in, T_FINDING& fault) : m_in(in), m_fault(fault) {}

    int Make(T_MODEL_CONTENT& out, T_CURVE_FACTS& facts)
    {
        if (!ReadCurve(m_in.curve, m_facts.read, m_fault) ||
            !CheckHeaderUnits(m_facts.read, m_in.units, m_fault) || !TakeMasses() || !CheckTop() ||
            !TakeShape())
            return 0;
        CalcFactors();
        MakeModel();
        if (!AddEvaluations()) return 0;
        if (const std::string why = ModelFault(m_out.model); !why.empty())
            return CreateFault(m_fault, "spectrum", "IDS_QM_NEW_REFUSED", why);
        out = std::move(m_out);
        facts = std::move(m_facts);
        return 1;
    }

private:
    int TakeMasses()
    {
        const std::size_t storeys = m_in.heights.size();
        if (storeys == 0 || !AreAbove0(m_in.heights))
            return CreateFault(m_fault, "heights", "IDS_QM_NEW_HEIGHTS");
        if (m_in.masses.empty() || !AreAbove0(m_in.masses))
            return CreateFault(m_fault, "masses", "IDS_QM_NEW_MASSES");
        const std::size_t wanted = m_in.isTotal ? 1 : storeys;
        if (m_in.masses.size() != wanted)
            return CreateFault(m_fault, "masses",
                               m_in.isTotal ? "IDS_QM_NEW_ONE_TOTAL" : "IDS_QM_NEW_MASS_COUNT",
                               std::to_string(m_in.masses.size()), std::to_string(wanted));
        const double unit = KilogramsPer(m_in.massGiven, m_in.units);
        const double parts = m_in.isTotal ? static_cast<double>(storeys) : 1.0;
        for (std::size_t i = 0; i < storeys; ++i)
            m_kilograms.push_back(m_in.masses[m_in.isTotal ? 0 : i] * unit / parts);
        return 1;
    }

    std::vector<double> ShapeOfHeights() const
    {
        std::vector<double> shape(m_in.heights.size());
        std::partial_sum(m_in.heights.begin(), m_in.heights.end(), shape.begin());
        return shape;
    }

    /// Displacements at the first step; the top storey's may be the control node's.
    std::vector<double> ShapeOfCurve() const
    {
        const T_CURVE_POINT& first = m_facts.read.points[1];
        std::vector<double> shape = first.storeys;
        if (shape.size() + 1 == m_in.heights.size()) shape.push_back(first.displacement);
        return shape;
    }

    /// The control node is the top storey: a column of its own may differ by its rounding only.
    int CheckTop()
    {
        constexpr double kRounding = 0.01;
        for (const T_CURVE_POINT& point : m_facts.read.points) {
            if (point.storeys.size() != m_in.heights.size()) continue;
            const double d = point.displacement, top = point.storeys.back();
            if (!(std::fabs(d - top) <= kRounding * std::max(std::fabs(d), std::fabs(top))))
                return CreateFault(m_fault, "text", "IDS_QM_NEW_TOP_DIFFERS",
                                   std::to_string(point.line), ShortestText(d), ShortestText(top),
                                   std::to_string(point.storeys.size()));
        }
        return 1;
    }

    int TakeShape()
    {
        const std::size_t storeys = m_in.heights.size(), given = m_facts.read.storeys;
        if (given != 0 && given != storeys && given + 1 != storeys)
            return CreateFault(m_fault, "columns", "IDS_QM_NEW_STOREY_COLUMNS",
                               std::to_string(given), std::to_string(storeys));
        const bool isCurve = m_in.shape == SHAPE_GIVEN::Curve;
        if (isCurve && given == 0)
            return CreateFault(m_fault, "shape", "IDS_QM_NEW_NO_STOREY_COLUMNS");
        std::vector<double> shape = m_in.shape == SHAPE_GIVEN::Heights ? ShapeOfHeights()
                                    : isCurve                          ? ShapeOfCurve()
                                                                       : m_in.typedShape;
        if (shape.size() != storeys)
            return CreateFault(m_fault, "shape", "IDS_QM_NEW_SHAPE_COUNT",
                               std::to_string(shape.size()), std::to_string(storeys));
        const double top = shape.back();
        const auto finite = [](double v) { return std::isfinite(v); };
        if (!(top > 0.0) || !std::ranges::all_of(shape, finite) || !(Dot(shape, m_kilograms) > 0.0))
            return CreateFault(m_fault, "shape", "IDS_QM_NEW_SHAPE");
        for (double& value : shape)
            value /= top;
        m_facts.shape = std::move(shape);
        return 1;
    }

    /// Gamma, m* and the period of the first step: k* = V / d, both divided by Gamma.
    void CalcFactors()
    {
        const double si = SiFactor(m_in.units, kDimMass);
        for (const double mass : m_kilograms)
            m_facts.mass.push_back(mass / si);
        const double total = Dot(m_facts.mass, std::vector(m_facts.mass.size(), 1.0));
        std::vector<double> squares = m_facts.shape;
        for (double& value : squares)
            value *= value;
        const double S1 = Dot(m_facts.mass, m_facts.shape), S2 = Dot(m_facts.mass, squares);
        const T_CURVE_POINT& first = m_facts.read.points[1];
        m_facts.totalMass = total;
        m_facts.weight = total * FromSi(kGravity, m_in.units, kDimAccel);
        m_facts.gamma = S1 / S2;
        m_facts.substituteMass = S1;
        m_facts.massRatio = S1 * S1 / (S2 * total);
        m_facts.period = 2.0 * std::numbers::pi * std::sqrt(S1 * first.displacement / first.force);
        for (const T_CURVE_POINT& point : m_facts.read.points)
            m_facts.peakForce = std::max(m_facts.peakForce, point.force);
    }

    // ---- the model, in SI ----

    double Length(double value) const { return ToSi(value, m_in.units, kDimLength); }

    void AddStorey(std::size_t storey, double elevation)
    {
        T_MODEL& model = m_out.model;
        const int id = static_cast<int>(storey) + 2;
        T_NODE_D node{id, {0.0, 0.0, Length(elevation)}, {}, {0, 1, 0, 1, 0, 1}};
        node.mass = {m_kilograms[storey], 0.0, m_kilograms[storey]};
        model.nodes[id] = node;
        T_ELEM_D stick; // without section: it is drawn, not analysed
        stick.id = id - 1;
        stick.nodeI = id - 1;
        stick.nodeJ = id;
        model.elements[stick.id] = stick;
        model.storeys[id - 1] = {std::to_string(id - 1) + "F", Length(m_in.heights[storey]), {id}};
        model.modes[1].shape[id] = {m_facts.shape[storey]};
    }

    void MakeModel()
    {
        T_MODEL& model = m_out.model;
        model.styp.title = m_in.title;
        model.styp.units = m_in.units;
        model.nodes[1] = {1, {}, {}, {1, 1, 1, 1, 1, 1}};
        model.modes[1].period = m_facts.period;
        double elevation = 0.0;
        for (std::size_t i = 0; i < m_in.heights.size(); ++i)
            AddStorey(i, elevation += m_in.heights[i]);
        model.spectra[1] = m_in.spectrum;
        RecordToSi(model.spectra[1], m_in.units);
        T_POLC_D push;
        push.name = "PX";
        push.controlNode = static_cast<int>(m_in.heights.size()) + 1;
        push.direction = 1;
        push.patternKind = 3; // mode times storey mass: the factors follow from masses and shape
        push.modes = {1};
        model.pushovers[1] = push;
        m_out.results[1] = MakePushResult(Steps(push.controlNode));
    }

    /// Steps behind the origin. The load factor is the base shear over the weight.
    T_PUSH_DATA Steps(int control) const
    {
        T_PUSH_DATA data;
        const auto& points = m_facts.read.points;
        for (std::size_t i = 1; i < points.size(); ++i) {
            data.loadFactor.push_back(points[i].force / m_facts.weight);
            data.baseReaction.push_back(ToSi(points[i].force, m_in.units, kDimForce));
            for (std::size_t s = 0; s < points[i].storeys.size(); ++s)
                if (static_cast<int>(s) + 2 != control)
                    data.displacement[static_cast<int>(s) + 2].push_back(
                        Length(points[i].storeys[s]));
            data.displacement[control].push_back(Length(points[i].displacement));
        }
        return data;
    }

    int AddEvaluations()
    {
        std::vector<T_CURVE_METHOD> methods = m_in.methods;
        if (methods.empty()) methods.push_back(MethodOf(m_in.spectrum));
        T_TABLE<T_EVAL_D>& all = m_out.model.evaluations;
        for (const T_CURVE_METHOD& method : methods) {
            T_EVAL_D evaluation;
            evaluation.name = "PX " + CurveMethodText(method);
            evaluation.push = "PX";
            evaluation.method = method.method;
            evaluation.procedure = method.procedure;
            evaluation.spectrum = m_in.spectrum.name;
            const auto isSame = [&](const auto& e) { return e.second.name == evaluation.name; };
            if (std::ranges::any_of(all, isSame))
                return CreateFault(m_fault, "method", "IDS_QM_NEW_METHOD_TWICE",
                                   CurveMethodText(method));
            const auto faults = EvaluationFindings(evaluation, m_out.model);
            if (!faults.empty())
                return CreateFault(m_fault, "method", "IDS_QM_NEW_REFUSED", faults.front().text);
            all[static_cast<int>(all.size()) + 1] = evaluation;
        }
        return 1;
    }

    static T_CURVE_METHOD MethodOf(const T_SPFC_D& spectrum)
    {
        constexpr std::array<PUSH_METHOD, 5> kMethods{PUSH_METHOD::Atc40, PUSH_METHOD::Ec8Opcm,
                                                      PUSH_METHOD::Ec8Opcm, PUSH_METHOD::Ntc2018,
                                                      PUSH_METHOD::Atc40}; // by kind of spectrum
        return {kMethods.at(spectrum.data.index())};
    }

    const T_CURVE_CASE& m_in;
    T_FINDING& m_fault;
    std::vector<double> m_kilograms; // by storey
    T_CURVE_FACTS m_facts;
    T_MODEL_CONTENT m_out;
};

/// What no building has: wrong units, most likely.
bool LooksOdd(const T_CURVE_CASE& in, const T_CURVE_FACTS& facts)
{
    constexpr double kLeastRatio = 0.005, kMostRatio = 3.0; // base shear over weight
    constexpr double kMostDrift = 0.3;                      // displacement over height
    const double ratio = facts.peakForce / facts.weight;
    const double height = std::accumulate(in.heights.begin(), in.heights.end(), 0.0);
    return !(ratio >= kLeastRatio && ratio <= kMostRatio) || !IsUsualPeriod(facts.period) ||
           !(facts.read.points.back().displacement <= kMostDrift * height);
}

std::string WithUnit(double value, const std::string& unit)
{
    return FormatText("%.6g ", value) + unit;
}

} // namespace

std::string CurveMethodText(const T_CURVE_METHOD& method)
{
    const std::string name = MethodName(method.method);
    return method.procedure ? name + ":" + *method.procedure : name;
}

int ParseCurveMethod(const std::string& text, T_CURVE_METHOD& out)
{
    const std::size_t mark = text.find(':');
    const std::string name = text.substr(0, mark);
    for (int code = kFirstMethod; code < kFirstMethod + std::ssize(kMethodNames); ++code) {
        T_CURVE_METHOD method;
        method.method = static_cast<PUSH_METHOD>(code);
        if (name != MethodName(method.method)) continue;
        if (mark != text.npos && text.size() != mark + 2) return 0;
        if (mark != text.npos) method.procedure = text.back();
        out = method;
        return 1;
    }
    return 0;
}

int MakeCurveCase(const T_CURVE_CASE& in, T_MODEL_CONTENT& out, T_CURVE_FACTS& facts,
                  T_FINDING& fault)
{
    return CCurveCaseMaker(in, fault).Make(out, facts);
}

std::vector<std::string> CurveCaseNotes(const T_CURVE_CASE& in, const T_CURVE_FACTS& facts)
{
    std::vector<std::string> notes = CurveReadNotes(facts.read);
    const std::string force(NameOf(in.units.force)), length(NameOf(in.units.length));
    const double tonnes = facts.totalMass * SiFactor(in.units, kDimMass) / 1000.0;
    notes.push_back(Say("IDS_QM_NEW_TOTAL", WithUnit(facts.totalMass, force + " s2/" + length),
                        WithUnit(tonnes, "t"), WithUnit(facts.weight, force)));
    notes.push_back(Say("IDS_QM_NEW_FACTORS", FormatText("%.4f", facts.gamma),
                        WithUnit(facts.substituteMass, force + " s2/" + length),
                        FormatText("%.4f", facts.massRatio)));
    notes.push_back(Say("IDS_QM_NEW_PERIOD", FormatText("%.4g", facts.period)));
    notes.push_back(Say("IDS_QM_NEW_SPECTRUM_IS", SpectrumText(in.spectrum)));
    const double ratio = facts.peakForce / facts.weight;
    notes.push_back(
        Say("IDS_QM_NEW_PEAK", WithUnit(facts.peakForce, force), FormatText("%.4g", ratio)));
    if (LooksOdd(in, facts)) notes.push_back(Say("IDS_QM_NEW_ODD"));
    constexpr double kLeastMassRatio = 0.5;
    if (facts.massRatio < kLeastMassRatio) notes.push_back(Say("IDS_QM_NEW_ODD_SHAPE"));
    if (const std::string doubt = SpectrumDoubt(in.spectrum); !doubt.empty())
        notes.push_back(doubt);
    if (facts.read.storeys == 0 && in.heights.size() > 1)
        notes.push_back(Say("IDS_QM_NEW_NO_DRIFTS"));
    return notes;
}
