# Stands in for the toolchain file of an NDK in aar_test.py: libraries for Linux, built the way that Android's
# are. VOREL_STUBS, from the environment, holds for each ABI a liblog and a libjnigraphics to link against.
set(CMAKE_SYSTEM_NAME Android)
set(CMAKE_SYSTEM_VERSION 1) # the version at which CMake asks for no NDK
if(ANDROID_ABI STREQUAL "arm64-v8a")
  set(CMAKE_SYSTEM_PROCESSOR aarch64)
  set(CMAKE_CXX_COMPILER aarch64-linux-gnu-g++)
  # Little optimisation takes less time; what is asserted in a debug build stays out as in a release.
  set(CMAKE_BUILD_TYPE Standin CACHE STRING "" FORCE)
  set(CMAKE_CXX_FLAGS_STANDIN "-O1 -DNDEBUG" CACHE STRING "")
else()
  # The sources of the library are compiled as in a release for this machine: a compiler cache has them.
  set(CMAKE_SYSTEM_PROCESSOR x86_64)
  set(CMAKE_CXX_COMPILER g++)
endif()
set(CMAKE_TRY_COMPILE_PLATFORM_VARIABLES ANDROID_ABI)
foreach(headers /usr/include/android /usr/include/android/nativehelper)
  include_directories(SYSTEM $<$<STREQUAL:$<TARGET_PROPERTY:NAME>,voreleffect_jni>:${headers}>)
endforeach()
set(CMAKE_SHARED_LINKER_FLAGS_INIT "-L$ENV{VOREL_STUBS}/${ANDROID_ABI} -Wl,--as-needed")
