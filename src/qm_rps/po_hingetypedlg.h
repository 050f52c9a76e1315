// Model of the hinge type editor: choices that are offered together, one curve editor per
// component, and the check of the whole type before it is stored.
#pragma once

#include "qm_base/mdialog.h"
#include "qm_rps/hingefindings.h"

#include <functional>

/// What a hinge type is judged against besides itself.
struct T_HINGE_CONTEXT {
    bool altHysteresis = false; // alternative hysteresis models are in use
    bool strengthDegradation = false;
    bool gsd = false;        // section-based curves are switched on ...
    bool gsdAllowed = false; // ... and the product allows them
    std::string concreteCode, steelCode;
    /// Section and material of a key, null where there is none; unset: references are not checked.
    std::function<const T_SECT_D*(int key)> section;
    std::function<const T_MATL_D*(int key)> material;
    /// Adds what the yield surface and the user interaction curves do not keep; may be unset.
    std::function<void(const T_PHGT_D&, std::vector<T_FINDING>&)> interactionFindings;
};

class CPO_HingeTypeDlg : public zql::frx::MDialog {
public:
    struct T_SKCV_ENTRY {
        const char* key; // of its text
        SKEL_TYPE code;
        bool enabled = true;
        bool operator==(const T_SKCV_ENTRY&) const = default;
    };
    using T_LENGTH_STATE = std::array<T_ENDS<bool>, 6>;

    explicit CPO_HingeTypeDlg(T_HINGE_CONTEXT context);

    /// Takes the record. A component whose curve type is not offered gets the first that is.
    void Data2Dlg(const T_PHGT_D& data);
    /// Checks, then writes the whole record. 0: `data` as it was.
    [[nodiscard]] int Dlg2Data(T_PHGT_D& data);
    const T_PHGT_D& Type() const { return m_type; }
    void SetName(const std::string& name) { m_type.name = name; }
    void SetSection(int section, int material);
    T_HINGE_LENGTH& Length() { return m_type.length; }
    void SetMasonry(const std::optional<T_MASONRY_HINGE>& masonry) { m_type.masonry = masonry; }

    /// Curve types that a component of such a type offers, in their order.
    static std::vector<T_SKCV_ENTRY> CustomizeSkcvCmb(const T_PHGT_D& type, HINGE_COMPONENT c,
                                                      const T_HINGE_CONTEXT& context);
    /// Position in its list of the component's curve type.
    int SelectedSkcv(HINGE_COMPONENT c) const;
    /// Keys of the materials of a strength calculation that fit the material class.
    static std::vector<const char*> InitComboByMaterialType(MATL_CLASS material);

    // What changes the lists of curve types fills them again.
    void OnSelChangeElement(HINGE_ELEMENT element);
    void OnSelChangeDefinition(HINGE_DEFINITION definition);
    void OnSelChangeMaterial(MATL_CLASS material);

    void OnComponentCtrl(HINGE_COMPONENT c, bool active);
    void OnLocationCtrl(HINGE_COMPONENT c, HINGE_LOCATION location);
    /// J-end as I-end, or on its own (starting from the I-end's curve).
    void OnIJSymmetryRdo(HINGE_COMPONENT c, bool sameEnds);
    /// Chooses the entry at that position. 0: none there or disabled, nothing changed. A curve of
    /// another family starts from its defaults.
    [[nodiscard]] int OnSelChangeSkcv(HINGE_COMPONENT c, int index);
    /// Opens the editor of the component's curve in the view. 1 accepted and taken; 0 not.
    [[nodiscard]] int OnBtnSkcvProp(HINGE_COMPONENT c);

    /// The bending components offer these interactions, in this order; My and Mz share one.
    static constexpr std::array<HINGE_INTERACTION, 4> kBendingInteractions{
        HINGE_INTERACTION::P, HINGE_INTERACTION::MyMz, HINGE_INTERACTION::PMM,
        HINGE_INTERACTION::User};
    /// Position in that list to record code. 0: no such position.
    [[nodiscard]] static int ConvertInteraction(int index, HINGE_INTERACTION& code);
    /// Record code to position; -1 for one that bending does not offer.
    static int ConvertInteraction(HINGE_INTERACTION code);
    [[nodiscard]] int OnSelChangeInteraction(int index);

    /// Which components need a hinge length at the I-end and the J-end.
    static T_LENGTH_STATE GetHingeLengthEnableState(const T_PHGT_D& type, bool altHysteresis);
    static const char* HingeLengthCaptionKey(bool altHysteresis);
    bool IsHingeLengthEnabled() const;

    /// Everything that a type does not keep: name, references, curves of all active components and
    /// ends, masonry, interaction. CheckData shows the first.
    static std::vector<T_FINDING> TypeFindings(const T_PHGT_D& type,
                                               const T_HINGE_CONTEXT& context);
    std::vector<T_FINDING> Findings() const { return TypeFindings(m_type, m_context); }
    int CheckData() override;

private:
    T_HINGE_COMPONENT& At(HINGE_COMPONENT c);
    void RefillSkcv();

    T_HINGE_CONTEXT m_context;
    T_PHGT_D m_type;
};
