#include "stub.h"

FUNCTION(__android_log_print)
