#include "stub.h"

FUNCTION(cosf)
FUNCTION(ldexp)
FUNCTION(sinf)
FUNCTION(tanf)
