// Model of the window with the curves of sections: moment-curvature, interaction, surface.
#pragma once

#include "qm_base/mdialog.h"
#include "qm_db/dbdoc.h"
#include "qm_rps/dialog/texttable.h"
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
    void OnChanged() { m_answers.clear(); }

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

private:
    struct T_PAGE {
        std::optional<T_SECTION_ANSWER> answer;
        std::string reason;
    };
    const T_PAGE& Page(SECTION_TASK task);
    bool ReadAxial(std::vector<double>& out) const;

    CDBDoc& m_doc;
    std::vector<T_SECTION_PAIR> m_pairs;
    int m_pair = -1;
    std::map<SECTION_TASK, T_PAGE> m_answers;
};
