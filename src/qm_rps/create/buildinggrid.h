// The lines and levels of a regular frame: ids and places of its nodes, its bays by name.
#pragma once

#include "qm_rps/create/building.h"

/// Lines of the plan, from 0.
struct T_PLAN_PLACE {
    std::size_t ix = 0, iy = 0;
};
/// A bay of an outer frame between two lines.
struct T_BRACED_BAY {
    T_PLAN_PLACE from, to;
};

/// Lengths in SI. The building must outlive the grid; a list may be empty until it is checked.
class CBuildingGrid {
public:
    explicit CBuildingGrid(const T_BUILDING& in);

    bool IsPlane() const { return m_in.baysY.empty(); }
    std::size_t LinesX() const { return m_x.size(); }
    std::size_t LinesY() const { return m_y.size(); }
    std::size_t Levels() const { return m_z.size(); }
    /// "305": level 3, fifth node of the plan (along X first); a plan of 100 nodes and more has
    /// more digits.
    int Id(std::size_t ix, std::size_t iy, std::size_t level) const;
    int IdOf(const T_PLAN_PLACE& place, std::size_t level) const
    {
        return Id(place.ix, place.iy, level);
    }
    std::size_t LevelOf(int id) const { return static_cast<std::size_t>(id / m_stride); }
    std::array<double, 3> At(std::size_t ix, std::size_t iy, std::size_t level) const
    {
        return {m_x[ix], m_y[iy], m_z[level]};
    }
    /// "x2": the bays on both outer frames along X, of a plane frame the one. 0: no such bay.
    [[nodiscard]] int ReadBays(const std::vector<std::string>& names,
                               std::vector<T_BRACED_BAY>& out, T_FINDING& fault) const;
    std::string PlanText() const;

private:
    const T_BUILDING& m_in;
    std::vector<double> m_x, m_y, m_z;
    int m_stride = 100;
};
