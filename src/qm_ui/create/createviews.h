// Windows that make models and parts of them: each function registers the views of one subject.
#pragma once

#include "qm_ui/form/viewfactory.h"

/// A model of a pasted capacity curve.
void RegisterCurveWizardView(CViewFactory& factory);
/// A spectrum of the model.
void RegisterSpectrumView(CViewFactory& factory);
/// Storeys from the levels of nodes.
void RegisterStoreyGuideView(CViewFactory& factory);
/// Modes by analysis or typed.
void RegisterModesView(CViewFactory& factory);
/// The regular frame of a building.
void RegisterFrameGuideView(CViewFactory& factory);
