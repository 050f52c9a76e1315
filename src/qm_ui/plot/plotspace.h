// Finds free places for legends and labels in the plot area.
#pragma once

#include "qm_ui/plot/plotgeometry.h"

#include <cstddef>
#include <optional>
#include <vector>

/// Where a text went: the box, the point it belongs to, and the end of the leader line from that
/// point (at the box) when it has one.
struct T_PLOT_PLACE {
    T_PLOT_BOX box;
    T_PLOT_PX anchor;
    std::optional<T_PLOT_PX> leaderEnd;
};

/// Keeps a coarse picture of what is drawn in the area, and the boxes already taken. Every place
/// handed out lies inside the area and meets no box taken before; among those, the search takes
/// the one that hides least and stays nearest. It hands out nothing when there is no room.
class CPlotSpace {
public:
    explicit CPlotSpace(const T_PLOT_BOX& area);

    /// What a box would hide: the weight of each cell (4 x 4 px) that the line or the point
    /// touches; the heaviest thing in a cell counts.
    void MarkLine(T_PLOT_PX a, T_PLOT_PX b, double weight);
    void MarkRun(const PLOT_RUN& run, double weight);
    void MarkPoint(T_PLOT_PX p, double weight);

    void Take(const T_PLOT_BOX& box) { m_taken.push_back(box); }
    [[nodiscard]] bool IsFree(const T_PLOT_BOX& box) const;
    [[nodiscard]] double Hidden(const T_PLOT_BOX& box) const;

    /// A box of the given size anywhere in the area, best near the top right corner. Takes it.
    std::optional<T_PLOT_BOX> PlaceAnywhere(double w, double h);
    /// A box near the anchor, with a leader line when it is not close. Takes it.
    std::optional<T_PLOT_PLACE> PlaceNear(T_PLOT_PX anchor, double w, double h);
    /// A box beside the line (not empty), best near its last point, sliding back. Takes it.
    std::optional<T_PLOT_PLACE> PlaceAlong(const PLOT_RUN& run, double w, double h);

private:
    struct T_LEADER {
        T_PLOT_PX a, b;
    };
    [[nodiscard]] double HiddenBelow(T_PLOT_PX a, T_PLOT_PX b) const;
    [[nodiscard]] double LeaderCost(T_PLOT_PX anchor, const T_PLOT_BOX& box) const;
    [[nodiscard]] T_PLOT_PLACE TakeWithLeader(T_PLOT_PX anchor, const T_PLOT_BOX& box);

    T_PLOT_BOX m_area;
    std::size_t m_cols = 1;
    std::size_t m_rows = 1;
    std::vector<double> m_weights; // row-major, m_rows x m_cols
    std::vector<T_PLOT_BOX> m_taken;
    std::vector<T_LEADER> m_leaders;
};
