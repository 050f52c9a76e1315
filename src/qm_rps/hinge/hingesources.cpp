#include "qm_rps/hinge/hingesources.h"

namespace {

constexpr std::size_t kSurfaceRows = 48; // axial forces of a surface

template <class R>
const R* Find(const T_TABLE<R>& table, int key)
{
    const auto at = table.find(key);
    return at == table.end() ? nullptr : &at->second;
}

} // namespace

const T_SECT_D* CHingeSources::Section(int key) const
{
    return Find(m_sections, key);
}

const T_MATL_D* CHingeSources::Material(int key) const
{
    return Find(m_materials, key);
}

const CHingeSources::T_RESULT* CHingeSources::Strength(int section, int material) const
{
    const T_SECT_D* s = Section(section);
    const T_MATL_D* m = Material(material);
    if (!s || !m) return nullptr;
    const auto [at, fresh] = m_results.try_emplace({section, material});
    T_RESULT& r = at->second;
    if (fresh && !CSectionStrength::Calc(*s, *m, m_units, r.strength, r.fault)) r.strength = {};
    return &r;
}

T_PM_LINES CHingeSources::Lines(int section, int material) const
{
    T_PM_LINES lines;
    const T_RESULT* result = Strength(section, material);
    if (!result || result->fault != SECT_FAULT::None) return lines;
    for (const bool aboutY : {true, false})
        for (const bool positive : {true, false}) {
            auto& sides = aboutY ? lines.y : lines.z;
            SECT_FAULT fault{};
            if (!CSectionStrength::CalcCurve(*Section(section), *Material(material), m_units,
                                             aboutY, positive, positive ? sides.pos : sides.neg,
                                             fault))
                return {};
        }
    return lines;
}

const std::vector<T_SURFACE_ROW>& CHingeSources::Surface(int section, int material,
                                                         std::span<const double> directions) const
{
    T_SURFACE& kept = m_surfaces[{section, material}];
    if (std::ranges::equal(kept.directions, directions)) return kept.rows;
    kept = {{directions.begin(), directions.end()}, {}};
    const T_SECT_D* s = Section(section);
    const T_MATL_D* m = Material(material);
    SECT_FAULT fault{};
    if (!s || !m ||
        !CSectionStrength::CalcSurface(*s, *m, m_units, kSurfaceRows, directions, kept.rows, fault))
        kept.rows.clear();
    return kept.rows;
}

std::optional<CAxialForceList::T_RANGE> CHingeSources::AxialRange(int section, int material) const
{
    const T_RESULT* result = Strength(section, material);
    if (!result || result->fault != SECT_FAULT::None) return std::nullopt;
    const T_YIELD_LEVEL& level = result->strength.level;
    return CAxialForceList::T_RANGE{-level.tension, level.compression};
}
