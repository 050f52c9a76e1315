#include "qm_rps/push/pushlaws.h"

#include "qm_base/say.h"
#include "qm_rps/hinge/curvefindings.h"
#include "qm_rps/hinge/hingechoices.h"
#include "qm_rps/hinge/hingegenerator.h"
#include "qm_rps/hinge/hingetable.h"
#include "qm_rps/hinge/hingetypefindings.h"
#include "qm_rps/hinge/pageyield.h"
#include "qm_rps/push/law/lawaxial.h"
#include "qm_rps/push/law/lawplaces.h"
#include "qm_rps/push/law/lawsurface.h"

#include <algorithm>
#include <cmath>
#include <set>
#include <tuple>
#include <utility>

namespace {

constexpr T_UNITS kSi{FORCE_UNIT::N, LENGTH_UNIT::m};
constexpr T_DIRS6 kNoRelease{};

bool Acts(int type, const std::vector<int>& types)
{
    return types.empty() || std::ranges::find(types, type) != types.end();
}

/// An element of the kind that a type is for; walls are beams.
bool KindFits(HINGE_ELEMENT type, ELEM_KIND kind)
{
    constexpr std::array<ELEM_KIND, 5> kinds{ELEM_KIND::Beam, ELEM_KIND::Beam, ELEM_KIND::Truss,
                                             ELEM_KIND::Link, ELEM_KIND::Spring};
    return kinds[static_cast<std::size_t>(type)] == kind;
}

class CBuilder {
public:
    CBuilder(CDBDoc& doc, std::span<const int> elements, const T_PUSH_LAW_OPTIONS& options)
        : m_doc(doc), m_model(doc.Data().Model()), m_elements(elements), m_options(options),
          m_sources(m_model.sections, m_model.materials, kSi), m_generator(doc)
    {
        FindLoaded();
    }

    int Build(T_PUSH_HINGES& out, std::string& error)
    {
        const T_TABLE<T_PHGE_D> current = HingesOf(m_doc); // in current units
        for (const auto& [key, hinge] : m_model.hinges)
            if (Acts(hinge.hingeType, m_options.types) && !AddHinge(hinge, current.at(key))) {
                error = m_error;
                return 0;
            }
        Sort();
        out = std::move(m_out);
        return 1;
    }

private:
    /// One component of a hinge at one place.
    struct T_PAGE {
        const T_PHGE_D& hinge;
        const T_PHGT_D& type;
        const T_ELEM_D& element;
        std::size_t index = 0; // of the element
        HINGE_COMPONENT component = HINGE_COMPONENT::Fx;
        double memberLength = 0.0;
    };

    int Fail(int element, const std::string& type, const std::string& place,
             const std::string& reason)
    {
        m_error = Say("IDS_QM_PUSH_HINGE", std::to_string(element), type) +
                  (place.empty() ? "" : ", " + place) + ": " + reason;
        return 0;
    }
    int Fail(const T_PAGE& page, const std::string& reason, const std::string& end = {})
    {
        const std::string name = kComponentNames[static_cast<std::size_t>(page.component)];
        return Fail(page.hinge.element, page.type.name, end.empty() ? name : name + " " + end,
                    reason);
    }

    int AddHinge(const T_PHGE_D& hinge, const T_PHGE_D& current)
    {
        const auto type = m_model.hingeTypes.find(hinge.hingeType);
        const auto element = m_model.elements.find(hinge.element);
        if (type == m_model.hingeTypes.end())
            return Fail(hinge.element, std::to_string(hinge.hingeType), "",
                        Say("IDS_QM_PUSH_HINGE_NO_TYPE"));
        const T_PHGT_D& t = type->second;
        if (element == m_model.elements.end())
            return Fail(hinge.element, t.name, "", Say("IDS_CMD_IEHP_NO_ELEM"));
        const T_ELEM_D& e = element->second;
        if (!KindFits(t.element, e.kind))
            return Fail(e.id, t.name, "", Say("IDS_QM_PUSH_HINGE_KIND", ElementText(t.element)));
        if (const std::string stale = m_generator.StaleText(current); !stale.empty())
            return Fail(e.id, t.name, "",
                        Say("IDS_QM_HINGE_STALE", stale) + " " + Assign(t.name, e.id));
        const auto at = std::ranges::lower_bound(m_elements, e.id);
        T_PAGE page{hinge, t, e, static_cast<std::size_t>(at - m_elements.begin())};
        double length = 0.0;
        if (m_doc.Memb().GetMembLengByIncludeElem(e.id, length))
            page.memberLength = ToSi(length, m_doc.Unit().Units(), kDimLength);
        for (std::size_t i = 0; i < t.components.size(); ++i) {
            page.component = static_cast<HINGE_COMPONENT>(i);
            if (t.components[i].active && !AddComponent(page)) return 0;
        }
        return 1;
    }

