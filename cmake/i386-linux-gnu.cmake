# A 32-bit x86 build on a 64-bit Debian machine, as the host runs the tool:
# the multilib compilers with -m32, and the i386 libraries of multiarch
# (GoogleTest) found under /usr/lib/i386-linux-gnu.
set(CMAKE_C_FLAGS_INIT -m32)
set(CMAKE_CXX_FLAGS_INIT -m32)
set(CMAKE_EXE_LINKER_FLAGS_INIT -m32)
set(CMAKE_LIBRARY_ARCHITECTURE i386-linux-gnu)
