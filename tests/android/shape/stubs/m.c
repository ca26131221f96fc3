#include "stub.h"

FUNCTION(cosf)
FUNCTION(nextafterf)
FUNCTION(sinf)
FUNCTION(tanf)
