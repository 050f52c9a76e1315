#include "qm_rps/pushover/evaluation/pushtargetinput.h"

T_BILINEAR_OPTIONS BilinearOptionsOf(const T_EVAL_D& evaluation)
{
    const T_EVAL_BILINEAR given = evaluation.bilinear.value_or(T_EVAL_BILINEAR{});
    const bool ec8 = evaluation.method == PUSH_METHOD::Ec8Opcm;
    const std::string fallback = evaluation.masonry.value_or(false) ? "masonry"
                                 : ec8                              ? "ec8"
                                                                    : "ntc";
    const std::string rule = given.rule.value_or(fallback);
    T_BILINEAR_OPTIONS options = BilinearDefaults(rule == "masonry" ? BILINEAR_RULE::Masonry
                                                  : rule == "ntc"   ? BILINEAR_RULE::Ntc
                                                                    : BILINEAR_RULE::Ec8);
    options.secant = given.secant.value_or(options.secant);
    options.drop = given.drop.value_or(options.drop);
    // The iteration runs on one spectrum; NTC has four.
    options.iterate = ec8 && given.iterate.value_or(false);
    options.peak = given.strength == "peak";
    return options;
}

std::array<T_TARGET_SPECTRUM, 4> TargetSpectraOf(const T_SPFC_D& record, PUSH_METHOD method,
                                                 int behaviorType, double factor)
{
    std::array<T_TARGET_SPECTRUM, 4> spectra;
    const bool ntc = method != PUSH_METHOD::Ec8Opcm;
    for (std::size_t i = 0; i < (ntc ? spectra.size() : 1); ++i) {
        const LIMIT_STATE state = ntc ? static_cast<LIMIT_STATE>(i) : LIMIT_STATE::SLV;
        const std::shared_ptr<CETC_DESIGN_SPECT> spectrum =
            MakeDesignSpectrum(record, behaviorType, state);
        if (!spectrum) continue;
        if (factor != 1.0) spectrum->ScaleBy(factor);
        spectra[i] = {[spectrum](double T) { return spectrum->CalcSaAt(T); },
                      spectrum->CornerPeriod()};
    }
    return spectra;
}

std::optional<double> CStepDrift::Of(int step)
{
    m_used = true;
    if (step == 0) return 0.0;
    double kind1 = 0.0, kind2 = 0.0;
    if (!m_doc.Post().GetPushoverStoryDriftRatio(m_push.key, step, kind1, kind2, m_push.turn)) {
        m_missing = true;
        return std::nullopt;
    }
    return m_kind == 1 ? kind1 : kind2;
}

const char* CStepDrift::WarningKey()
{
    if (m_missing)
        return StoreyFindings(m_doc.Data().Model()).empty() ? "IDS_QM_WARN_NO_DRIFT"
                                                            : "IDS_QM_WARN_STOREY_ORDER";
    return m_used && m_doc.Post().HasStoreyGaps(m_push.key, m_push.turn) ? "IDS_QM_WARN_STOREY_GAPS"
                                                                         : nullptr;
}
