// Model of the hinge type editor: choices that are offered together, one curve editor per
// component, the editors of the type's other parts, and the check of the whole type before it is
// stored.
#pragma once

#include "qm_base/checkeddialog.h"
#include "qm_rps/hinge/hingechoices.h"
#include "qm_rps/hinge/hingelabels.h"
#include "qm_rps/hinge/hingepages.h"

#include <functional>

class CPO_HingeTypeDlg : public CCheckedDialog {
public:
    /// A section or material that the type can refer to.
    struct T_REF_ENTRY {
        int key = 0;
        std::string text; // "3 : wall 30"
        bool operator==(const T_REF_ENTRY&) const = default;
    };
    using T_REF_LIST = std::vector<T_REF_ENTRY>;

    explicit CPO_HingeTypeDlg(T_HINGE_CONTEXT context);

    /// Writes the record to the document. 1 stored; 0 not. Unset: OnApply refuses.
    std::function<int(const T_PHGT_D&)> m_store;
    /// Opens the options of the model. The new context; empty: nothing was changed.
    std::function<std::optional<T_HINGE_CONTEXT>()> m_editOptions;
    double m_memberLength = 0.0;           // of the first element that uses the type; 0: none does
    std::vector<std::string> m_otherNames; // of other types; the name must be unlike them

    /// Takes the record. A component whose curve type is not offered gets the first that is.
    void Data2Dlg(const T_PHGT_D& data);
    /// Checks, then writes the whole record. 0: `data` as it was.
    [[nodiscard]] int Dlg2Data(T_PHGT_D& data);
    /// Checks and stores; a warning (HingeTypeWarnings) is shown and goes on. 0: a finding was
    /// shown, or the document refused.
    [[nodiscard]] int OnApply();
    int OnOK() override { return OnApply(); }
    /// The document has changed: options, codes and sections are read again, lists filled again.
    void OnUpdate(T_HINGE_CONTEXT context);

    const T_PHGT_D& Type() const { return m_type; }
    /// The type as edited, for members that nothing else follows: name, references, flags.
    T_PHGT_D& Edited() { return m_type; }
    T_HINGE_OWNER Owner() const { return {m_type, m_context.units, m_context.sources}; }
    /// The page that the preview shows.
    CHingePages& Preview() { return m_preview; }

    /// See HingeTypeFindings, after the rule of the name. CheckData shows the first.
    std::vector<T_FINDING> Findings() const override;
    /// Opens the editor of what a finding is about. 0: it has none, or was cancelled.
    [[nodiscard]] int OnFinding(const T_FINDING& f);
    /// The part of the editor that a finding is about: "name", "My.type", "My.curve", a field of
    /// "yieldSurface.", "pmm." or "masonry.".
    static std::string FieldOf(const T_FINDING& f);

    /// Curve types that a component offers now, in their order.
    std::vector<T_SKCV_ENTRY> CustomizeSkcvCmb(HINGE_COMPONENT c) const;
    /// Position in that list of the component's curve type.
    int SelectedSkcv(HINGE_COMPONENT c) const;
    /// Chooses the entry at that position. 0: none there or disabled, nothing changed. A curve of
    /// another family starts from its defaults.
    [[nodiscard]] int OnSelChangeSkcv(HINGE_COMPONENT c, int index);
    /// Which parts are shown, and which of these can be used.
    T_PART_STATES CustomizeDlgByMode() const;
    /// Keys of the materials of a strength calculation that fit the material class.
    static std::vector<const char*> InitComboByMaterialType(MATL_CLASS material);
    /// See StiffnessRows; with m_memberLength.
    std::vector<T_STIFFNESS_ROW> UpdateInitialStiffness() const;
    /// A row of them as texts: component, page, option, K(+) and K(-) with their unit.
    std::array<std::string, 5> StiffnessCells(const T_STIFFNESS_ROW& row) const;
    /// What the strengths of the material class are calculated as: "Concrete, Steel".
    std::string StrengthMaterials() const;

