// Records that are too many for a row each: a few packed lists hold the members of all of them.
#pragma once

#include "qm_db/records.h"
#include "qm_db/store/recordcodecarrays.h"

inline constexpr const char* kNodes = "nodes"; // owner of the nodes' lists; the key is the chunk

void PutNodes(const T_TABLE<T_NODE_D>& nodes, CPackedArrays& arrays);
/// Throws "damaged" when the chunk is not the next one or its lists differ in length.
void GetNodeChunk(const CPackedArrays& arrays, std::int64_t chunk, T_TABLE<T_NODE_D>& nodes);

void PutElements(const T_TABLE<T_ELEM_D>& elements, CPackedArrays& arrays);
void GetElements(const CPackedArrays& arrays, T_TABLE<T_ELEM_D>& elements);

void PutHinges(const T_TABLE<T_PHGE_D>& hinges, CPackedArrays& arrays);
void GetHinges(const CPackedArrays& arrays, T_TABLE<T_PHGE_D>& hinges);
