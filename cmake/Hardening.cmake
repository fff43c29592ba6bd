# What makes a mistake in the programs hard to misuse. Tests/Hardening reads the binaries and tells
# when any of this is missing.

include(CheckPIESupported)
check_pie_supported()

add_library(NidusHardening INTERFACE)
target_compile_options(NidusHardening INTERFACE
  -fstack-protector-strong -fstack-clash-protection
  # Each unit says how it was compiled.
  $<$<CXX_COMPILER_ID:GNU>:-frecord-gcc-switches>)
if(CMAKE_SYSTEM_PROCESSOR STREQUAL "x86_64")
  target_compile_options(NidusHardening INTERFACE -fcf-protection)
endif()
# A library of ours comes from beside the program, whatever LD_LIBRARY_PATH says.
target_link_options(NidusHardening INTERFACE
  -Wl,-z,relro,-z,now,-z,noexecstack,--disable-new-dtags)

# The checked functions of the C library need optimised code, and sanitizers check these calls
# themselves.
if(CMAKE_BUILD_TYPE MATCHES "^(Release|RelWithDebInfo|MinSizeRel)$")
  target_compile_options(NidusHardening INTERFACE -U_FORTIFY_SOURCE -D_FORTIFY_SOURCE=3)
  set(NIDUS_IS_FORTIFIED ON)
endif()
