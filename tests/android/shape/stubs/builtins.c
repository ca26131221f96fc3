/* What the library takes from the compiler's own runtime, which is linked into it: the level of the
   instruction set, which 64-bit ARM asks of the kernel. */
#include "stub.h"

#ifdef STUBS_FOR_x86_64
OBJECT(__cpu_model)
OBJECT(__cpu_features2)
#endif
typedef int none; /* C asks for something */
