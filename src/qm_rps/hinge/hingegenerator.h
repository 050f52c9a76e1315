// Hinges of a type for elements, with the strengths of each element's section and material.
#pragma once

#include "qm_rps/hinge/hingecontext.h"
#include "qm_rps/hinge/hingefindings.h"

/// One element's part of the calculation, in the document's current units.
struct T_HINGE_ELEMENT {
    T_SECT_D section;
    T_MATL_D material;
    double memberLength = 0.0;
    const CHingeSources::T_RESULT* result = nullptr; // automatic strengths; owned by the sources
};

/// Why an element can't have a hinge of the type; text filled in, starting with the element.
struct T_HINGE_REFUSAL {
    int element = 0;
    std::string key;  // IDS_CMD_IEHP_NO_ELEM, NO_SECT, NO_MATL, NO_MEMB, NO_WALL, NO_RBAR ...
    std::string text; // "Element 7: The element has no section. ..."
};

class CHingeGenerator {
public:
    explicit CHingeGenerator(CDBDoc& doc) : m_doc(doc), m_sources(HingeContextOf(doc).sources) {}

    /// Element, section, material and member in this order; a wall type asks for a rectangle.
    /// 1 found; 0 with the refusal, `out` unchanged.
    [[nodiscard]] int ReadElement(const T_PHGT_D& type, int element, T_HINGE_ELEMENT& out,
                                  T_HINGE_REFUSAL& refusal) const;

    /// The hinge of a type on an element. Yield strengths per component: entered ones from the
    /// curve of the first page, automatic ones from section and material. Crack strengths: entered
    /// P1 of a trilinear curve; there is no method for automatic ones, which stay 0. Magnitudes.
    /// 1 done; 0 with the refusal, `out` unchanged.
    [[nodiscard]] int CalcHinge(int hingeType, int element, T_PHGE_D& out,
                                T_HINGE_REFUSAL& refusal) const;

    /// Hinges of a type for elements as one undoable edit. An element that has hinges keeps the key
    /// of the first; its others go. 1 done; 0 with the refusal of the first element that can't have
    /// one (element 0: the type does not exist or no element is named), the document unchanged.
    [[nodiscard]] int Generate(int hingeType, const std::vector<int>& elements,
                               T_HINGE_REFUSAL& refusal);

    /// Automatic strengths that can't be calculated on the elements that use the type; what is
    /// missing comes with the element in the field ("element 7"). None for a type whose strengths
    /// are entered.
    std::vector<T_FINDING> ElementFindings(int hingeType) const;

    /// Entered yield strength of a side: P2 of a trilinear curve, else P1; of a backbone its own.
    static double EnteredYield(const T_SKEL_SIDE& side, SKEL_TYPE type);
    static double EnteredYield(const T_SKEL_MULTI_SIDE& side, SKEL_TYPE type);

private:
    CDBDoc& m_doc;
    std::shared_ptr<const CHingeSources> m_sources;
};
