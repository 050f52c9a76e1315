// Page of the pushover curve window with the options of the bilinear capacity spectrum. It edits
// the evaluation of its window.
#pragma once

#include "qm_base/mdialog.h"
#include "qm_db/records.h"

class CPushOverCurveSub4Dlg : public zql::frx::MDialog {
public:
    /// Keys of the labels: bilinear rule, secant stiffness, strength rule, ultimate drop.
    static constexpr std::array<const char*, 4> kLabels{
        "IDS_RPS_PO_MODEL_BILINEAR", "IDS_RPS_PO_MODEL_STIFF", "IDS_RPS_PO_MODEL_STRNTH",
        "IDS_RPS_PO_MODEL_CAPACITY"};

    /// The evaluation must outlive the page.
    explicit CPushOverCurveSub4Dlg(T_EVAL_D& settings) : m_settings(settings) {}

    /// The options in the settings; made on the first call. Absent values take the rule's defaults.
    T_EVAL_BILINEAR& Options();
    /// Options that say nothing leave the settings.
    void DropEmpty();

private:
    T_EVAL_D& m_settings;
};
