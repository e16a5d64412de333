#include "host/messages/platform/Desktop.h"

namespace tessel
{
bool hasDisplay()
{
    return true;
}

std::vector<std::string> pageOpeners()
{
    return {"open"};
}
} // namespace tessel
