#pragma once
// Decoding of OpenGL selection records into hits, and their ordering. Selection names are
// indices into the list of handles that the pick pass pushed (a handle does not fit a 32-bit
// name on 64-bit Windows), so decoding turns them back into the entity handles.
#include "gl/vel_karvel.h"

// Words in the selection buffer of one pick, and words in one record of the pick pass (name
// count, minimum depth, maximum depth, one name).
const int VelSelectBufferWords = 512;
const int VelSelectRecordWords = 4;

// The hit depth 0..1 of a record's unsigned minimum depth.
double VelSelectDepth(unsigned int minimumDepth);

// Reads hitCount records from buffer (bufferWords long) into hits: sized to the number of usable
// records, which is hitCount unless a record lies past the buffer or names no pushed handle.
// hitCount < 1 (none, or -1 for an overflow) leaves hits untouched.
void VelDecodeHits(const unsigned int* buffer, int bufferWords, int hitCount, _DorPosition* const* names,
                   int nameCount, CDorArray<_VelSelect, _VelSelect&>& hits);

// Ascending depth by comb sort (gap shrinking by 10/13). Not stable: a pass never swaps two equal
// depths, but the longer gaps carry hits past each other, so equal depths may come out reversed.
void VelSortHits(_VelSelect* hits, int count);
