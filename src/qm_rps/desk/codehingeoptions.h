// What the window of the hinges of a code asks for beside the members, and how its pushes are told.
#pragma once

#include "qm_rps/generate/codehinges.h"

#include <array>

/// What a connection of steel beams is asked for beside its kind.
struct T_CONNECTION_MEASURE {
    const char* key; // of its caption
    const char* name;
    T_DIM dim;
    double T_STEEL_CONNECTION::*value;
};
inline constexpr std::array<T_CONNECTION_MEASURE, 3> kConnectionMeasures{
    {{"IDS_QM_UI_GEN_COLUMN_FLANGE", "columnFlange", kDimLength, &T_STEEL_CONNECTION::columnFlange},
     {"IDS_QM_UI_GEN_PLATE", "continuityPlate", kDimLength, &T_STEEL_CONNECTION::continuityPlate},
     {"IDS_QM_UI_GEN_PANEL", "panelRatio", kDimNone, &T_STEEL_CONNECTION::panelRatio}}};

/// Forces and lengths are in current units. The document must outlive the object.
class CCodeHingeOptions {
public:
    /// The code is EN 1998-3 in a model of Eurocodes, else ASCE 41-17.
    explicit CCodeHingeOptions(CDBDoc& doc);

    HINGE_CODE m_code = HINGE_CODE::Asce17;
    bool m_secondary = false;
    bool m_keepGoing = true; // members that can't have a hinge are left out and named

    /// Where the shear of member ends comes from: their strengths (0), a push of one of the model's
    /// load cases, or what the stale types that were taken had of an earlier push (the last one,
    /// where there are such).
    std::vector<std::string> ShearTexts() const;
    int m_shear = 0;
    /// The load case that is pushed; 0: none.
    int PushedCase() const;

    /// Curves of columns at axial forces from, to, compression positive; of ASCE 41 and FEMA 356.
    bool HasAxialCurves() const { return !IsChordCode(m_code); }
    std::array<std::optional<double>, 2> m_axial;
    /// Strength of what ties masonry spandrels; asked for where the model has masonry.
    bool HasMasonry() const;
    double m_tie = 0.0;

    /// Fully restrained connections of steel beams: asked for where there are such among the
    /// elements and the code is ASCE 41-17. 0: none.
    bool AsksConnection(const std::vector<int>& elements) const;
    static std::vector<std::string> ConnectionTexts();
    int m_connection = 0;
    std::array<std::optional<double>, 3> m_measures; // empty: of the frame; plates: none

    /// Code, level, forces of the first of the elements' stale types, the first connection among
    /// them, and each one's V of a push.
    void TakeStale(const std::vector<int>& elements);

    /// As the generator takes it. 1 done; 0 with the reason, `out` as it was.
    [[nodiscard]] int Read(std::vector<int> elements, T_CODE_REQUEST& out,
                           std::string& reason) const;
    /// The hinges themselves, in the document, by a push if one is asked for, which is told to
    /// `progress`. 0 as CCodeHinges.
    [[nodiscard]] int Generate(const T_CODE_REQUEST& request, const PUSH_PROGRESS_FN& progress,
                               T_CODE_HINGES& out, T_HINGE_REFUSAL& refusal) const;
    /// The same without a change of the document.
    [[nodiscard]] int Preview(const T_CODE_REQUEST& request, const PUSH_PROGRESS_FN& progress,
                              T_CODE_HINGES& out, T_HINGE_REFUSAL& refusal) const;

    T_UNITS Units() const { return m_doc.Data().Units(); }

private:
    int ReadConnection(T_CODE_REQUEST& request, std::string& reason) const;
    void TakeConnection(const std::optional<T_STEEL_CONNECTION>& connection);
    int Make(CDBDoc& doc, const T_CODE_REQUEST& request, const PUSH_PROGRESS_FN& progress,
             T_CODE_HINGES& out, T_HINGE_REFUSAL& refusal) const;
    CDBDoc& m_doc;
    std::map<int, std::vector<double>> m_pushed; // of the stale types that were taken
};

/// "push 1: largest change of V: element 4, 31.2 % (74.6 -> 108.4), target reached"; a line for
/// each push.
std::string CodeIterationsText(const T_CODE_HINGES& hinges, const T_UNITS& units);
