# Android without an NDK, for shape.sh: clang for the target, libc++ headers, the C headers of 64-bit ARM
# Linux, Android's own public headers as Debian packages them. VOREL_STUBS, from the environment, holds
# the libraries to link against.
set(CMAKE_SYSTEM_NAME Android)
set(CMAKE_SYSTEM_VERSION 1) # the version at which CMake asks for no NDK
set(CMAKE_SYSTEM_PROCESSOR aarch64)
set(CMAKE_CXX_COMPILER clang++-14)
set(CMAKE_CXX_COMPILER_TARGET aarch64-linux-android24)
set(CMAKE_TRY_COMPILE_TARGET_TYPE STATIC_LIBRARY)
set(CMAKE_CXX_FLAGS_INIT "-nostdinc++ -nostdlibinc -isystem /usr/lib/llvm-14/include/c++/v1\
 -isystem /usr/aarch64-linux-gnu/include -isystem /usr/include/android -isystem /usr/include/android/nativehelper")
# What the compiler would add by itself is left out: nothing but the stubs is linked.
set(CMAKE_SHARED_LINKER_FLAGS_INIT "-Wno-unused-command-line-argument -fuse-ld=lld -nostdlib -L$ENV{VOREL_STUBS} -Wl,-z,defs -Wl,--as-needed")
set(CMAKE_CXX_STANDARD_LIBRARIES_INIT "-lc++_static -lm -lc")
