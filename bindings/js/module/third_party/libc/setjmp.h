#pragma once

// The packaged C library for WebAssembly has no setjmp: the compiler makes both calls to the functions
// of setjmp.c, which throw and catch by the instructions of WebAssembly.
typedef struct {
    void* call;          // of the function that setjmp stands in
    unsigned int place;  // of the setjmp within it
    struct {
        void* buffer;
        int value;
    } jump;  // what is thrown
} jmp_buf[1];

int setjmp(jmp_buf buffer) __attribute__((returns_twice));
_Noreturn void longjmp(jmp_buf buffer, int value);