    static std::string Assign(const std::string& type, int element)
    {
        return Say("IDS_QM_PUSH_HINGE_ASSIGN", type, std::to_string(element));
    }

    int AddComponent(const T_PAGE& page)
    {
        if (!HasComponent(page.type.element, page.component))
            return Fail(page, Say("IDS_QM_PUSH_HINGE_COMPONENT"));
        const bool shear =
            page.component == HINGE_COMPONENT::Fy || page.component == HINGE_COMPONENT::Fz;
        if (shear && HasShearPair(page.type) && page.type.interaction == HINGE_INTERACTION::VyVz)
            return Fail(page, Say("IDS_QM_PUSH_HINGE_VYVZ"));
        std::vector<T_HINGE_SPOT> spots;
        std::string reason;
        const T_HINGE_SPAN span{page.element.kind, FlexibleLength(page.element), page.memberLength,
                                IsLoaded(page.element)};
        if (!HingeSpots(page.type, page.component, span, spots, reason)) return Fail(page, reason);
        for (const T_HINGE_SPOT& spot : spots)
            if (!AddSpot(page, spot)) return 0;
        return 1;
    }

    int AddSpot(const T_PAGE& page, const T_HINGE_SPOT& spot)
    {
        const auto c = static_cast<std::size_t>(page.component);
        const bool once = page.component == HINGE_COMPONENT::Fx ||
                          page.component == HINGE_COMPONENT::Mx; // no force anywhere
        const T_DIRS6& i =
            page.element.kind == ELEM_KIND::Beam ? page.element.release.I : kNoRelease;
        const T_DIRS6& j =
            page.element.kind == ELEM_KIND::Beam ? page.element.release.J : kNoRelease;
        if (((spot.at == 0.0 || once) && i[c]) || ((spot.at == 1.0 || once) && j[c]))
            return Fail(page, Say("IDS_QM_PUSH_HINGE_RELEASED"), spot.end);
        if (!m_taken.emplace(page.index, spot.at, c).second)
            return Fail(page, Say("IDS_QM_PUSH_HINGE_TWICE"), spot.end);
        T_PUSH_LAW law;
        std::string reason;
        if (!MakeLawOf(page, spot, law, reason)) return Fail(page, reason, spot.end);
        law.law.component = static_cast<int>(c);
        if (!Put(page, spot, std::move(law), reason)) return Fail(page, reason, spot.end);
        return 1;
    }

    /// Strengths of a page: entered, or generated for the element.
    int ReadStrengths(const T_PAGE& page, const T_HINGE_SPOT& spot, const T_SKEL_CURVE& curve,
                      T_LAW_BASIS& basis, std::string& reason)
    {
        const auto c = static_cast<std::size_t>(page.component);
        const T_HINGE_COMPONENT& component = page.type.components[c];
        const T_PAGE_STRENGTH entered = PageStrength(curve, component.type, page.component, {});
        basis.crack = entered.crack;
        if (!IsAutoYield(curve)) {
            basis.yield = {entered.yield.pos.value_or(0.0), entered.yield.neg.value_or(0.0)};
            if (const auto* fema = std::get_if<T_SKEL_FEMA>(&curve)) {
                const T_SIDES<T_SKEL_SIDE> sides = SidesAt(*fema, basis.axial);
                basis.yield = {sides.pos.yield,
                               fema->symmetric ? sides.pos.yield : sides.neg.yield};
            }
            return 1;
        }
        const bool own = spot.pageJ && NeedsIJPages(component);
        basis.yield = (own ? page.hinge.yieldJ : page.hinge.yield)[c];
        if (IsSectionSignOpposite(page.component)) std::swap(basis.yield.pos, basis.yield.neg);
        if (basis.yield.pos > 0.0 && basis.yield.neg > 0.0) return 1;
        reason =
            Say("IDS_QM_PUSH_HINGE_NOT_GENERATED") + " " + Assign(page.type.name, page.element.id);
        return 0;
    }

