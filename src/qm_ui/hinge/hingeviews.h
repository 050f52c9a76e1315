// Windows of the hinge editors: each function registers the views of a group of dialog models.
#pragma once

#include "qm_ui/form/viewfactory.h"

/// Lists: hinge types, generated hinges with the options of their strengths, the older table.
void RegisterHingeListViews(CViewFactory& factory);
/// Hinge type editor.
void RegisterHingeTypeView(CViewFactory& factory);
/// Curve editors: FEMA with its list of axial forces, multilinear, Eurocode.
void RegisterHingeFemaViews(CViewFactory& factory);
void RegisterHingeMultiView(CViewFactory& factory);
void RegisterHingeEuroView(CViewFactory& factory);
/// Yield surface and user P-M interaction.
void RegisterHingeInteractionViews(CViewFactory& factory);
/// Lengths, integration points, span, masonry.
void RegisterHingeLengthViews(CViewFactory& factory);
/// Options of hinges and design codes of the model.
void RegisterHingeOptionsView(CViewFactory& factory);
/// Hinges of members as a code gives them.
void RegisterCodeHingeView(CViewFactory& factory);
/// Options of the yield strength calculation and their descriptions.
void RegisterHingeStrengthViews(CViewFactory& factory);
