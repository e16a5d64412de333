// A sample core module (.zmb), the smallest of all: one command, no state.
//
// The command writes the numbers from 1 on in a spiral and marks the primes, which like to stand on
// diagonals.
#include <tessel/tsedcommands.h>
#include <tessel/tsformat.h>

#include <algorithm>
#include <cstdlib>
#include <string>

namespace
{
constexpr const wchar_t* kGroup = L"PRIMES";
constexpr const wchar_t* kCommand = L"PRIMES";
constexpr int kRadius = 15; // rings around the 1 in the middle

bool isPrime(int number)
{
    for (int divisor = 2; divisor * divisor <= number; ++divisor)
        if (number % divisor == 0)
            return false;
    return number > 1;
}

// The number at a place of the spiral: x to the right, y upwards, 1 at the origin, 2 to its right, then
// counter-clockwise. A ring ends with the square of its width at its lower right corner.
int numberAt(int x, int y)
{
    const int ring = std::max(std::abs(x), std::abs(y));
    const int side = 2 * ring;
    const int last = (side + 1) * (side + 1);
    if (y == -ring)
        return last - (ring - x);
    if (x == -ring)
        return last - side - (y + ring);
    if (y == ring)
        return last - 2 * side - (x + ring);
    return last - 3 * side - (ring - y);
}

void showSpiral()
{
    std::wstring picture;
    for (int y = kRadius; y >= -kRadius; --y)
    {
        for (int x = -kRadius; x <= kRadius; ++x)
            picture += isPrime(numberAt(x, y)) ? L"* " : L"  ";
        picture.erase(picture.find_last_not_of(L' ') + 1);
        picture += L'\n';
    }
    tsutPrintf(L"%sThe primes up to %d, on a spiral that begins in the middle.\n", picture.c_str(),
               numberAt(kRadius, -kRadius));
}

TsEdCommandStack* commands()
{
    return TsEdCommandStack::cast(tsrxSysRegistry()->at(TSED_REGISTERED_COMMANDS));
}

int load()
{
    if (!commands() || commands()->addCommand(kGroup, kCommand, kCommand, 0, showSpiral) != TSED_COMMAND_OK)
        return TSRX_RET_ERROR;
    tsedDescribeCommand(kGroup, kCommand, L"Shows the primes on a spiral");
    tsutPrintf(L"Primes: type PRIMES to see them on a spiral.\n");
    return TSRX_RET_OK;
}

int unload()
{
    return commands()->removeGroup(kGroup) == TSED_COMMAND_OK ? TSRX_RET_OK : TSRX_RET_ERROR;
}
} // namespace

extern "C" TESSEL_EXPORT int tsrxEntryPoint(unsigned message, void*)
{
    switch (message)
    {
    case TSRX_MSG_LOAD:
        return load();
    case TSRX_MSG_UNLOAD:
        return unload();
    default:
        return TSRX_RET_OK;
    }
}
