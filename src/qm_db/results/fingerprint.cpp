#include "qm_db/results/fingerprint.h"

#include "qm_db/file/checksum.h"
#include "qm_db/results/stagedresult.h"

#include <bit>
#include <type_traits>

namespace {

/// A checksum over numbers and lists of numbers; the lengths of the lists count.
class CSum {
public:
    template <class... T>
    void operator()(const T&... values)
    {
        (Add(values), ...);
    }
    std::uint64_t Value() const { return m_sum.Value(); }

private:
    void Add(double v) { m_sum.AddWord(std::bit_cast<std::uint64_t>(v)); }
    template <class T>
    requires std::is_integral_v<T> || std::is_enum_v<T>
    void Add(T v) { m_sum.AddWord(static_cast<std::uint64_t>(v)); }
    template <class R>
    requires requires(const R& r) { r.size(); }
    void Add(const R& values)
    {
        Add(values.size());
        for (const auto& v : values)
            Add(v);
    }
    template <class T>
    void Add(const T_ENDS<T>& ends)
    {
        (*this)(ends.I, ends.J);
    }
    template <class T>
    void Add(const std::optional<T>& v)
    {
        Add(v.has_value());
        if (v) Add(*v);
    }
    template <class T>
    void Add(const std::pair<const int, T>& entry)
    {
        (*this)(entry.first, entry.second);
    }

    void Add(const T_NODE_D& n) { (*this)(n.xyz, n.restraint); }
    void Add(const T_MATL_D& m) { (*this)(m.E, m.nu, m.G, m.density, m.alpha); }
    void Add(const T_SECT_D& s)
    {
        (*this)(s.shape, s.size, s.area, s.Asy, s.Asz, s.J, s.Iyy, s.Izz);
        // Only where they are there: results of other models that are stored stay fresh.
        if (s.fillet != 0.0) Add(s.fillet);
        for (const T_SECT_FACTORS& f : {s.factorsI, s.factorsJ})
            if (f != T_SECT_FACTORS{}) (*this)(f.area, f.Asy, f.Asz, f.J, f.Iyy, f.Izz);
    }
    void Add(const T_ELEM_D& e)
    {
        (*this)(e.kind, e.nodeI, e.nodeJ, e.section, e.material, e.zAxis, e.release, e.offset,
                e.stiffness);
    }
    void Add(const T_DIAP_D& d) { (*this)(d.nodes, d.normal); }
    void Add(const T_EQDS_D& e) { (*this)(e.nodes, e.directions); }

    void Add(const T_NODAL_LOAD& l) { (*this)(l.node, l.load); }
    void Add(const T_BEAM_LOAD& l) { (*this)(l.element, l.axes, l.direction, l.type, l.w, l.at); }
    void Add(const T_SETTLEMENT& l) { (*this)(l.node, l.displacement); }
    void Add(const T_TEMPERATURE_LOAD& l) { (*this)(l.element, l.change); }
    void Add(const T_PTNS_D& l) { (*this)(l.element, l.force); }

    void Add(const T_STAG_LOAD& l) { (*this)(l.loadCase, l.step); }
    void Add(const T_STAG_PART& p) { (*this)(p.elements, p.supports, p.loads); }
    void Add(const T_STAG_D& s) { (*this)(s.activate, s.deactivate, s.steps); }

    CChecksum m_sum;
};

} // namespace

std::uint64_t FingerprintOfStructure(const T_MODEL& model)
{
    CSum sum;
    sum(model.nodes, model.materials, model.sections, model.elements, model.diaphragms,
        model.equalDisplacements, model.styp.plane, model.styp.gravity);
    return sum.Value();
}

std::uint64_t FingerprintOfCase(std::uint64_t structure, const T_STLD_D& c)
{
    CSum sum;
    sum(structure, c.selfWeight, c.nodal, c.beam, c.settlement, c.temperature, c.pretension);
    return sum.Value();
}

std::uint64_t FingerprintOfStagePlan(const T_MODEL& model)
{
    const T_STCT_D& control = model.styp.stageControl;
    CSum sum;
    sum(FingerprintOfStructure(model), model.stages, control.birth, control.geometricStiffness,
        control.cableSag);
    for (const int key : StageLoadCases(model)) {
        const auto it = model.loadCases.find(key);
        if (it != model.loadCases.end()) sum(key, it->second.group);
    }
    return sum.Value();
}

std::uint64_t FingerprintOfStages(const T_MODEL& model)
{
    const T_STCT_D& control = model.styp.stageControl;
    const std::uint64_t structure = FingerprintOfStructure(model);
    CSum sum;
    sum(structure, model.stages, control.birth, control.geometricStiffness, control.cableSag);
    for (const int key : StageLoadCases(model)) {
        const auto it = model.loadCases.find(key);
        if (it != model.loadCases.end())
            sum(key, it->second.group, FingerprintOfCase(structure, it->second));
    }
    return sum.Value();
}
