# Debian's cross compiler. Architecture-independent headers are found on the build machine, or in the folder ARM64_ROOT
# with everything else of a 64-bit Arm system.
set(CMAKE_SYSTEM_NAME Linux)
set(CMAKE_SYSTEM_PROCESSOR aarch64)
set(CMAKE_CXX_COMPILER aarch64-linux-gnu-g++)
if(DEFINED ENV{ARM64_ROOT})
    set(CMAKE_SYSROOT $ENV{ARM64_ROOT})
endif()
