# What the toolchains have in common: g++ of the triplet, or the clang++ that CXX names, told its
# target.
if("$ENV{CXX}" MATCHES "clang")
  set(CMAKE_CXX_COMPILER $ENV{CXX})
  set(CMAKE_CXX_COMPILER_TARGET ${DRAVENTA_TRIPLET})
else()
  set(CMAKE_CXX_COMPILER ${DRAVENTA_TRIPLET}-g++)
endif()