    int MakeLawOf(const T_PAGE& page, const T_HINGE_SPOT& spot, T_PUSH_LAW& law,
                  std::string& reason)
    {
        const T_HINGE_COMPONENT& component = At(page.type, page.component);
        const T_SKEL_CURVE& curve = spot.pageJ ? component.curves.J : component.curves.I;
        std::vector<T_FINDING> wrong;
        PushFindings(curve, component.type, {static_cast<int>(page.component)}, wrong);
        for (const T_FINDING& f : wrong) {
            reason = f.field + ": " + f.text;
            return 0;
        }
        T_LAW_BASIS basis;
        basis.length = spot.length;
        const double axial = m_options.axial ? m_options.axial(page.index, spot.at) : 0.0;
        if (component.type == SKEL_TYPE::Fema) basis.axial = -axial;
        basis.stiffness = StiffnessOf(page, spot, curve);
        std::vector<solver::T_AXIAL_STRENGTH> byAxial;
        if (!ReadStrengths(page, spot, curve, basis, reason)) return 0;
        if (IsBending(page.component) && page.element.kind == ELEM_KIND::Beam &&
            !StrengthsOf(page, curve, basis, byAxial, reason))
            return 0;
        if (!byAxial.empty()) {
            const T_SIDES<double> at = StrengthAt(byAxial, axial);
            if (at.pos > 0.0 && basis.yield.pos > 0.0) basis.atAxial.pos = at.pos / basis.yield.pos;
            if (at.neg > 0.0 && basis.yield.neg > 0.0) basis.atAxial.neg = at.neg / basis.yield.neg;
        }
        if (!MakeLaw(curve, component.type, basis, law, reason)) return 0;
        PutAxial(std::move(byAxial), basis, law);
        return 1;
    }

    /// Elastic stiffness in the measure of the curve. Shear: G times the shear area by the length
    /// of the member, as a displacement is measured; a link has its own stiffness.
    std::optional<double> StiffnessOf(const T_PAGE& page, const T_HINGE_SPOT& spot,
                                      const T_SKEL_CURVE& curve) const
    {
        const T_ELEM_D& e = page.element;
        const auto c = static_cast<std::size_t>(page.component);
        if (!HasLineElement(page.type))
            return e.stiffness[c] > 0.0 ? std::optional(e.stiffness[c]) : std::nullopt;
        const bool shear =
            page.component == HINGE_COMPONENT::Fy || page.component == HINGE_COMPONENT::Fz;
        const INIT_STIFFNESS option =
            std::visit([](const auto& k) { return k.initStiffness; }, curve);
        const T_THETA_LOOKUP lookup = LookupOf(page.type, m_sources.Section(e.section),
                                               m_sources.Material(e.material), page.memberLength);
        const auto k = CHingeTheta::CalcStiffness(
            lookup, page.component, spot.pageJ ? HINGE_LOCATION::JEnd : HINGE_LOCATION::IEnd,
            shear ? INIT_STIFFNESS::Elastic : option, 0.0);
        if (!k || !shear || lookup.perLength) return k;
        return *k / lookup.memberLength;
    }

    int StrengthsOf(const T_PAGE& page, const T_SKEL_CURVE& curve, const T_LAW_BASIS& basis,
                    std::vector<solver::T_AXIAL_STRENGTH>& out, std::string& reason)
    {
        const T_AXIAL_BASIS axial{page.type,
                                  page.component,
                                  curve,
                                  basis.yield,
                                  m_sources,
                                  page.element.section,
                                  page.element.material};
        return StrengthsByAxial(axial, out, reason);
    }

    /// Strength by axial force, in the engine's measure: that of the first point.
    static void PutAxial(std::vector<solver::T_AXIAL_STRENGTH> rows, const T_LAW_BASIS& basis,
                         T_PUSH_LAW& law)
    {
        const double pos = law.law.positive.points.empty()
                               ? 0.0
                               : law.law.positive.points.front().force / basis.yield.pos;
        const double neg = law.law.negative.points.empty()
                               ? 0.0
                               : law.law.negative.points.front().force / basis.yield.neg;
        for (solver::T_AXIAL_STRENGTH& row : rows) {
            row.positive *= pos;
            row.negative *= neg;
        }
        law.law.byAxial = std::move(rows);
    }

    double FlexibleLength(const T_ELEM_D& e) const
    {
        const auto i = m_model.nodes.find(e.nodeI), j = m_model.nodes.find(e.nodeJ);
        if (i == m_model.nodes.end() || j == m_model.nodes.end()) return 0.0;
        double sum = 0.0;
        for (std::size_t d = 0; d < 3; ++d) {
            const double along =
                j->second.xyz[d] + e.offset.J[d] - i->second.xyz[d] - e.offset.I[d];
            sum += along * along;
        }
        return std::sqrt(sum);
    }

    /// A static load case has loads along the element, its weight included.
    bool IsLoaded(const T_ELEM_D& e) const
    {
        const auto material = m_model.materials.find(e.material);
        return m_loaded.contains(e.id) || (m_hasWeight && material != m_model.materials.end() &&
                                           material->second.density > 0.0);
    }
    void FindLoaded()
    {
        for (const auto& [key, load] : m_model.loadCases) {
            const auto& w = load.selfWeight;
            m_hasWeight = m_hasWeight || w[0] != 0.0 || w[1] != 0.0 || w[2] != 0.0;
            for (const T_BEAM_LOAD& l : load.beam)
                m_loaded.insert(l.element);
        }
    }

