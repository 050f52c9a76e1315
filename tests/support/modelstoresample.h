// Contents and files for the tests of the model file.
#pragma once

#include "tempfolder.h"

#include "qm_db/modelstore.h"

#include <string>
#include <vector>

/// Every kind of record, every optional field set once and absent once, awkward numbers.
T_MODEL_CONTENT RichContent();

/// A model of `nodes` nodes with ids 10, 20, ... and one load case of `steps` steps in which node
/// id n moves by SampleDisplacement(n, step).
T_MODEL_CONTENT GridContent(int nodes, int steps);
double SampleDisplacement(int node, int step);

/// Model and results are equal, -0.0 and 0.0 told apart in the results. A result that can't be
/// read is unequal to everything.
bool SameContent(const T_MODEL_CONTENT& a, const T_MODEL_CONTENT& b);

inline std::string BytesOf(const std::string& path)
{
    return ReadText(path);
}

inline void WriteBytes(const std::string& path, const std::string& bytes)
{
    WriteText(path, bytes);
}
