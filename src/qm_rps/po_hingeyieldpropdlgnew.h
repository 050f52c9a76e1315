// Model of the editor of a hinge type's yield surface.
#pragma once

#include "qm_base/checkeddialog.h"
#include "qm_db/records.h"
#include "qm_rps/hinge/hingelabels.h"
#include "qm_rps/hinge/hingepartfindings.h"

class CPO_HingeYieldPropDlgNew : public CCheckedDialog {
public:
    T_HINGE_OWNER m_owner; // for titles and units

    /// The normaliser of the moments of an Eurocode surface, as shown.
    static constexpr const char* kMomentNormaliserText =
        " Mmax = max ( |MUy(+)|, |MUy(-)|, |MUz(+)|, |MUz(-)| )";

    /// Edits a copy; OnOK writes it back to `record`, which is not owned. The skeleton curve fixes
    /// the levels: trilinear (and slip trilinear) crack and yield, which is checked as entered, so
    /// a missing crack level counts as zeros; Eurocode one level with its own labels; else the
    /// yield level alone.
    CPO_HingeYieldPropDlgNew(T_YIELD_SURFACE& record, SKEL_TYPE type)
        : m_surface(record), m_type(type), m_record(record)
    {
    }

    T_YIELD_SURFACE m_surface; // as edited
    /// The yield level that section and material of the type give; empty: they give none.
    std::optional<T_YIELD_LEVEL> m_calculated;
    /// Replaces the yield level by the calculated one; axes stay in use or not. 0: there is none.
    [[nodiscard]] int OnCalculateBtn();
    /// The whole curves of a level that is the calculated one, edited nowhere; else empty.
    T_PM_LINES LinesOf(const T_YIELD_LEVEL& level) const;

    bool m_showValue = false; // IDS_RPS_Show_Value against IDS_RPS_Show_Ratio

    /// See YieldSurfaceFindings.
    std::vector<T_FINDING> Findings() const override;
    /// 1 and the record holds the surface; 0 and the record is unchanged.
    int OnOK() override;

    /// A level as it is shown.
    struct T_LEVEL {
        T_YIELD_LEVEL_NAMES names;
        const char* titleKey; // of its page
        T_YIELD_LEVEL* level; // of m_surface
    };
    /// The levels of the curve type. A crack level that is missing is made.
    std::vector<T_LEVEL> Levels();
    /// Takes an axis into use, or out of it, in every level.
    void OnAxisChk(bool aboutY, bool used);
    bool IsAxisUsed(bool aboutY) const
    {
        return aboutY ? m_surface.yield.y.used : m_surface.yield.z.used;
    }
    bool IsEurocode() const { return m_type == SKEL_TYPE::Ec8; }

    /// Key of the note in place of an axis that is not used; empty where it is used.
    std::string AxisNoteKey(bool aboutY) const;

private:
    SKEL_TYPE m_type;
    T_YIELD_SURFACE& m_record;
};
