// Pictures and tables of results: what the window of the frame shows.
#pragma once

#include "exitcodes.h"
#include "qm_rps/view/resultview.h"

#include <string>
#include <vector>

/// What results are asked for; several are alternatives in a picture.
struct T_SOURCE_OPTIONS {
    std::string file;
    std::vector<std::string> cases, stages, pushes; // names
    std::vector<int> modes;
    int step = 0;         // of stages and pushes; 0: the last one
    std::string elements; // "1,5-9": shown alone; empty: all
    bool overwrite = false, envelope = false;
};

struct T_PICTURE_OPTIONS : T_SOURCE_OPTIONS {
    std::string what = "deformed", labels = "member", look = "auto", out;
    bool onDeformed = false, outline = false, perspective = false, numbers = false;
    double scale = 0.0, size = 1.0; // scale 0: one that suits
};

struct T_RESULTS_OPTIONS : T_SOURCE_OPTIONS {
    std::string what = "forces", nodes, csv, xlsx, json;
};

/// Analyses, or pushes, what has no results yet, and draws or lists it. The file stays as it is.
EXIT_CODE RunPicture(const T_PICTURE_OPTIONS& options);
EXIT_CODE RunResults(const T_RESULTS_OPTIONS& options);

/// The sources that are asked for, analysed; no names: every load case, for an envelope
/// combinations, too. Done, or the code to exit
/// with after one line on stderr.
EXIT_CODE FindSources(CDBDoc& doc, const T_SOURCE_OPTIONS& options, CFrameScene& scene,
                      std::vector<T_SHAPE_SOURCE>& out);
/// Ids that must be there; empty text: none.
EXIT_CODE ReadElementIds(CDBDoc& doc, const T_SOURCE_OPTIONS& options, std::set<int>& out);
