#include "stub.h"

FUNCTION(abort)
FUNCTION(calloc)
FUNCTION(free)
#ifdef __aarch64__
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
