/* What the Java facade takes from the C++ runtime beyond what the library does, to catch with. */
#include "stub.h"

FUNCTION(_ZSt9terminatev)      /* std::terminate() */
FUNCTION(_ZdlPvRKSt9nothrow_t) /* operator delete(void*, nothrow_t) */
FUNCTION(__cxa_begin_catch)
FUNCTION(__cxa_end_catch)
FUNCTION(__gxx_personality_v0)
FUNCTION(_Unwind_Resume)
