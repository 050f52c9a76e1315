#include "qm_rps/factors/tuning/ulfdeck.h"

#include "qm_base/msgfunction.h"
#include "qm_rps/factors/ulfstageproblem.h"

#include <algorithm>
#include <cmath>

namespace {

constexpr int kDisplacementKind = 1, kTrussKind = 3, kBeamKind = 4;
constexpr int kPlaces = 5; // of a beam, I-end to J-end
constexpr int kMomentY = 5, kMomentZ = 6;
constexpr double kMostSlope = 0.1; // of a deck: rise over length

/// All quantities, in the order of T_ULF_DECK.
std::vector<T_OPT_QUANTITY> AllOf(const T_ULF_DECK& deck)
{
    std::vector<T_OPT_QUANTITY> all;
    for (const auto* stations : {&deck.displacements, &deck.moments})
        for (const T_DECK_STATION& station : *stations)
            all.push_back(station.what);
    all.insert(all.end(), deck.stays.begin(), deck.stays.end());
    return all;
}

std::array<std::size_t, 3> CountsOf(const T_ULF_DECK& deck)
{
    return {deck.displacements.size(), deck.moments.size(), deck.stays.size()};
}

/// A beam of the deck with its ends along the horizontal.
struct T_SPAN {
    const T_ELEM_D* beam = nullptr;
    double I = 0.0, J = 0.0; // m
};

/// The horizontal axis along which the deck is longest.
std::size_t LongAxis(const T_MODEL& model, const std::vector<const T_ELEM_D*>& beams,
                     std::size_t vertical)
{
    const auto length = [&](std::size_t axis) {
        double lo = 0.0, hi = 0.0;
        bool first = true;
        for (const T_ELEM_D* beam : beams)
            for (const int node : {beam->nodeI, beam->nodeJ}) {
                const double x = model.nodes.at(node).xyz[axis];
                lo = first ? x : std::min(lo, x);
                hi = first ? x : std::max(hi, x);
                first = false;
            }
        return hi - lo;
    };
    const std::size_t other = vertical == 2 ? 1 : 2;
    return length(other) > length(0) ? other : 0;
}

bool IsLevel(const T_MODEL& model, const T_ELEM_D& e, std::size_t vertical)
{
    if (e.kind != ELEM_KIND::Beam || !model.nodes.contains(e.nodeI) ||
        !model.nodes.contains(e.nodeJ))
        return false;
    const auto &i = model.nodes.at(e.nodeI).xyz, &j = model.nodes.at(e.nodeJ).xyz;
    const double length = std::hypot(j[0] - i[0], j[1] - i[1], j[2] - i[2]);
    return length > 0.0 && std::fabs(j[vertical] - i[vertical]) <= kMostSlope * length;
}

std::vector<T_SPAN> SpansOf(const T_MODEL& model, std::size_t vertical)
{
    std::vector<const T_ELEM_D*> beams;
    for (const auto& [id, element] : model.elements)
        if (IsLevel(model, element, vertical)) beams.push_back(&element);
    const std::size_t axis = LongAxis(model, beams, vertical);
    std::vector<T_SPAN> spans;
    for (const T_ELEM_D* beam : beams)
        spans.push_back(
            {beam, model.nodes.at(beam->nodeI).xyz[axis], model.nodes.at(beam->nodeJ).xyz[axis]});
    std::ranges::stable_sort(spans, {}, [](const T_SPAN& s) { return std::min(s.I, s.J); });
    return spans;
}

} // namespace

