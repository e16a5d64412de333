#include "host/Services.h"

namespace tessel
{
Services& services()
{
    static Services running;
    return running;
}
} // namespace tessel
