// What a target-displacement evaluation reads from the model and from its settings.
#pragma once

#include "qm_db/recordfacts.h"
#include "qm_rps/pushover/pushovertargetevaluation.h"

/// Options of the bilinear curve: the rule's own, or the method's where none is named, with the
/// fractions that the settings give.
T_BILINEAR_OPTIONS BilinearOptionsOf(const T_EVAL_D& evaluation);

/// The elastic spectra of the limit states: NTC has four, Eurocode 8 one. A state that the record
/// does not enable stays empty. `factor` on their ordinates.
std::array<T_TARGET_SPECTRUM, 4> TargetSpectraOf(const T_SPFC_D& spectrum, PUSH_METHOD method,
                                                 int behaviorType, double factor = 1.0);

/// Storey drift ratios of the steps of a load case, by the chosen kind; remembers what it met.
class CStepDrift {
public:
    /// kind 1 or 2, see CPostCtrl. The document must outlive this object.
    CStepDrift(CDBDoc& doc, T_PUSH_NAME push, int kind) : m_doc(doc), m_push(push), m_kind(kind) {}

    /// Ratio of a step; step 0 is the model at rest. Empty: it is not known.
    std::optional<double> Of(int step);

    /// Key of the warning that belongs to what was read; null: none.
    const char* WarningKey();

private:
    CDBDoc& m_doc;
    T_PUSH_NAME m_push;
    int m_kind;
    bool m_used = false, m_missing = false;
};
