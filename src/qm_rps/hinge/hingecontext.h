// What a hinge type is judged against besides itself.
#pragma once

#include "qm_db/dbdoc.h"
#include "qm_rps/hinge/hingesources.h"

#include <memory>
#include <string>

struct T_HINGE_CONTEXT {
    bool altHysteresis = false; // alternative hysteresis models are in use
    bool strengthDegradation = false;
    bool gsd = false;        // section-based curves are switched on ...
    bool gsdAllowed = false; // ... and the product allows them
    std::string concreteCode, steelCode;
    T_UNITS units;                  // of the type
    T_SIDES<double> alpha1, alpha2; // stiffness reduction ratios of new multilinear curves
    /// In the units of the type; null: references and automatic strengths are not judged.
    std::shared_ptr<const CHingeSources> sources;
};

/// Options, design codes, sections and materials of a document, in its current units.
T_HINGE_CONTEXT HingeContextOf(CDBDoc& doc);
