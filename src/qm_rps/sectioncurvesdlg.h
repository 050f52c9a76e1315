// Model of the window with the curves of sections: moment-curvature, interaction, surface; and with
// the check of given forces.
#pragma once

#include "qm_base/mdialog.h"
#include "qm_db/dbdoc.h"
#include "qm_rps/dialog/texttable.h"
#include "qm_rps/section/sectioncheck.h"
#include "qm_rps/section/sectioncurves.h"

#include <functional>
#include <map>

class CSectionCurvesDlg : public zql::frx::MDialog {
public:
    /// Shows the first section that has a material.
    explicit CSectionCurvesDlg(CDBDoc& doc);

    /// "column 40x40, C25/30", section by section with its materials.
    std::vector<std::string> PairTexts() const;
    int PairIndex() const { return m_pair; } // -1: no section has a material
    void OnSelChangePair(int index);
    /// The first pair with this section; nothing where there is none.
    void OnOpenSection(int section);

    /// What all pages are calculated with; OnChanged after a change of a member.
    T_SECTION_OPTIONS m_options;
    double m_directionDeg = 0.0;
    std::string m_axial = "0"; // in units of the document, with blanks between them
    void OnChanged();

    /// The result of a page; calculated when it is asked for. None: ReasonOf says why not.
    const T_SECTION_ANSWER* Answer(SECTION_TASK task);
    /// Why a page has no result; what its warnings are; else empty.
    std::string ReasonOf(SECTION_TASK task);
    /// States where the page has any, else points.
    T_TEXT_TABLE Table(SECTION_TASK task);
    T_UNITS Units() const { return m_doc.Data().Units(); }

    /// Asks for a file to write; set by the application. Empty: cancelled.
    std::function<std::string()> m_askFile;
    /// Writes the points of a page as .xlsx or, with another ending, as values with commas. 1
    /// written, or cancelled; 0 with a message.
    int OnExport(SECTION_TASK task);

    // ---- given forces ----
    /// Sets in units of the document, the first one without forces; the chosen one, -1: none.
    std::vector<T_SECTION_FORCES> m_sets;
    int m_set = 0;
    /// A name, then the forces in the order of kSectionForces.
    static constexpr std::size_t kSetColumns = 1 + kSectionForces.size();
    std::string SetHead(std::size_t column) const;
    std::string SetText(std::size_t row, std::size_t column) const;
    /// 1 taken; 0 no such cell, or no finite number.
    int SetCell(std::size_t row, std::size_t column, const std::string& text);
    void OnNewSet();
    void OnDeleteSet();
    /// Asks for a file to read; set by the application. Empty: cancelled.
    std::function<std::string()> m_askSets;
    /// Puts the sets of a file (ReadForceSets), or the results of m_loadCase in m_elements that
    /// have the shown section (ForcesOfMembers), in place of the sets. 1 done, or cancelled; 0 with
    /// a message.
    int OnReadSets();
    int OnTakeResults();
    std::vector<std::string> LoadCases() const; // and combinations
    int m_loadCase = 0;
    std::string m_elements; // "1,5-9"; empty: all
    bool m_byRatio = false; // the worst set first; OnChanged after a change, as for the two below
    /// Whose rules beside those of no code: 0 all that fit, 1 the first of kSectionCheckCodeNames.
    int m_checkCode = 0;
    double m_cotTheta = 1.0;
    bool IsConcrete() const; // its shear asks for cot theta

    /// Sets and ways of checking, with ratios and verdicts.
    T_TEXT_TABLE Ways();
    const T_SECTION_WAY* WayAt(std::size_t row);
    int Way() const { return m_way; } // chosen row; -1: none
    void OnWay(int row);
    /// Every number of the chosen way.
    T_TEXT_TABLE WayTrace();
    /// Section, strengths and warnings; or why nothing was checked.
    std::string CheckText();
    /// As OnExport: the table of the command that checks sections.
    int OnExportCheck();

private:
    template <class T>
    struct T_PAGE {
        std::optional<T> answer;
        std::string reason;
    };
    const T_PAGE<T_SECTION_ANSWER>& Page(SECTION_TASK task);
    const T_PAGE<T_SECTION_CHECK>& Checked();
    std::size_t WayCount();
    int TakeSets(std::vector<T_SECTION_FORCES> sets);
    bool ReadAxial(std::vector<double>& out) const;
    int Export(const std::function<T_TEXT_TABLE()>& table);

    CDBDoc& m_doc;
    std::vector<T_SECTION_PAIR> m_pairs;
    int m_pair = -1;
    std::map<SECTION_TASK, T_PAGE<T_SECTION_ANSWER>> m_answers;
    std::optional<T_PAGE<T_SECTION_CHECK>> m_check;
    int m_way = -1;
};
