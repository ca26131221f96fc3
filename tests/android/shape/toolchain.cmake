# Android without an NDK, for shape.sh: clang for the target, libc++ headers, the C headers of Linux for the
# same CPU, Android's own public headers as Debian packages them. From the environment come VOREL_CPU,
# aarch64 or x86_64, and VOREL_STUBS, where the libraries to link against are.
set(CMAKE_SYSTEM_NAME Android)
set(CMAKE_SYSTEM_VERSION 1) # the version at which CMake asks for no NDK
set(CMAKE_SYSTEM_PROCESSOR $ENV{VOREL_CPU})
set(CMAKE_CXX_COMPILER clang++-14)
set(CMAKE_CXX_COMPILER_TARGET $ENV{VOREL_CPU}-linux-android24)
set(CMAKE_TRY_COMPILE_TARGET_TYPE STATIC_LIBRARY)
if("$ENV{VOREL_CPU}" STREQUAL "aarch64")
  set(c_headers "-isystem /usr/aarch64-linux-gnu/include")
else()
  set(c_headers "-isystem /usr/include/x86_64-linux-gnu -idirafter /usr/include")
endif()
set(CMAKE_CXX_FLAGS_INIT "-nostdinc++ -nostdlibinc -isystem /usr/lib/llvm-14/include/c++/v1\
 ${c_headers} -isystem /usr/include/android -isystem /usr/include/android/nativehelper")
# What the compiler would add by itself is left out: nothing but the stubs is linked.
set(CMAKE_SHARED_LINKER_FLAGS_INIT "-Wno-unused-command-line-argument -fuse-ld=lld -nostdlib -L$ENV{VOREL_STUBS} -Wl,-z,defs -Wl,--as-needed")
set(CMAKE_CXX_STANDARD_LIBRARIES_INIT "-lc++_static -lm -lc")
