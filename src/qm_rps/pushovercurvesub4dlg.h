// Page of the pushover curve window with the options of the bilinear capacity spectrum.
#pragma once

#include "qm_base/mdialog.h"
#include "qm_db/records.h"

class CPushOverCurveSub4Dlg : public zql::frx::MDialog {
public:
    /// Keys of the labels: bilinear rule, secant stiffness, strength rule, ultimate drop.
    static constexpr std::array<const char*, 4> kLabels{
        "IDS_RPS_PO_MODEL_BILINEAR", "IDS_RPS_PO_MODEL_STIFF", "IDS_RPS_PO_MODEL_STRNTH",
        "IDS_RPS_PO_MODEL_CAPACITY"};

    /// As edited; absent values take the rule's defaults.
    T_EVAL_BILINEAR m_options;

    void Data2Dlg(const std::optional<T_EVAL_BILINEAR>& options)
    {
        m_options = options.value_or(T_EVAL_BILINEAR{});
    }

    /// The secant fraction and the ultimate drop lie in (0, 1]. 0 shows
    /// IDS_DB_PO_CURVE_PP_BETWEEN_0_1 and the page stays open.
    int CheckData() override;
};
