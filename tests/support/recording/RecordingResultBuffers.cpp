// The result buffers of the real host, counted: its two functions are built under other names for this.
#include <tessel/tsresbuf.h>

#include "tests/support/recording/RecordingLoans.h"

TsResultBuffer* realBuildList(std::initializer_list<TsRbValue> values);
int realReleaseList(TsResultBuffer* list);

TsResultBuffer* tsutBuildList(std::initializer_list<TsRbValue> values)
{
    TsResultBuffer* list = realBuildList(values);
    for (const TsResultBuffer* entry = list; entry; entry = entry->next)
        recording_loans::lend(entry, "result buffer");
    return list;
}

int tsutRelRb(TsResultBuffer* list)
{
    for (const TsResultBuffer* entry = list; entry; entry = entry->next)
        recording_loans::takeBack(entry);
    return realReleaseList(list);
}
