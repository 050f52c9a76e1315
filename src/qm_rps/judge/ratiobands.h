// Member ends and joints on the picture of the frame, by their ratios at a limit state.
#pragma once

#include "qm_rps/desk/framescene.h"
#include "qm_rps/judge/judgementresult.h"

/// Upper ends of the bands of ratios; beyond the last one, and what is not checked, have bands of
/// their own.
inline constexpr std::array<double, 4> kRatioBands{0.5, 0.8, 1.0, 1.5};
inline constexpr std::size_t kBandBeyond = kRatioBands.size(), kBandUnchecked = kBandBeyond + 1;
inline constexpr std::size_t kBands = kBandUnchecked + 1;

/// A line of the scene from one end to its middle.
struct T_BANDED_HALF {
    std::size_t line = 0;
    bool atJ = false;
    std::size_t band = kBandUnchecked; // the worse one of several axes
};
/// A joint, in the worse one of its planes.
struct T_BANDED_NODE {
    std::size_t node = 0; // of the scene
    std::size_t band = kBandUnchecked;
};
struct T_RATIO_BANDS {
    std::vector<T_BANDED_HALF> halves;
    std::vector<T_BANDED_NODE> nodes;
    std::array<std::size_t, kBands> count{}; // of halves and nodes
};

T_RATIO_BANDS RatioBands(const T_JUDGEMENT& judgement, const T_JUDGED_STATE& state,
                         const T_FRAME_SCENE& scene);
/// "up to 0.5", "above 1.5", "not checked".
std::string BandText(std::size_t band);
