#include "stub.h"

FUNCTION(abort)
FUNCTION(calloc)
FUNCTION(free)
#ifdef STUBS_FOR_aarch64
FUNCTION(getauxval) /* the level of the instruction set */
#endif
FUNCTION(malloc)
FUNCTION(memcmp)
FUNCTION(memcpy)
FUNCTION(memmove)
FUNCTION(memset)
FUNCTION(snprintf)
FUNCTION(strlen)
FUNCTION(vsnprintf)
