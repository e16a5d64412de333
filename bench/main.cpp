#include "bench/Ratios.h"

void addLoadingBenchmarks();
void addListBenchmarks();

int main(int argc, char** argv)
{
    addLoadingBenchmarks();
    addListBenchmarks();
    return bench::runAll(argc, argv) == 0 ? 0 : 1;
}
