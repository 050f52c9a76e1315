// The pages of a hinge type's active components, and which of them is on show.
#pragma once

#include "qm_rps/hinge/hingefindings.h"

/// The type is not owned; it may change between any two calls.
class CHingePages {
public:
    struct T_PAGE {
        HINGE_COMPONENT component = HINGE_COMPONENT::Fx;
        HINGE_END end = HINGE_END::Both;
        std::string text; // "My: Properties, I-end"
    };

    explicit CHingePages(const T_PHGT_D& type) : m_type(type) {}

    std::vector<T_PAGE> All() const;
    /// Position of the page on show; -1: no component is active.
    int Shown() const;
    void Show(int index) { m_page = index; }
    void ShowFirstOf(HINGE_COMPONENT c);
    /// The curve of the page on show, or null.
    const T_SKEL_CURVE* Curve() const;

private:
    const T_PHGT_D& m_type;
    int m_page = 0;
};