    /// A law to the hinge of its record that stands there.
    int Put(const T_PAGE& page, const T_HINGE_SPOT& spot, T_PUSH_LAW law, std::string& reason)
    {
        const auto stands = [&](const solver::T_PUSH_HINGE& h) {
            return h.element == page.index && h.at == spot.at;
        };
        auto& hinges = m_out.hinges;
        // Components of one record follow one another.
        auto at = std::find_if(hinges.begin() + static_cast<std::ptrdiff_t>(FirstOf(page)),
                               hinges.end(), stands);
        if (at == hinges.end()) {
            solver::T_PUSH_HINGE& h = hinges.emplace_back();
            h.element = page.index;
            h.at = spot.at;
            h.flow = m_options.flow;
            at = hinges.end() - 1;
        }
        T_PUSH_LAW_PLACE place{
            page.hinge.element, spot.end,       static_cast<std::size_t>(at - hinges.begin()),
            at->laws.size(),    page.component, std::move(law.letters),
            law.criteria,       law.fails};
        at->laws.push_back(std::move(law.law));
        if (page.component == HINGE_COMPONENT::Mz && ShareSurface(page.type) && HasMy(*at))
            at->biaxial = true;
        m_out.laws.push_back(std::move(place));
        if (!at->biaxial || !page.type.exactSurface) return 1;
        return SurfaceShape(m_sources, page.element.section, page.element.material, at->laws.back(),
                            at->shape, reason);
    }
    static bool HasMy(const solver::T_PUSH_HINGE& h)
    {
        return std::ranges::any_of(h.laws, [](const auto& law) {
            return law.component == static_cast<int>(HINGE_COMPONENT::My);
        });
    }
    /// The first hinge that the record has made.
    std::size_t FirstOf(const T_PAGE& page)
    {
        if (m_record != &page.hinge) {
            m_record = &page.hinge;
            m_first = m_out.hinges.size();
        }
        return m_first;
    }

    /// By element and place; the order of the records does not count.
    void Sort()
    {
        std::vector<std::size_t> order(m_out.hinges.size());
        for (std::size_t i = 0; i < order.size(); ++i)
            order[i] = i;
        std::ranges::stable_sort(order, {}, [&](std::size_t i) {
            const solver::T_PUSH_HINGE& h = m_out.hinges[i];
            return std::tuple(h.element, h.at, h.laws.front().component);
        });
        T_PUSH_HINGES sorted;
        std::vector<std::size_t> now(order.size());
        for (std::size_t i = 0; i < order.size(); ++i) {
            now[order[i]] = i;
            sorted.hinges.push_back(std::move(m_out.hinges[order[i]]));
        }
        sorted.laws = std::move(m_out.laws);
        for (T_PUSH_LAW_PLACE& place : sorted.laws)
            place.hinge = now[place.hinge];
        std::ranges::sort(sorted.laws, {},
                          [](const T_PUSH_LAW_PLACE& p) { return std::tuple(p.hinge, p.law); });
        m_out = std::move(sorted);
    }

    CDBDoc& m_doc;
    const T_MODEL& m_model;
    std::span<const int> m_elements;
    const T_PUSH_LAW_OPTIONS& m_options;
    CHingeSources m_sources;
    CHingeGenerator m_generator;
    std::set<std::tuple<std::size_t, double, std::size_t>> m_taken; // element, place, component
    std::set<int> m_loaded;   // elements with loads along them
    bool m_hasWeight = false; // some load case has
    T_PUSH_HINGES m_out;
    const T_PHGE_D* m_record = nullptr;
    std::size_t m_first = 0;
    std::string m_error;
};

} // namespace

int BuildPushHinges(CDBDoc& doc, std::span<const int> elements, const T_PUSH_LAW_OPTIONS& options,
                    T_PUSH_HINGES& out, std::string& error)
{
    return CBuilder(doc, elements, options).Build(out, error);
}

bool NeedsInitialAxial(const T_MODEL& model, const std::vector<int>& types)
{
    return std::ranges::any_of(model.hingeTypes, [&](const auto& entry) {
        if (!Acts(entry.first, types)) return false;
        return std::ranges::any_of(entry.second.components, [](const T_HINGE_COMPONENT& c) {
            const auto* i = std::get_if<T_SKEL_FEMA>(&c.curves.I);
            const auto* j = std::get_if<T_SKEL_FEMA>(&c.curves.J);
            return c.active && ((i && i->multiCurve) || (j && j->multiCurve));
        });
    });
}