    // Sections of the document. Fibres of frames: any with dimensions. Fibres of walls, wall
    // sections and thicknesses: rectangles; the thickness (text "2 : 0.3") is the smaller side.
    T_REF_LIST InitFiberCombo_Fibr() const;
    T_REF_LIST InitFiberCombo_Fibw() const;
    T_REF_LIST InitPropCombo_Sect() const;
    T_REF_LIST InitPropCombo_Thik() const;
    /// Materials of the document that fit the material class, and the one that is chosen.
    T_REF_LIST InitPropCombo_Matl() const;

    // What changes the lists of curve types fills them again.
    void OnSelChangeElement(HINGE_ELEMENT element);
    void OnSelChangeDefinition(HINGE_DEFINITION definition);
    void OnSelChangeMaterial(MATL_CLASS material);

    /// Puts the component back to its defaults, active or not as it was: the first curve type that
    /// is offered, 6EI/L for bending and the elastic stiffness else, Fx and Mx at the centre
    /// (links, springs and trusses all), the others at both ends.
    void InitDataByDof(HINGE_COMPONENT c);
    /// The same for every active component; the button asks first. 0: no.
    void InitDataCheckedAll();
    [[nodiscard]] int OnBtnDefaults();
    /// Opens the options of the model. 0: nothing was changed.
    [[nodiscard]] int OnBtnOptions();

    void OnComponentCtrl(HINGE_COMPONENT c, bool active);
    void OnLocationCtrl(HINGE_COMPONENT c, HINGE_LOCATION location);
    /// J-end as I-end, or on its own (starting from the I-end's curve).
    void OnIJSymmetryRdo(HINGE_COMPONENT c, bool sameEnds);

    // Open an editor in the view. 1 accepted and taken; 0 not.
    [[nodiscard]] int OnBtnSkcvProp(HINGE_COMPONENT c);
    [[nodiscard]] int OnYieldSurfaceDlgDlg();
    [[nodiscard]] int OnUserInteractionDlg();
    [[nodiscard]] int OnMasonryPropDlg();
    [[nodiscard]] int OnBtnIntegrationPoint();
    /// Moment-rotation or moment-curvature lengths, by the definition.
    [[nodiscard]] int OnBtnHingeLength();
    [[nodiscard]] int OnBtnAlphaYSpan();

    /// Masonry properties on (with defaults) or off.
    void OnMasonryChk(bool on);
    /// Strut form of the FEMA curves of Fx, on every page.
    void OnInfillStrutChk(bool on);
    bool IsInfillStrut() const;

    /// Position among kInteractions to record code. 0: no such position.
    [[nodiscard]] static int ConvertInteraction(int index, HINGE_INTERACTION& code);
    /// Record code to position.
    static int ConvertInteraction(HINGE_INTERACTION code);
    /// The interaction of My or of Mz; the other one keeps its own. 0: not offered.
    [[nodiscard]] int OnSelChangeInteraction(HINGE_COMPONENT c, int index);

    /// Lengths of a component at the ends that need one, "I 0.3, J 0.25"; empty where none does.
    std::string GetHingeLength_MTheta(HINGE_COMPONENT c) const; // My and Mz alone
    std::string GetHingeLength_MPhi(HINGE_COMPONENT c) const;
    /// Those of all components: "My: I 0.3, J 0.25; Mz: I 0.3"; "-" where none needs one.
    std::string HingeLengthsText() const;
    /// Key of what the lengths are: Lpl, or Lv with the alternative hysteresis models.
    const char* HingeLengthCaption() const
    {
        return HingeLengthCaptionKey(m_context.altHysteresis);
    }

private:
    void RefillSkcv();
    std::string LengthText(HINGE_COMPONENT c, const T_ENDS<double>& length) const;

    T_HINGE_CONTEXT m_context;
    T_PHGT_D m_type;
    CHingePages m_preview{m_type};
};
