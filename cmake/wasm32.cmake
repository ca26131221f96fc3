# Toolchain: WebAssembly by Debian's clang 19, lld, libc++ and wasi-libc. Set VOREL_WASM_LLVM for another
# release of them.
set(VOREL_WASM_LLVM 19 CACHE STRING "Release of LLVM that compiles for WebAssembly")
set(CMAKE_SYSTEM_NAME Generic)
set(CMAKE_SYSTEM_PROCESSOR wasm32)
# Programs do not link before the library's own runtime (bindings/js/module) is there.
set(CMAKE_TRY_COMPILE_TARGET_TYPE STATIC_LIBRARY)
list(APPEND CMAKE_TRY_COMPILE_PLATFORM_VARIABLES VOREL_WASM_LLVM)

foreach(language C CXX)
  set(CMAKE_${language}_COMPILER_TARGET wasm32-wasi)
  set(CMAKE_${language}_FLAGS_INIT "-mbulk-memory -mnontrapping-fptoint")
  set(CMAKE_EXECUTABLE_SUFFIX_${language} .wasm)
endforeach()
set(CMAKE_C_COMPILER clang-${VOREL_WASM_LLVM})
set(CMAKE_CXX_COMPILER clang++-${VOREL_WASM_LLVM})
# What throws does so by the instructions of WebAssembly.
string(APPEND CMAKE_CXX_FLAGS_INIT " -fwasm-exceptions")
foreach(tool AR RANLIB NM)
  string(TOLOWER ${tool} name)
  set(CMAKE_${tool} llvm-${name}-${VOREL_WASM_LLVM})
endforeach()

# The stack first: one that overflows then meets the end of memory, and not the program's data.
set(CMAKE_EXE_LINKER_FLAGS_INIT "-Wl,-z,stack-size=262144 -Wl,--stack-first")
set(BUILD_SHARED_LIBS OFF CACHE BOOL "There are no shared libraries" FORCE)
set(VOREL_SYSTEM_FONTS OFF CACHE BOOL "There are no installed fonts" FORCE)
set(VOREL_INSTALL OFF CACHE BOOL "Nothing is installed")
