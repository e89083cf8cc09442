# SPDX-FileCopyrightText: The Arbor Lumen authors
# SPDX-License-Identifier: Apache-2.0

# Installs the library, its headers, a CMake package and a pkg-config file.
include(CMakePackageConfigHelpers)

install(TARGETS arbor_lumen_vm arbor_lumen_sycl_dependency lumen_serv EXPORT ArborLumenTargets
        LIBRARY DESTINATION ${CMAKE_INSTALL_LIBDIR})
# Loaded by name, from the folder of lumen_serv.
install(TARGETS lumen_arr LIBRARY DESTINATION ${CMAKE_INSTALL_LIBDIR})
if(TARGET arbor_lumen_vm_v3)
  install(TARGETS arbor_lumen_vm_v3
          LIBRARY DESTINATION ${CMAKE_INSTALL_LIBDIR}/glibc-hwcaps/x86-64-v3)
endif()
install(DIRECTORY include/ ${ARBORLUMEN_GENERATED}/include/
        DESTINATION ${CMAKE_INSTALL_INCLUDEDIR} FILES_MATCHING PATTERN "*.hpp")

set(package_dir ${CMAKE_INSTALL_LIBDIR}/cmake/ArborLumen)
install(EXPORT ArborLumenTargets NAMESPACE ArborLumen:: DESTINATION ${package_dir})
configure_package_config_file(cmake/ArborLumenConfig.cmake.in ArborLumenConfig.cmake
                              INSTALL_DESTINATION ${package_dir})
write_basic_package_version_file(ArborLumenConfigVersion.cmake COMPATIBILITY SameMinorVersion)
install(FILES ${PROJECT_BINARY_DIR}/ArborLumenConfig.cmake
              ${PROJECT_BINARY_DIR}/ArborLumenConfigVersion.cmake DESTINATION ${package_dir})

if(ARBORLUMEN_SYCL STREQUAL "embedded")
  set(pkg_config_sycl_flags "-DARBORLUMEN_SYCL_EMBEDDED -std=c++20")
  set(pkg_config_sycl_libs "-larbor_lumen_sycl -pthread")
else()
  set(pkg_config_sycl_flags "-std=c++20")
  set(pkg_config_sycl_libs "")
endif()
# The install tree may be moved, or made by --prefix.
file(RELATIVE_PATH pkg_config_to_prefix "/${CMAKE_INSTALL_LIBDIR}/pkgconfig" "/")
configure_file(cmake/arbor-lumen-vm.pc.in arbor-lumen-vm.pc @ONLY)
install(FILES ${PROJECT_BINARY_DIR}/arbor-lumen-vm.pc
        DESTINATION ${CMAKE_INSTALL_LIBDIR}/pkgconfig)
