#include "stub.h"

FUNCTION(cosf)
FUNCTION(ldexp)
FUNCTION(nextafterf)
FUNCTION(sinf)
FUNCTION(tanf)
