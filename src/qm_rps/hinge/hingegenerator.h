// Hinges of a type for elements, with the strengths of each element's section and material.
#pragma once

#include "qm_rps/hinge/axial/initialaxial.h"
#include "qm_rps/hinge/hingecontext.h"
#include "qm_rps/hinge/hingefindings.h"

/// One element's part of the calculation, in the document's current units. Links and point springs
/// have neither section nor material, nor a method for automatic strengths.
struct T_HINGE_ELEMENT {
    std::optional<T_SECT_D> section;
    std::optional<T_MATL_D> material;
    double memberLength = 0.0;
    const CHingeSources::T_RESULT* result = nullptr; // automatic strengths; outlives the generator
};

/// Why an element can't have a hinge of the type.
struct T_HINGE_REFUSAL {
    int element = 0;
    std::string key;  // IDS_CMD_IEHP_NO_ELEM, NO_SECT, NO_MATL, NO_MEMB, NO_WALL, NO_RBAR ...
    std::string why;  // "The element has no section. ..."
    std::string text; // "Element 7: The element has no section. ..."
};

class CHingeGenerator {
public:
    explicit CHingeGenerator(CDBDoc& doc) : m_doc(doc), m_context(HingeContextOf(doc)) {}

    /// Element, its kind, section, material, material class and member in this order; a wall type
    /// asks for a rectangle, a type of composite material takes concrete and steel too, a link or a
    /// point spring needs its kind alone. 1 found; 0 with the refusal, `out` unchanged.
    [[nodiscard]] int ReadElement(const T_PHGT_D& type, int element, T_HINGE_ELEMENT& out,
                                  T_HINGE_REFUSAL& refusal) const;

    /// For the pages of the I-end, of the J-end, and of both.
    using T_STRENGTHS = std::map<HINGE_END, CHingeSources::T_RESULT>;
    /// Automatic strengths of an element. Moments of components that no curve gives by the axial
    /// force are those at the axial force of the initial loads (of a static load case: `axialCase`)
    /// at their end, for a page of both ends at the mean of their forces; the others those without
    /// an axial force. 1 done; 0 with the refusal, `out` unchanged.
    [[nodiscard]] int CalcStrengths(const T_PHGT_D& type, int element, int axialCase,
                                    const T_HINGE_ELEMENT& e, T_STRENGTHS& out,
                                    T_HINGE_REFUSAL& refusal) const;

    /// The hinge of a type on an element: see PageStrength, for each end that has a curve of its
    /// own. Magnitudes. 1 done; 0 with the refusal, `out` unchanged.
    [[nodiscard]] int CalcHinge(int hingeType, int element, T_PHGE_D& out, T_HINGE_REFUSAL& refusal,
                                int axialCase = 0) const;

    /// Hinges of a type for elements as one undoable edit, or as a part of the one that is open. An
    /// element that has hinges keeps the key of the first; its others go. 1 done; 0 with the
    /// refusal of the first element that can't have one (element 0: the type does not exist or
    /// breaks a rule, or no element is named), the document unchanged.
    [[nodiscard]] int Generate(int hingeType, const std::vector<int>& elements,
                               T_HINGE_REFUSAL& refusal, int axialCase = 0);

    /// What is wrong with the hinges of a type, with the element in the field ("element 7"): the
    /// element can't have one, automatic strengths can't be calculated, stored strengths are stale.
    std::vector<T_FINDING> ElementFindings(int hingeType) const;

    /// Stored strengths that are not those of today: "My(+) 300, now 280; ..."; empty: they are, or
    /// none is stored, or today's can't be calculated. The J-end's have "J" before the component.
    std::string StaleText(const T_PHGE_D& hinge) const;
    /// Strengths have been generated for the hinge, or entered.
    static bool HasStrengths(const T_PHGE_D& hinge);

private:
    int AxialOf(int axialCase, int element, T_ENDS<double>& out, T_HINGE_REFUSAL& refusal) const;

    CDBDoc& m_doc;
    T_HINGE_CONTEXT m_context;
    mutable std::map<int, CInitialAxial> m_axial; // by load case, as they are asked for
};
