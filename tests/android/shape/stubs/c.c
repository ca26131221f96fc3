#include "stub.h"

FUNCTION(abort)
FUNCTION(calloc)
FUNCTION(free)
FUNCTION(getauxval) /* the level of the instruction set */
FUNCTION(malloc)
FUNCTION(memcmp)
FUNCTION(memcpy)
FUNCTION(memmove)
FUNCTION(memset)
FUNCTION(snprintf)
FUNCTION(strlen)
FUNCTION(vsnprintf)
