# Debian packages made by CPack (bash scripts/package.sh writes them under build/). Two of
# them: zor2check (the checker, its manual page, the documentation and the CMake package)
# needs only the C and C++ libraries; zor2describe adds the libclang runtime and clang's own
# headers, some 140 MB of LLVM that a machine which only checks descriptions is spared.
# dpkg-shlibdeps (Debian package dpkg-dev) finds each program's shared-library dependencies.

set(ZOR2_PACKAGE_CONTACT "zor2check maintainers <zor2check@localhost>" CACHE STRING
  "Maintainer field of the Debian packages")

set(CPACK_GENERATOR DEB)
set(CPACK_PACKAGE_NAME zor2check)
set(CPACK_PACKAGE_VERSION ${PROJECT_VERSION})
set(CPACK_PACKAGE_CONTACT "${ZOR2_PACKAGE_CONTACT}")
set(CPACK_DEB_COMPONENT_INSTALL ON)
set(CPACK_COMPONENTS_ALL checker)
set(CPACK_DEBIAN_FILE_NAME DEB-DEFAULT)
set(CPACK_DEBIAN_PACKAGE_SHLIBDEPS ON)
set(CPACK_DEBIAN_PACKAGE_SECTION devel)

set(CPACK_DEBIAN_CHECKER_PACKAGE_NAME zor2check)
string(CONCAT CPACK_COMPONENT_CHECKER_DESCRIPTION
  "checks that a release of published C++ interfaces stays compatible\n"
  "zor2check compares the interface description documents of two releases and reports\n"
  "each change a published interface must not undergo, as an XML report and, on request,\n"
  "as JSON, SARIF, Markdown or HTML; -fail and a baseline make it a CI gate. The CMake\n"
  "package (find_package(zor2check)) checks a target's public headers against a committed\n"
  "description at each build and test; it needs the package zor2describe.")

if(TARGET zor2describe)
  list(APPEND CPACK_COMPONENTS_ALL describer)
  set(CPACK_DEBIAN_DESCRIBER_PACKAGE_NAME zor2describe)
  # libclang reads its own headers (stddef.h, ...) from the -dev package of the same LLVM
  # release; the C++ standard headers come with the compiler.
  set(CPACK_DEBIAN_DESCRIBER_PACKAGE_DEPENDS "zor2check (= ${PROJECT_VERSION})")
  if(ZOR2_LLVM_MAJOR)
    string(APPEND CPACK_DEBIAN_DESCRIBER_PACKAGE_DEPENDS
      ", libclang-common-${ZOR2_LLVM_MAJOR}-dev")
  endif()
  set(CPACK_DEBIAN_DESCRIBER_PACKAGE_RECOMMENDS "g++")
  string(CONCAT CPACK_COMPONENT_DESCRIBER_DESCRIPTION
    "writes the interface description document of C++ headers\n"
    "zor2describe reads the public and protected headers of a framework with libclang and\n"
    "writes the interface description document that zor2check compares, the classes, their\n"
    "methods and arguments, with what the headers' comment tags say.")
endif()

include(CPack)
