// A picture of a document: what is drawn. The rooms with windows know how.
#pragma once

#include "qm_db/records.h"
#include "qm_rps/factors/ulfresult.h"
#include "qm_rps/judge/judgementresult.h"
#include "qm_rps/push/pushrun.h"
#include "qm_rps/pushover/evaluation/pushovercomparison.h"

#include <memory>
#include <string>
#include <variant>

/// The frame as it stands.
struct T_FRAME_VIEW {
    bool numbers = false; // of nodes and elements
};
struct T_SECTION_VIEW {
    T_SECT_D section;
    T_UNITS units;
};
/// Backbone of a component at the I-end.
struct T_BACKBONE_VIEW {
    std::shared_ptr<const T_PHGT_D> type;
    HINGE_COMPONENT component{};
    bool atJ = false;
};
/// Curve of the results of a load case.
struct T_PUSH_VIEW {
    std::shared_ptr<const std::vector<T_PUSH_RUN>> runs;
    T_UNITS units;
    std::string title;
};
struct T_EVALUATION_VIEW {
    std::shared_ptr<const T_PUSH_EVALUATION> result;
};
/// Ends of members by their ratios at a limit state.
struct T_JUDGEMENT_VIEW {
    std::shared_ptr<const T_JUDGEMENT> judgement;
    std::size_t state = 0;
};

/// Evaluations of one load case by one spectrum on their capacity curve.
struct T_COMPARISON_VIEW {
    std::shared_ptr<const T_PUSH_COMPARISON> comparison;
};
/// Lengths beside each other, the first on top.
struct T_BARS_VIEW {
    std::string title, axis; // axis: with its unit
    std::vector<std::pair<std::string, double>> bars;
};
/// Constrained quantities between their bounds.
struct T_FACTORS_VIEW {
    std::shared_ptr<const T_ULF_RESULT> result;
};

using T_DOC_VIEW =
    std::variant<T_FRAME_VIEW, T_SECTION_VIEW, T_BACKBONE_VIEW, T_PUSH_VIEW, T_EVALUATION_VIEW,
                 T_JUDGEMENT_VIEW, T_COMPARISON_VIEW, T_BARS_VIEW, T_FACTORS_VIEW>;

/// Width of pictures that stand beside each other.
inline constexpr double kHalfPage = 0.49;

struct T_DOC_PICTURE {
    std::string caption;
    T_DOC_VIEW view;
    double width = 1.0; // fraction of the page's; small ones are drawn with texts of the same size
};