T_ULF_DECK DeckOf(const T_MODEL& model, const T_UNITS& units, std::span<const int> stays)
{
    const bool isXY = model.styp.plane == MODEL_PLANE::XY;
    const std::size_t vertical = isXY ? 1 : 2;
    const auto shown = [&units](double m) { return FromSi(m, units, kDimLength); };
    T_ULF_DECK deck;
    std::map<int, double> nodes; // by id, where they are
    for (const T_SPAN& span : SpansOf(model, vertical)) {
        nodes[span.beam->nodeI] = span.I;
        nodes[span.beam->nodeJ] = span.J;
        std::vector<T_DECK_STATION> places;
        for (int p = 1; p <= kPlaces; ++p)
            places.push_back({shown(std::lerp(span.I, span.J, (p - 1.0) / (kPlaces - 1.0))),
                              {kBeamKind, span.beam->id, p, isXY ? kMomentZ : kMomentY}});
        if (span.I > span.J) std::ranges::reverse(places);
        deck.moments.insert(deck.moments.end(), places.begin(), places.end());
    }
    for (const auto& [node, at] : nodes)
        deck.displacements.push_back(
            {shown(at), {kDisplacementKind, node, 0, static_cast<int>(vertical) + 1}});
    std::ranges::stable_sort(deck.displacements, {}, &T_DECK_STATION::along);
    for (const int id : stays) {
        const auto element = model.elements.find(id);
        const bool beam =
            element != model.elements.end() && element->second.kind == ELEM_KIND::Beam;
        deck.stays.push_back({beam ? kBeamKind : kTrussKind, id, beam ? 1 : 0, 1});
    }
    return deck;
}

int CUlfDeckValues::Read(const T_ULF_DECK& deck, const T_ULF_RESULT& result, IUlfResponse& source)
{
    const std::vector<T_OPT_QUANTITY> what = AllOf(deck);
    std::vector<T_OPT_ITEM> items;
    for (const T_ULF_CASE& loadCase : result.cases)
        items.push_back(UlfItemRecord(loadCase));
    std::vector<double> read(what.size() * items.size());
    if (!source.Read(items, what, read)) return 0;
    m_counts = CountsOf(deck);
    m_base.assign(what.size(), 0.0);
    m_units.clear();
    for (std::size_t i = 0; i < items.size(); ++i) {
        const bool unknown = result.cases[i].unknown;
        if (unknown) m_units.emplace_back(what.size());
        for (std::size_t q = 0; q < what.size(); ++q) {
            const double value = read[q * items.size() + i];
            if (unknown)
                m_units.back()[q] = value;
            else
                m_base[q] += result.factors[i] * value;
        }
    }
    return 1;
}

int CUlfDeckValues::Read(const T_ULF_DECK& deck, const T_ULSI_D& item, const T_MODEL& model,
                         IUlfStageResults& results)
{
    if (model.stages.empty()) return 0;
    const int last = model.stages.rbegin()->first;
    const std::vector<T_OPT_QUANTITY> what = AllOf(deck);
    const auto add = [&](std::vector<double>& to) {
        for (std::size_t q = 0; q < what.size(); ++q) {
            double value = 0.0;
            if (!results.ReadOne(what[q], value)) return false;
            to[q] += value;
        }
        return true;
    };
    std::vector<double> base(what.size());
    std::vector<std::vector<double>> units;
    if (!results.SelectSum(zql::lib::MMSGFunction::GetValue("IDS_DB_SGLD_SUM"), last,
                           kStageLastStep) ||
        !add(base))
        return 0;
    for (const T_ULSI_ROW& row : item.rows) {
        if (!row.unknown) continue;
        std::vector<int> loads = LoadsScaledBy(model, row);
        if (loads.empty()) loads.push_back(row.loadCase);
        std::vector<double>& unit = units.emplace_back(what.size());
        for (const int load : loads)
            if (!results.SelectCase(load, last, kStageLastStep) || !add(unit)) return 0;
        for (std::size_t q = 0; q < what.size(); ++q)
            base[q] -= unit[q]; // the analysed sum holds it once
    }
    m_counts = CountsOf(deck);
    m_base = std::move(base);
    m_units = std::move(units);
    return 1;
}

CUlfDeckValues::T_VALUES CUlfDeckValues::At(std::span<const double> factors) const
{
    std::vector<double> all = m_base;
    for (std::size_t u = 0; u < std::min(factors.size(), m_units.size()); ++u)
        for (std::size_t q = 0; q < all.size(); ++q)
            all[q] += factors[u] * m_units[u][q];
    if (all.empty()) return {};
    const auto first = all.begin(), moments = first + static_cast<std::ptrdiff_t>(m_counts[0]),
               stays = moments + static_cast<std::ptrdiff_t>(m_counts[1]);
    return {{first, moments}, {moments, stays}, {stays, all.end()}};
}
