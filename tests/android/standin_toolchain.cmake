# Stands in for the toolchain file of an NDK in aar_test.py: a library for ARM Linux, built the way that
# Android's is. VOREL_STUBS, from the environment, holds a liblog to link against.
set(CMAKE_SYSTEM_NAME Android)
set(CMAKE_SYSTEM_VERSION 1) # the version at which CMake asks for no NDK
set(CMAKE_SYSTEM_PROCESSOR aarch64)
set(CMAKE_CXX_COMPILER aarch64-linux-gnu-g++)
set(CMAKE_CXX_FLAGS_INIT "-isystem /usr/include/android/nativehelper")
set(CMAKE_SHARED_LINKER_FLAGS_INIT "-L$ENV{VOREL_STUBS} -Wl,--as-needed")
