# A build for another processor, with Debian's cross compiler and the libraries that
# scripts/cross-sysroot has taken out of Debian's packages. The presets arm64 and s390x name
# PALLAX_ARCH, as Debian does; tests and generators run under qemu-user.
set(CMAKE_TRY_COMPILE_PLATFORM_VARIABLES PALLAX_ARCH)
set(processor_arm64 aarch64)
set(processor_s390x s390x)
set(CMAKE_SYSTEM_NAME Linux)
set(CMAKE_SYSTEM_PROCESSOR ${processor_${PALLAX_ARCH}})
set(triplet ${CMAKE_SYSTEM_PROCESSOR}-linux-gnu)
set(sysroot ${CMAKE_CURRENT_LIST_DIR}/../build/sysroot-${PALLAX_ARCH})
cmake_path(NORMAL_PATH sysroot)

set(CMAKE_CXX_COMPILER ${triplet}-g++)
set(CMAKE_LIBRARY_ARCHITECTURE ${triplet})
set(CMAKE_FIND_ROOT_PATH ${sysroot} /usr/${triplet})
set(CMAKE_FIND_ROOT_PATH_MODE_PROGRAM NEVER)
set(CMAKE_FIND_ROOT_PATH_MODE_LIBRARY ONLY)
set(CMAKE_FIND_ROOT_PATH_MODE_INCLUDE ONLY)
set(CMAKE_FIND_ROOT_PATH_MODE_PACKAGE ONLY)
# Headers that differ by processor.
set(CMAKE_CXX_STANDARD_INCLUDE_DIRECTORIES ${sysroot}/usr/include/${triplet})
# Libraries that a library needs, for the linker.
set(libraries ${sysroot}/usr/lib/${triplet} ${sysroot}/lib/${triplet})
list(TRANSFORM libraries REPLACE "(.+)" "-L\\1 -Wl,-rpath-link,\\1" OUTPUT_VARIABLE links)
list(JOIN links " " CMAKE_EXE_LINKER_FLAGS_INIT)
# Those that pkg-config knows.
set(ENV{PKG_CONFIG_SYSROOT_DIR} ${sysroot})
set(ENV{PKG_CONFIG_LIBDIR} ${sysroot}/usr/lib/${triplet}/pkgconfig:${sysroot}/usr/share/pkgconfig)
# Programs find their libraries, and the files of these, in the sysroot.
set(CMAKE_CROSSCOMPILING_EMULATOR qemu-${CMAKE_SYSTEM_PROCESSOR} -L ${sysroot})
