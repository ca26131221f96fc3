/* What the library takes from the C++ runtime, which is linked into it. */
#include "stub.h"

FUNCTION(_Znwm)               /* operator new(size_t) */
FUNCTION(_ZnwmRKSt9nothrow_t) /* operator new(size_t, nothrow_t) */
FUNCTION(_ZnamRKSt9nothrow_t) /* operator new[](size_t, nothrow_t) */
FUNCTION(_ZdlPv)              /* operator delete(void*) */
FUNCTION(_ZdaPv)              /* operator delete[](void*) */
OBJECT(_ZSt7nothrow)          /* std::nothrow */
FUNCTION(__cxa_pure_virtual)
OBJECT(_ZTVN10__cxxabiv117__class_type_infoE)    /* type information beside the vtables */
OBJECT(_ZTVN10__cxxabiv120__si_class_type_infoE) /* the same, of derived classes */
