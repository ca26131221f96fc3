#include "stub.h"

FUNCTION(AndroidBitmap_getInfo)
FUNCTION(AndroidBitmap_lockPixels)
FUNCTION(AndroidBitmap_unlockPixels)
