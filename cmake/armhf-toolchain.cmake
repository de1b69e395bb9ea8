# Cross build for 32-bit ARM (armhf) with Debian's cross toolchain and multiarch -dev
# packages (scripts/armhf.sh installs them). Programs run through qemu-arm: ctest, test
# discovery and the build's own tools (the profile writer) prefix them with the emulator.
set(CMAKE_SYSTEM_NAME Linux)
set(CMAKE_SYSTEM_PROCESSOR arm)
set(CMAKE_C_COMPILER arm-linux-gnueabihf-gcc)
set(CMAKE_CXX_COMPILER arm-linux-gnueabihf-g++)
# Multiarch: the armhf libraries and their CMake packages live in /usr/lib/arm-linux-gnueabihf.
set(CMAKE_LIBRARY_ARCHITECTURE arm-linux-gnueabihf)
set(CMAKE_FIND_ROOT_PATH_MODE_PROGRAM NEVER)

find_program(OVO_QEMU_ARM qemu-arm REQUIRED)
set(CMAKE_CROSSCOMPILING_EMULATOR "${OVO_QEMU_ARM}")
# The export check reads ARM objects.
find_program(OVO_NM arm-linux-gnueabihf-nm REQUIRED)
