// Runs of a push in the model file: a row of "push_results" each, and blocks in the table of result
// blocks. One block holds all steps, events, turns of hinges, components of hinges and node ids;
// displacements and states stand by step and so many nodes or components as fill a page of the
// file, so that one of them over all steps is one short run of the table, and one step a few
// blocks.
#pragma once

#include "qm_db/results/pushrun.h"
#include "qm_db/store/resultblocks.h"

#include <array>
#include <cmath>

/// A row of the table.
struct T_RUN_ROW {
    int row = 0; // its key, from 1; the blocks have it in place of the load case
    int pushover = 0;
    int nodes = 0, hinges = 0, steps = 0, events = 0, turns = 0;
    T_RUN_HEAD head;
};

/// A part of a run: so many things with so many numbers each, in one block, or by step.
struct T_RUN_PART {
    BLOCK_PART part;
    int T_RUN_ROW::*count;
    int width;
    int bytes = 8; // of a number
    int block = 0; // things in a block of each step; 0: one block holds all
};
inline constexpr std::array<T_RUN_PART, 8> kRunParts{
    {{BLOCK_PART::RunNodes, &T_RUN_ROW::nodes, 1, 4},
     {BLOCK_PART::RunHinges, &T_RUN_ROW::hinges, 3},
     {BLOCK_PART::RunSteps, &T_RUN_ROW::steps, 12},
     {BLOCK_PART::RunEvents, &T_RUN_ROW::events, 11},
     {BLOCK_PART::RunTurns, &T_RUN_ROW::turns, 4, 4},
     {BLOCK_PART::RunDisplacement, &T_RUN_ROW::nodes, 6, 8, 80},
     {BLOCK_PART::RunState, &T_RUN_ROW::hinges, 4, 8, 128},
     {BLOCK_PART::RunStart, &T_RUN_ROW::nodes, 6}}};

constexpr const T_RUN_PART& RunPartOf(BLOCK_PART part)
{
    return kRunParts[static_cast<std::size_t>(part) -
                     static_cast<std::size_t>(BLOCK_PART::RunNodes)];
}
/// Blocks of a part in each step, and numbers in one of them.
int RunChunks(const T_RUN_ROW& row, const T_RUN_PART& part);
int RunChunkNumbers(const T_RUN_ROW& row, const T_RUN_PART& part, int chunk);

inline T_BLOCK_KEY RunKey(const T_RUN_ROW& row, BLOCK_PART part, int chunk = 0, int step = 0)
{
    T_BLOCK_KEY key{row.row, part, chunk, step};
    key.shown = row.pushover;
    return key;
}

// What stands in the numbers of a part, in their order.
using T_HINGE_NUMBERS = std::array<double, 3>;
using T_STEP_NUMBERS = std::array<double, 12>;
using T_EVENT_NUMBERS = std::array<double, 11>; // the last: how many turns
using T_TURN_NUMBERS = std::array<int, 4>;
using T_STATE_NUMBERS = std::array<double, 4>;

/// Writes the runs of the load cases of the model; throws CStoreFault (BadInput for a source that
/// fails, for unequal lengths and for numbers that are not finite).
void WriteRuns(const CSqliteDb& db, const T_MODEL& model, const T_RESULT_MAP& results,
               const T_TURNED_MAP& turned);

/// Rows of "push_results"; their sum goes to `sums`.
std::vector<T_RUN_ROW> ReadRunRows(const CSqliteDb& db, T_TABLE_SUMS& sums);

/// Bytes of the numbers that a row speaks of.
double BytesOf(const T_RUN_ROW& row);

/// Reads and checks every block of these runs, and that there are no others of these parts.
void CheckRunBlocks(const CSqliteDb& db, const std::vector<T_RUN_ROW>& rows);
