#include "bench/Wishes.h"

#include <cstdlib>

namespace bench
{
namespace
{
std::string variable(const char* name)
{
    const char* value = std::getenv(name);
    return value ? value : "";
}
} // namespace

const Wishes& wishes()
{
    static const Wishes all = {!variable("MODRIG_BENCH_QUICK").empty(), variable("MODRIG_BENCH_ONLY"),
                               variable("MODRIG_BENCH_RESULTS"), variable("MODRIG_BENCH_COUNT")};
    return all;
}
} // namespace bench
