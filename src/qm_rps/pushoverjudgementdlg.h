// Model of the window that shows every member end judged at what an evaluation has found.
#pragma once

#include "qm_base/mdialog.h"
#include "qm_rps/dialog/texttable.h"
#include "qm_rps/judge/judgementtable.h"
#include "qm_rps/judge/ratiobands.h"
#include "qm_rps/judgedevaluation.h"

#include <functional>

class CPushOverJudgementDlg : public zql::frx::MDialog {
public:
    explicit CPushOverJudgementDlg(CDBDoc& doc) : m_doc(doc), m_scene(doc) {}

    /// Judges the ends at the points of a result. 1 judged; 0 `error` says why not, what is shown
    /// stays.
    [[nodiscard]] int OnJudge(const T_PUSH_EVALUATION& result, const PUSH_PROGRESS_FN& progress,
                              std::string& error);

    /// "that of the hinges", then every code, for all members.
    std::vector<std::string> CodeTexts() const;
    int CodeIndex() const;
    /// Judges again; the latest choice that could be judged stays.
    void OnSelChangeCode(int index);

    std::vector<std::string> StateTexts() const;
    int StateIndex() const { return m_state; } // -1: none
    void OnSelChangeState(int index);
    /// Ends by verdict; why a state has none.
    std::string CountText() const;
    T_TEXT_TABLE Table() const;
    VERDICT VerdictAt(std::size_t row) const;
    /// The first end beyond each limit state, displacements and ground accelerations.
    std::string LimitsText() const;
    std::string NotesText() const;
    std::string TitleText() const;
    /// The verdict of all limit states, and what must be said with it.
    std::string VerdictText() const;

    /// Asks for a file to write; set by the application. Empty: cancelled.
    std::function<std::string()> m_askFile;
    /// Writes the rows of all limit states as .xlsx or, with another ending, as values with commas.
    /// 1 written, or cancelled; 0 with a message.
    int OnExport();

    /// The shown state on the frame; null: none is shown.
    const T_JUDGED_STATE* State() const;
    const T_JUDGEMENT& Judgement() const { return m_judgement; }
    const T_FRAME_SCENE& Scene() { return m_scene.Scene(); }
    const T_RATIO_BANDS& Bands() const { return m_bands; }

private:
    CDBDoc& m_doc;
    CFrameScene m_scene;
    T_PUSH_EVALUATION m_result;
    T_JUDGE_OPTIONS m_options;
    T_JUDGEMENT m_judgement;
    T_RATIO_BANDS m_bands;
    int m_state = -1;
};
