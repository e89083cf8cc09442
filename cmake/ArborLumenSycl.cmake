# SPDX-FileCopyrightText: The Arbor Lumen authors
# SPDX-License-Identifier: Apache-2.0

# Defines arbor_lumen_sycl_dependency, the target through which everything gets SYCL, and
# arbor_lumen_device_code(TARGET), to be called for targets that hold kernels.
add_library(arbor_lumen_sycl_dependency INTERFACE)
set_target_properties(arbor_lumen_sycl_dependency PROPERTIES EXPORT_NAME sycl_dependency)

if(ARBORLUMEN_SYCL STREQUAL "embedded")
  set(ARBORLUMEN_SYCL_TESTS ${ARBORLUMEN_TESTS} CACHE BOOL "Build the tests of the SYCL runtime")
  add_subdirectory(sycl)
  target_link_libraries(arbor_lumen_sycl_dependency INTERFACE ArborLumen::sycl)
  target_compile_definitions(arbor_lumen_sycl_dependency INTERFACE ARBORLUMEN_SYCL_EMBEDDED)
  function(arbor_lumen_device_code target)
  endfunction()
elseif(ARBORLUMEN_SYCL STREQUAL "adaptivecpp")
  find_package(AdaptiveCpp CONFIG REQUIRED)
  target_compile_definitions(arbor_lumen_sycl_dependency INTERFACE ARBORLUMEN_SYCL_COMPILER
                                                                   ARBORLUMEN_SYCL_ADAPTIVECPP)
  function(arbor_lumen_device_code target)
    add_sycl_to_target(TARGET ${target})
  endfunction()
elseif(ARBORLUMEN_SYCL STREQUAL "compiler")
  target_compile_options(arbor_lumen_sycl_dependency INTERFACE -fsycl)
  target_link_options(arbor_lumen_sycl_dependency INTERFACE -fsycl)
  target_compile_definitions(arbor_lumen_sycl_dependency INTERFACE ARBORLUMEN_SYCL_COMPILER)
  function(arbor_lumen_device_code target)
  endfunction()
else()
  message(FATAL_ERROR "ARBORLUMEN_SYCL is \"${ARBORLUMEN_SYCL}\"; "
                      "it must be embedded, adaptivecpp or compiler")
endif()
