// Joins every module that tessel_add_module or tessel_add_bundle builds.
#include <tessel/tsversion.h>

TESSEL_TELLS_SDK_VERSION;
