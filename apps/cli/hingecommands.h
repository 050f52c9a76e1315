// The commands on hinge types and pushover load cases.
#pragma once

#include "exitcodes.h"

#include <optional>
#include <string>
#include <vector>

struct T_HINGE_OPTIONS {
    std::string file;
    std::string type;                        // name of a hinge type; empty: all
    std::string component;                   // "Fx" to "Mz"
    std::string end;                         // "I" or "J"; empty: the first page
    std::string to;                          // "ddy" or "plastic"
    std::string elements;                    // "1,2,5-9"
    std::string axialCase;                   // assign: static load case; empty: the initial loads
    std::string out;                         // file to write: .json, .qmdb or a picture
    bool overwrite = false;                  // a file that is there
    bool interaction = false;                // plot: interaction instead of the backbone
    bool values = false;                     // interaction: forces and moments, not ratios
    bool box = false;                        // backbone: the small preview
    std::vector<double> add, remove, change; // axial forces; change: old and new
    // Options of the model: what is to be changed.
    std::optional<std::string> concreteCode, steelCode;
    std::string alternative, wallDegradation, gsd; // "on", "off"; empty: as it is
    std::vector<double> alpha1, alpha2;            // (+), (-)
};

EXIT_CODE RunHingeList(const T_HINGE_OPTIONS& options);
EXIT_CODE RunHingeShow(const T_HINGE_OPTIONS& options);
/// Every rule that is not kept, with type, component, end and point. NotFound when there is any.
EXIT_CODE RunHingeCheck(const T_HINGE_OPTIONS& options);
/// Yield strengths, rotations and deformations from section, material and member length.
EXIT_CODE RunHingeYield(const T_HINGE_OPTIONS& options);
/// Hinges of the type for the elements, as one edit; BadInput with the first element that can't.
EXIT_CODE RunHingeAssign(const T_HINGE_OPTIONS& options);
/// The generated hinges with their strengths per component and sign.
EXIT_CODE RunHingeGenerated(const T_HINGE_OPTIONS& options);
EXIT_CODE RunHingeConvert(const T_HINGE_OPTIONS& options);
EXIT_CODE RunHingeAxial(const T_HINGE_OPTIONS& options);
/// Prints options of hinges and design codes; with a file to write it changes them first.
EXIT_CODE RunHingeModelOptions(const T_HINGE_OPTIONS& options);
/// The yield level that the type's own section and material give, into its yield surface.
EXIT_CODE RunHingeSurface(const T_HINGE_OPTIONS& options);
EXIT_CODE RunHingePlot(const T_HINGE_OPTIONS& options);

/// Checks the pushover load cases and their pattern rows.
EXIT_CODE RunCaseCheck(const std::string& file);
