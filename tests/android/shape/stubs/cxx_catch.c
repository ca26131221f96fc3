/* What the Java facade takes from the C++ runtime beyond what the library does, to catch with. */
#include "stub.h"

FUNCTION(_ZdlPvRKSt9nothrow_t) /* operator delete(void*, nothrow_t) */
