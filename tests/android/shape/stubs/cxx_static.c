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

/* What the C face takes: exceptions to catch, ... */
FUNCTION(__cxa_allocate_exception)
FUNCTION(__cxa_begin_catch)
FUNCTION(__cxa_end_catch)
FUNCTION(__cxa_free_exception)
FUNCTION(__cxa_throw)
FUNCTION(__gxx_personality_v0)
FUNCTION(_Unwind_Resume)
FUNCTION(_ZSt9terminatev) /* std::terminate() */
OBJECT(_ZTISt9bad_alloc)  /* ... those that the standard library throws, ... */
FUNCTION(_ZNSt9bad_allocC1Ev)
FUNCTION(_ZNSt9bad_allocD1Ev)
OBJECT(_ZTISt20bad_array_new_length)
FUNCTION(_ZNSt20bad_array_new_lengthC1Ev)
FUNCTION(_ZNSt20bad_array_new_lengthD1Ev)
OBJECT(_ZTISt12length_error)
OBJECT(_ZTVSt12length_error)
FUNCTION(_ZNSt12length_errorD1Ev)
FUNCTION(_ZNSt11logic_errorC2EPKc)
/* ... std::string::push_back(char), and std::shared_ptr. */
FUNCTION(_ZNSt3__112basic_stringIcNS_11char_traitsIcEENS_9allocatorIcEEE9push_backEc)
OBJECT(_ZTINSt3__119__shared_weak_countE)
FUNCTION(_ZNSt3__119__shared_weak_countD2Ev)
FUNCTION(_ZNSt3__119__shared_weak_count14__release_weakEv)
FUNCTION(_ZNKSt3__119__shared_weak_count13__get_deleterERKSt9type_info)
