// Model of the window that gives members the hinges of a code: which members, code and level; what
// they would get, number by number; then the hinges themselves.
#pragma once

#include "qm_base/mdialog.h"
#include "qm_rps/desk/codehingeoptions.h"
#include "qm_rps/desk/framescene.h"
#include "qm_rps/dialog/texttable.h"
#include "qm_rps/generate/codehingerows.h"
#include "qm_rps/generate/generatedtypes.h"

#include <functional>
#include <set>

class CCodeHingeDlg : public zql::frx::MDialog {
public:
    /// The document must outlive the dialog. No member is chosen.
    explicit CCodeHingeDlg(CDBDoc& doc);

    // ---- members ----
    const T_FRAME_SCENE& Scene() { return m_scene.Scene(); }
    /// By line of the scene.
    bool IsChosen(std::size_t line);
    std::size_t ChosenCount() const { return m_elements.size(); }
    /// Lines of the scene: one is taken or taken out again; those of a box are taken.
    void OnLine(std::size_t line);
    void OnLines(const std::vector<std::size_t>& lines);
    void OnAll(); // beams, and trusses of steel: other elements have no such hinges
    void OnNone();
    /// Members of types that are out of date, and what these were asked for.
    void OnStale();
    std::string ElementsText() const; // "1, 4-9"
    /// 0 with a message: no such list, or an element that the model does not have.
    [[nodiscard]] int OnElements(const std::string& text);

    // ---- code ----
    /// Names; with what a code is for where it is for some members alone.
    static std::vector<std::string> CodeTexts();
    CCodeHingeOptions m_options;
    bool AsksConnection() const { return m_options.AsksConnection(Chosen()); }
    /// After each change of the options.
    void OnOptions() { Forget(); }

    /// Runs work that tells parts done of a total and stops where that asks it to (false); set by
    /// the application. Empty: pushes run untold.
    using TELL_FN = std::function<bool(std::size_t, std::size_t)>;
    std::function<int(const std::function<int(TELL_FN)>&)> m_withProgress;

    // ---- what they would get ----
    /// Works the hinges out, with the pushes that they need; the document stays as it is. 0:
    /// StatusText says why not, and where what is missing is entered.
    int OnPreview();
    bool HasPreview() const { return !m_firsts.empty(); }
    /// A row for each type: section, member, elements.
    T_TEXT_TABLE Types() const;
    int Type() const { return m_type; } // chosen row; -1: none
    void OnType(int row);
    /// Ends, axes and sides of the chosen type.
    T_TEXT_TABLE Sides() const;
    int Side() const { return m_side; }
    void OnSide(int row);
    /// The curve of the chosen side's end and axis, in current units; null: none.
    struct T_SHOWN {
        T_PHGT_D type;
        HINGE_COMPONENT component = HINGE_COMPONENT::My;
        T_SKEL_CURVE curve;
        std::string page; // "I, J", "I"
    };
    const T_SHOWN* Shown() const { return m_shown ? &*m_shown : nullptr; }
    /// Every number of the chosen side: symbol, value, unit, formula, clause, mark.
    T_TEXT_TABLE Trace() const;
    /// The pushes, warnings of the chosen type and of the model, members that are left out; a line
    /// each.
    std::string WarningsText() const;
    std::string StatusText() const { return m_status; }

    // ---- the hinges themselves ----
    /// Generates them as one edit that can be undone. 0 with a message, the document as it was.
    [[nodiscard]] int OnApply();
    /// Members of types that are out of date get theirs again, by each type's code and level.
    [[nodiscard]] int OnRegenerate();
    bool HasStale() { return !m_types.StaleElements().empty(); }

private:
    std::vector<int> Chosen() const { return {m_elements.begin(), m_elements.end()}; }
    int WithProgress(const std::function<int(const PUSH_PROGRESS_FN&)>& work) const;
    void Forget();
    void Take(T_CODE_HINGES hinges);
    void Show();
    int Refuse(const T_HINGE_REFUSAL& refusal);
    std::vector<T_CODE_ROW_OF_HINGE> Rows() const;
    bool IsChord() const;

    CDBDoc& m_doc;
    CFrameScene m_scene;
    CGeneratedTypes m_types;
    std::set<int> m_elements;
    T_CODE_HINGES m_hinges;
    std::vector<const T_CODE_ELEMENT*> m_firsts; // of the types
    int m_type = -1, m_side = -1;
    std::optional<T_SHOWN> m_shown;
    std::string m_status;
};
