// Model of the hinge type editor: choices that are offered together, one curve editor per
// component, the editors of the type's other parts, and the check of the whole type before it is
// stored.
#pragma once

#include "qm_base/checkeddialog.h"
#include "qm_rps/hinge/hingecontext.h"
#include "qm_rps/hinge/hingefindings.h"
#include "qm_rps/hinge/hingelabels.h"

#include <functional>

class CPO_HingeTypeDlg : public CCheckedDialog {
public:
    struct T_SKCV_ENTRY {
        const char* key; // of its text
        SKEL_TYPE code;
        bool enabled = true;
        bool operator==(const T_SKCV_ENTRY&) const = default;
    };
    /// A section that the type can refer to.
    struct T_REF_ENTRY {
        int key = 0;
        std::string text; // "3 : wall 30"
        bool operator==(const T_REF_ENTRY&) const = default;
    };
    using T_REF_LIST = std::vector<T_REF_ENTRY>;
    using T_LENGTH_STATE = std::array<T_ENDS<bool>, 6>;
    /// Initial stiffness of a page of a component; empty where its data are missing.
    struct T_STIFFNESS_ROW {
        HINGE_COMPONENT component = HINGE_COMPONENT::Fx;
        HINGE_END end = HINGE_END::Both;
        INIT_STIFFNESS option = INIT_STIFFNESS::EI6L;
        T_SIDES<std::optional<double>> stiffness;
    };
    /// Parts of the editor besides the components' rows.
    enum class PART {
        Interaction,     // of My and Mz
        YieldSurface,    // OnYieldSurfaceDlgDlg
        UserInteraction, // P-M curves of the user
        Section,         // InitPropCombo_Sect, under "IDS_CMD_IEHP_SECT_TXT"
        Thickness,       // InitPropCombo_Thik, under "IDS_CMD_IEHP_THIK_TXT"
        FibreFrame,      // InitFiberCombo_Fibr
        FibreWall,       // InitFiberCombo_Fibw
        IntegrationPoints,
        HingeLength,
        Location,
        Masonry,
        InfillStrut, // choice of the strut form in Fx
        Count
    };
    struct T_PART_STATE {
        bool shown = false, enabled = false;
        bool operator==(const T_PART_STATE&) const = default;
    };
    using T_MODE = std::array<T_PART_STATE, static_cast<std::size_t>(PART::Count)>;

    /// A page of an active component, as the preview offers it.
    struct T_PAGE {
        HINGE_COMPONENT component = HINGE_COMPONENT::Fx;
        HINGE_END end = HINGE_END::Both;
        std::string text; // "My: Properties, I-end"
    };

    explicit CPO_HingeTypeDlg(T_HINGE_CONTEXT context);

    /// Writes the record to the document. 1 stored; 0 not. Unset: OnApply refuses.
    std::function<int(const T_PHGT_D&)> m_store;

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

    std::vector<std::string> m_otherNames; // of other types; the name must be unlike them

    const T_PHGT_D& Type() const { return m_type; }
    T_HINGE_OWNER Owner() const { return {m_type, m_context.units}; }

    /// What each component offers now, and the interactions in the order of their list.
    std::vector<T_SKCV_ENTRY> CurveTypes(HINGE_COMPONENT c) const
    {
        return CustomizeSkcvCmb(m_type, c, m_context);
    }
    static std::vector<std::string> InteractionTexts();
    /// The part of the editor that a finding is about: "name", "My.type", "My.curve", a field of
    /// "yieldSurface.", "pmm." or "masonry."; and its editor (0: it has none, or was cancelled).
    static std::string FieldOf(const T_FINDING& f);
    [[nodiscard]] int OnFinding(const T_FINDING& f);

    std::vector<T_PAGE> Pages() const;
    /// Position of the page on show; -1: no component is active.
    int Page() const;
    void ShowPage(int index) { m_page = index; }
    void ShowPageOf(HINGE_COMPONENT c);
    /// The curve of the page on show, or null.
    const T_SKEL_CURVE* PageCurve() const;
    void SetName(const std::string& name) { m_type.name = name; }
    void SetSection(int section, int material);
    void SetFibreSection(int section) { m_type.fibreSection = section; }
    void SetThicknessSection(int section) { m_type.thicknessSection = section; }
    T_HINGE_LENGTH& Length() { return m_type.length; }
    void SetMasonry(const std::optional<T_MASONRY_HINGE>& masonry) { m_type.masonry = masonry; }

    /// Curve types that a component of such a type offers, in their order.
    static std::vector<T_SKCV_ENTRY> CustomizeSkcvCmb(const T_PHGT_D& type, HINGE_COMPONENT c,
                                                      const T_HINGE_CONTEXT& context);
    /// Key of the text of a curve type; a code outside the list is shown as an error.
    static const char* SkcvKey(SKEL_TYPE code);
    /// Position in its list of the component's curve type.
    int SelectedSkcv(HINGE_COMPONENT c) const;
    /// Keys of the materials of a strength calculation that fit the material class.
    static std::vector<const char*> InitComboByMaterialType(MATL_CLASS material);

