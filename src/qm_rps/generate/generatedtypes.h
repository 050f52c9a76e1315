// How the generated hinge types of a document stand to it, for lists.
#pragma once

#include "qm_rps/generate/codehinges.h"

/// State: what was found for the present state of the document, so that a list may ask for each
/// row. The document must outlive the object.
class CGeneratedTypes {
public:
    explicit CGeneratedTypes(CDBDoc& doc) : m_doc(doc) {}

    /// Why the numbers of a type are not those that its code gives today; empty: they are, or it
    /// was not generated.
    const std::string& Fault(int hingeType);
    /// "ASCE41-17", "EN1998-3, secondary"; empty: it was not generated.
    std::string CodeText(int hingeType) const;
    /// Elements of all stale types.
    std::vector<int> StaleElements();

private:
    struct T_FOUND {
        CODE_TYPE_STATE state = CODE_TYPE_STATE::Fresh;
        std::string fault;
    };
    const T_FOUND& Find(int hingeType);

    CDBDoc& m_doc;
    long m_revision = -1;
    std::map<int, T_FOUND> m_found; // of all generated types
};
