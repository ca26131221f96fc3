#include "setjmp.h"

// What clang turns setjmp and longjmp into on WebAssembly (-wasm-enable-sjlj): a setjmp notes the call that
// it stands in, and a longjmp throws what a caller up to there tells by it.

void __wasm_setjmp(void* buffer, unsigned int place, void* call);
unsigned int __wasm_setjmp_test(void* buffer, void* call);
_Noreturn void __wasm_longjmp(void* buffer, int value);

void __wasm_setjmp(void* buffer, unsigned int place, void* call) {
    jmp_buf* const noted = buffer;
    (*noted)->call = call;
    (*noted)->place = place;
}

/// The place of the setjmp when it stands in this call, else 0.
unsigned int __wasm_setjmp_test(void* buffer, void* call) {
    jmp_buf* const noted = buffer;
    return (*noted)->call == call ? (*noted)->place : 0;
}

_Noreturn void __wasm_longjmp(void* buffer, int value) {
    enum { kTagOfLongjmp = 1 };
    jmp_buf* const noted = buffer;
    (*noted)->jump.buffer = buffer;
    (*noted)->jump.value = value == 0 ? 1 : value;
    __builtin_wasm_throw(kTagOfLongjmp, &(*noted)->jump);
}
