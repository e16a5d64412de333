#include "bench/Ratios.h"

void addLoadingBenchmarks();
void addListBenchmarks();
void addRebuildBenchmarks();
void addStartBenchmarks();

int main(int argc, char** argv)
{
    addLoadingBenchmarks();
    addListBenchmarks();
    addRebuildBenchmarks();
    addStartBenchmarks();
    return bench::runAll(argc, argv) == 0 ? 0 : 1;
}
