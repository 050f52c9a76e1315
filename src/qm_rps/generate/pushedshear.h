// Shear and shear span of member ends in a push.
#pragma once

#include "qm_rps/generate/memberend.h"
#include "qm_rps/push/endforces.h"

/// Takes from the member forces of a push, of each end and axis of bending, V and M / V at the step
/// at which the end's hinge flows for the first time (never: at which V is largest); of several
/// results of a load case those with the larger V. Forces are those of the whole state: the initial
/// loads and those along the member are in them.
class CPushedShears {
public:
    explicit CPushedShears(const std::vector<T_HINGE_MEMBER>& members);

    /// A step of a run; the steps of a run come in order, one run after the other.
    void Take(const T_STEP_FORCES& step);
    /// Of each element V and M / V of the I-end, then of the J-end, for each axis. Ends without a
    /// hinge have 0, elements without any shear in the push are left out.
    std::map<int, std::vector<double>> Values() const;

private:
    struct T_END {
        T_END_PLACE place;
        std::size_t value = 0; // place of V among the element's values
        double largest = 0.0, span = 0.0;
        double V = 0.0, M = 0.0; // of the run that is taken
        const T_PUSH_HINGE_SERIES* hinge = nullptr;
        bool flows = false;
    };
    void Begin(const T_PUSH_RUN& run);
    static void TakeEnd(const T_STEP_FORCES& step, T_END& end);

    std::vector<T_END> m_ends;
    std::map<int, std::size_t> m_sizes; // of the values, by element
};

/// The element whose V has changed most, and by how much of its new value.
struct T_SHEAR_CHANGE {
    int element = 0;
    double change = 0.0;
    double before = 0.0, now = 0.0; // V
};
/// An element that is not in `before` had V = 0.
T_SHEAR_CHANGE LargestChange(const std::map<int, std::vector<double>>& before,
                             const std::map<int, std::vector<double>>& now);
