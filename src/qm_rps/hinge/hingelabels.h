// Names and units that the editors of hinges show.
#pragma once

#include "qm_rps/dialog/unithead.h"
#include "qm_rps/hinge/hingesources.h"

#include <memory>
#include <string>
#include <vector>

/// The type that an editor of one of its parts belongs to, the units of its values, and what its
/// automatic strengths are calculated from (null: nothing is).
struct T_HINGE_OWNER {
    T_PHGT_D type;
    T_UNITS units;
    std::shared_ptr<const CHingeSources> sources{};
};

/// Text of an element type; a value outside the five is shown as an error, not refused.
std::string ElementText(HINGE_ELEMENT element);

/// HeadWithUnit of a strength, a deformation (a rotation in rad) and a stiffness of a component.
std::string StrengthHead(const std::string& name, HINGE_COMPONENT c, const T_HINGE_OWNER& owner);
std::string DeformHead(const std::string& name, HINGE_COMPONENT c, const T_HINGE_OWNER& owner);
std::string StiffnessHead(const std::string& name, HINGE_COMPONENT c, const T_HINGE_OWNER& owner);
/// Key of the yield deformation's name: displacement, rotation, curvature or strain.
const char* YieldDeformKey(HINGE_COMPONENT c, HINGE_DEFINITION definition);

/// "Moment - Rotation (M-%s)", "Moment - Curvature (M-%s Lumped)" or "... Distributed)" with the
/// component's rotation symbol Rx, Ry or Rz; empty for a force.
std::string HingeModelLabel(HINGE_DEFINITION definition, HINGE_COMPONENT c);
/// Key of the name of a hinge length.
const char* HingeLengthCaptionKey(bool altHysteresis);
/// A criterion as shown: its value, or that the criteria are not in use.
std::string CriterionText(bool inUse, double value);

/// Initial stiffness options of a component: 6EI/L, 3EI/L, 2EI/L and user of bending, the elastic
/// stiffness and user of the others.
std::vector<INIT_STIFFNESS> StiffnessOptions(HINGE_COMPONENT c);
std::vector<std::string> StiffnessTexts(HINGE_COMPONENT c);
/// Position of an option in that list; -1: the component has no such. Of Fx and Mx every option
/// but user is the elastic stiffness.
int StiffnessPosition(HINGE_COMPONENT c, INIT_STIFFNESS option);