    // Sections of the document. Fibres of frames: any with dimensions. Fibres of walls, wall
    // sections and thicknesses: rectangles; the thickness (text "2 : 0.3") is the smaller side.
    T_REF_LIST InitFiberCombo_Fibr() const;
    T_REF_LIST InitFiberCombo_Fibw() const;
    T_REF_LIST InitPropCombo_Sect() const;
    T_REF_LIST InitPropCombo_Thik() const;
    /// Materials of the document.
    T_REF_LIST InitPropCombo_Matl() const;

    /// Which parts are shown, and which of these can be used, for the element type, definition,
    /// material class, interaction and components.
    T_MODE CustomizeDlgByMode() const;
    /// Degrees of freedom that the element type has: a truss Fx alone, others all.
    static bool HasComponent(HINGE_ELEMENT element, HINGE_COMPONENT c);

    /// "Moment - Rotation (M-%s)", "Moment - Curvature (M-%s Lumped)" or "... Distributed)" with
    /// the component's rotation symbol Rx, Ry or Rz; empty for a force.
    static std::string HingeModelLabel(HINGE_DEFINITION definition, HINGE_COMPONENT c);

    /// A row per page of the active components, from section and material of the type and the span
    /// that the type gives, else `memberLength`.
    std::vector<T_STIFFNESS_ROW> UpdateInitialStiffness(double memberLength) const;

    // What changes the lists of curve types fills them again.
    void OnSelChangeElement(HINGE_ELEMENT element);
    void OnSelChangeDefinition(HINGE_DEFINITION definition);
    void OnSelChangeMaterial(MATL_CLASS material);

    /// Puts the component back to its defaults, active or not as it was: the first curve type that
    /// is offered, 6EI/L for bending and the elastic stiffness else, Fx and Mx at the centre
    /// (links, springs and trusses all), the others at both ends.
    void InitDataByDof(HINGE_COMPONENT c);
    /// The same for every active component.
    void InitDataCheckedAll();

    void OnComponentCtrl(HINGE_COMPONENT c, bool active);
    void OnLocationCtrl(HINGE_COMPONENT c, HINGE_LOCATION location);
    /// J-end as I-end, or on its own (starting from the I-end's curve).
    void OnIJSymmetryRdo(HINGE_COMPONENT c, bool sameEnds);
    /// Chooses the entry at that position. 0: none there or disabled, nothing changed. A curve of
    /// another family starts from its defaults.
    [[nodiscard]] int OnSelChangeSkcv(HINGE_COMPONENT c, int index);

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
    void OnWithholdMzChk(bool on) { m_type.withholdMzLength = on; }
    /// Strut form of the FEMA curves of Fx, on every page.
    void OnInfillStrutChk(bool on);
    bool IsInfillStrut() const;

    /// The bending components offer these interactions, in this order; My and Mz share one.
    static constexpr std::array<HINGE_INTERACTION, 4> kBendingInteractions{
        HINGE_INTERACTION::P, HINGE_INTERACTION::MyMz, HINGE_INTERACTION::PMM,
        HINGE_INTERACTION::User};
    /// Position in that list to record code. 0: no such position.
    [[nodiscard]] static int ConvertInteraction(int index, HINGE_INTERACTION& code);
    /// Record code to position; -1 for one that bending does not offer.
    static int ConvertInteraction(HINGE_INTERACTION code);
    [[nodiscard]] int OnSelChangeInteraction(int index);
    /// The curve type that fixes the levels of the yield surface: that of My, else of Mz.
    static SKEL_TYPE YieldSurfaceCurve(const T_PHGT_D& type);

    /// Which components need a hinge length at the I-end and the J-end.
    static T_LENGTH_STATE GetHingeLengthEnableState(const T_PHGT_D& type, bool altHysteresis);
    static const char* HingeLengthCaptionKey(bool altHysteresis);
    bool IsHingeLengthEnabled() const;
    /// Lengths of a component at the ends that need one, "I 0.3, J 0.25"; empty where none does.
    std::string GetHingeLength_MTheta(HINGE_COMPONENT c) const; // My and Mz alone
    std::string GetHingeLength_MPhi(HINGE_COMPONENT c) const;

    /// See HingeTypeFindings. CheckData shows the first.
    static std::vector<T_FINDING> TypeFindings(const T_PHGT_D& type,
                                               const T_HINGE_CONTEXT& context);
    /// The same with the rule of the name.
    std::vector<T_FINDING> Findings() const override;

private:
    T_HINGE_COMPONENT& At(HINGE_COMPONENT c);
    void RefillSkcv();
    std::string LengthText(HINGE_COMPONENT c, const T_ENDS<double>& length) const;

    T_HINGE_CONTEXT m_context;
    T_PHGT_D m_type;
    int m_page = 0;
};
