// A sample object-database module (.omp): objects with derived values, and a command that tabulates them.
//
// The objects are the gears of a speed reducer. Each pair shares a tooth size; the driven gear turns slower
// by the ratio of the teeth and shares its shaft with the gear that drives the next pair.
#include <tessel/tsedcommands.h>
#include <tessel/tsformat.h>

#include <array>

namespace
{
constexpr const wchar_t* kGroup = L"GEARS";
constexpr const wchar_t* kCommand = L"GEARS";
constexpr double kMotorSpeed = 1450; // turns a minute

class GearPair
{
public:
    constexpr GearPair(double toothSize, int drivingTeeth, int drivenTeeth)
        : mToothSize(toothSize), mDrivingTeeth(drivingTeeth), mDrivenTeeth(drivenTeeth)
    {
    }

    double toothSize() const { return mToothSize; } // in mm: pitch diameter divided by teeth
    int drivingTeeth() const { return mDrivingTeeth; }
    int drivenTeeth() const { return mDrivenTeeth; }
    double ratio() const { return static_cast<double>(mDrivenTeeth) / mDrivingTeeth; }
    double axisDistance() const { return mToothSize * (mDrivingTeeth + mDrivenTeeth) / 2; }

private:
    double mToothSize;
    int mDrivingTeeth;
    int mDrivenTeeth;
};

constexpr std::array kReducer = {GearPair(1.5, 17, 68), GearPair(2.0, 19, 57), GearPair(3.0, 21, 52)};

void printPair(std::size_t number, const GearPair& pair, double speed)
{
    tsutPrintf(L"%6d %9.1f mm %9d %9d %8.3f %10.1f mm %9.1f/min\n", number, pair.toothSize(),
               pair.drivingTeeth(), pair.drivenTeeth(), pair.ratio(), pair.axisDistance(), speed);
}

void showGears()
{
    tsutPrintf(L"  pair  tooth size   driving    driven    ratio axis distance         speed\n");
    double speed = kMotorSpeed;
    std::size_t number = 0;
    for (const GearPair& pair : kReducer)
    {
        speed /= pair.ratio();
        printPair(++number, pair, speed);
    }
    tsutPrintf(L"The motor turns at %.0f/min, the last shaft %.2f times slower.\n", kMotorSpeed,
               kMotorSpeed / speed);
}

TsEdCommandStack* commands()
{
    return TsEdCommandStack::cast(tsrxSysRegistry()->at(TSED_REGISTERED_COMMANDS));
}

int load()
{
    if (!commands() || commands()->addCommand(kGroup, kCommand, kCommand, 0, showGears) != TSED_COMMAND_OK)
        return TSRX_RET_ERROR;
    tsedDescribeCommand(kGroup, kCommand, L"Shows the table of a speed reducer");
    tsutPrintf(L"Gears: type GEARS for the table of a speed reducer.\n");
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
