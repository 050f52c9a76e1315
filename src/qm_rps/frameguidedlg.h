// Model of the window that makes the regular frame of a building: bays, storeys, sections, loads;
// what follows, live, with a preview.
#pragma once

#include "qm_base/checkeddialog.h"
#include "qm_rps/create/building.h"
#include "qm_rps/desk/framescene.h"
#include "qm_rps/dialog/texttable.h"

#include <functional>
#include <memory>
#include <optional>

class CFrameGuideDlg : public CCheckedDialog {
public:
    /// The document must outlive the dialog. Starts with a small frame of concrete in kN, m.
    explicit CFrameGuideDlg(CDBDoc& doc);

    // ---- what is wanted; OnChange after each change ----
    T_BUILDING m_building; // but for its lists
    std::string m_baysX = "5, 5, 5", m_baysY = "4, 4", m_storeys = "3.5, 3, 3";
    std::string m_braceBays = "x1";
    int m_modes = 6;    // that are found at once; 0: none
    bool m_push = true; // pushover load cases, both ways along each direction
    void OnChange() { m_isMade = m_isTried = false; }
    bool IsPlane() const { return m_baysY.empty(); }
    T_UNITS Units() const { return m_building.units; }
    std::string LineUnit() const; // "kN/m"

    // ---- what follows ----
    /// The frame as it would be; empty while something is wrong.
    const T_FRAME_SCENE& Scene();
    /// Loads and masses by level, with their sums.
    T_TEXT_TABLE Levels();
    std::string NotesText();
    std::string CommandText();
    std::vector<T_FINDING> Findings() const override;
    const T_BUILDING_FACTS& Facts() const { return m_facts; }

    /// After OnOK: the modes that the pushover load cases take; empty: there are none.
    const std::string& PushText() const { return m_pushText; }
    /// After OnOK: whether all modes and load cases that were wanted are there.
    bool IsWhole() const { return m_isWhole; }

    /// Asked before the open model goes; 0: it stays. Set by the application.
    std::function<int()> m_mayReplace;
    /// Runs work that tells parts done of a total and stops where that asks it to (false); set by
    /// the application. Empty: it runs untold.
    using TELL_FN = std::function<bool(std::size_t, std::size_t)>;
    std::function<int(const std::function<int(TELL_FN)>&)> m_withProgress;
    /// Puts the frame into the document in place of what it has, finds its modes and makes its load
    /// cases. 0: refused with a message; where modes or load cases can't be had, the frame stays
    /// and a message says why. Messages also tell of an unusual period, and of a mode of the load
    /// cases that moves less than half of the mass.
    int OnOK() override;

private:
    void Update() const;
    [[nodiscard]] int ReadLists(T_BUILDING& out, T_FINDING& fault) const;
    int FindModes();
    int MakePushCases();

    CDBDoc& m_doc;
    std::string m_pushText;
    bool m_isWhole = false, m_hasLowMass = false;
    std::unique_ptr<CDBDoc> m_preview;
    CFrameScene m_scene;
    mutable bool m_isTried = false, m_isMade = false;
    mutable T_BUILDING m_asked;
    mutable T_MODEL_CONTENT m_content;
    mutable T_BUILDING_FACTS m_facts;
    mutable T_FINDING m_fault;
};
