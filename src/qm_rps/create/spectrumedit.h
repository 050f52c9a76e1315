// A spectrum while it is typed: each kind keeps its values while another one is looked at.
#pragma once

#include "qm_base/finding.h"
#include "qm_db/records.h"
#include "qm_rps/create/spectrumvalues.h"

#include <array>
#include <string>
#include <tuple>
#include <vector>

/// State: the values of every kind, and which kind the spectrum is of. No document, no rule of its
/// own: RecordFindings judges what Record gives.
class CSpectrumEdit {
public:
    CSpectrumEdit();

    enum KIND { Atc40, Ec8, Ec8Old, Ntc, User };
    int m_kind = Ec8;
    std::string m_name;

    T_SPFC_ATC40 m_atc40;
    T_SPFC_EURO2003 m_ec8;
    T_SPFC_EURO1996 m_ec8Old;
    T_SPFC_NTC m_ntc;
    T_SPFC_USER m_user;

    static std::vector<std::string> KindTexts();
    /// Of the kind; the name goes along while it is that of the kind before.
    void OnKind(int kind);
    /// In current units.
    T_SPFC_D Record() const;
    void Take(const T_SPFC_D& record);

    // ---- members that fields bind to ----
    /// A letter of the soil as an index of the letters that the kind has.
    std::vector<std::string> SoilTexts() const;
    int Soil() const;
    void OnSoil(int index);
    /// Design ground acceleration and damping of the kinds that have one.
    double Ag() const { return m_kind == Ec8Old ? m_ec8Old.ag : m_ec8.ag; }
    void OnAg(double ag);
    double Damping() const;
    void OnDamping(double percent);
    bool HasDamping() const { return m_kind == Ec8 || m_kind == Ec8Old || m_kind == Ntc; }
    bool HasState(std::size_t state) const { return m_ntc.states.at(state).has_value(); }
    void OnState(std::size_t state, bool on);
    /// SXS and SX1 of ASCE 41 in place of Ca and Cv.
    double Sxs() const { return kPlateau * m_atc40.Ca; }
    void OnSxs(double sxs) { m_atc40.Ca = sxs / kPlateau; }
    /// Table of the kind User as text of two columns, and from such a text. 0: Refusal says why,
    /// the table as it was.
    int OnTable(const std::string& text);
    const std::string& Refusal() const { return m_refusal.text; }
    /// Rows that are typed: T in s, Sa in g.
    std::string Cell(std::size_t row, std::size_t column) const;
    int SetCell(std::size_t row, std::size_t column, const std::string& text);
    void OnAddRow();
    void OnDeleteRow(std::size_t row);

private:
    static constexpr double kPlateau = 2.5; // SXS over Ca: ATC-40 4.4.3
    char& SoilOf();

    std::array<T_SPFC_NTC_STATE, 4> m_states; // of those that are switched off
    T_FINDING m_refusal;
};
