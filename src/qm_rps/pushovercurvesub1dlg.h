// Page of the pushover curve window with the choice of method and procedure.
#pragma once

#include "qm_base/mdialog.h"
#include "qm_db/records.h"

#include <span>

class CPushOverCurveSub1Dlg : public zql::frx::MDialog {
public:
    /// The two lists of methods, in the order of the page.
    static constexpr std::array<PUSH_METHOD, 2> kPerfPointMethods{PUSH_METHOD::Fema440,
                                                                  PUSH_METHOD::Atc40};
    static constexpr std::array<PUSH_METHOD, 3> kTargetMethods{
        PUSH_METHOD::Ec8Opcm, PUSH_METHOD::Ntc2008, PUSH_METHOD::Ntc2018};

    PUSH_METHOD m_method = PUSH_METHOD::Atc40;
    char m_procedure = 'A';

    /// Keys of the procedures that a method offers, A first; none for target displacements.
    static std::span<const char* const> Procedures(PUSH_METHOD method);

    /// The procedure is one that the method offers. 0 shows IDS_QM_NO_SUCH_PROCEDURE.
    int CheckData() override;
};
