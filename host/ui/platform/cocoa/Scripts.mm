#include "host/ui/platform/Scripts.h"

namespace tessel::windowing
{
// The platform does.
void showEveryScript()
{
}
} // namespace tessel::windowing
