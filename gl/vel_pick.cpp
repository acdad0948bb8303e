#include "gl/vel_pick.h"

double VelSelectDepth(unsigned int minimumDepth)
{
    // NOTE: a single-precision product, as hosts have always received it.
    return static_cast<double>(static_cast<float>(minimumDepth) * 2.3283064e-10f);
}

void VelDecodeHits(const unsigned int* buffer, int bufferWords, int hitCount, _DorPosition* const* names,
                   int nameCount, CDorArray<_VelSelect, _VelSelect&>& hits)
{
    if (hitCount < 1)
        return;
    int records = hitCount < bufferWords / VelSelectRecordWords ? hitCount : bufferWords / VelSelectRecordWords;
    hits.SetSize(records);
    int used = 0;
    for (int r = 0; r < records; ++r) {
        const unsigned int* record = buffer + r * VelSelectRecordWords;
        unsigned int name = record[3];
        if (name >= static_cast<unsigned int>(nameCount))
            continue;
        hits[used].position = names[name];
        hits[used].depth = VelSelectDepth(record[1]);
        ++used;
    }
    hits.SetSize(used);
}

void VelSortHits(_VelSelect* hits, int count)
{
    int gap = count;
    bool swapped = true;
    while (gap > 1 || swapped) {
        gap = gap * 10 / 13;
        if (gap < 1)
            gap = 1;
        swapped = false;
        for (int i = 0; i + gap < count; ++i) {
            if (hits[i].depth > hits[i + gap].depth) {
                _VelSelect t = hits[i];
                hits[i] = hits[i + gap];
                hits[i + gap] = t;
                swapped = true;
            }
        }
    }
}
