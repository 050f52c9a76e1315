// Members: elements in a row that share a member number.
#pragma once

#include "qm_db/datactrl.h"

class CMembCtrl {
public:
    explicit CMembCtrl(const CDataCtrl& data) : m_data(data) {}

    /// Length of the member that contains the element, the sum of its elements' lengths, in the
    /// current length unit; an element of member 0 is alone. 1 done; 0 there is no such element,
    /// or an element of the member lacks a node; output as it was.
    [[nodiscard]] int GetMembLengByIncludeElem(int element, double& length) const;

private:
    const CDataCtrl& m_data;
};
