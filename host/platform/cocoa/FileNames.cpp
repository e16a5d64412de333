#include "host/platform/FileNames.h"

namespace tessel
{
// The file systems here take no name that is not text.
void nameEveryFile()
{
}
} // namespace tessel
