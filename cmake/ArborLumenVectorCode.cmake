# SPDX-FileCopyrightText: The Arbor Lumen authors
# SPDX-License-Identifier: Apache-2.0

# Loops over scalar bodies that have to vectorise, compiled per class of processors by the compiler
# that does it best: clang 19 or later where it is installed, else the project's own compiler.
#
# arbor_lumen_vector_objects(VARIABLE CLASS SOURCES files… [INCLUDES folders…]) compiles sources for
# a class, baseline, avx2 or avx512 on x86-64, and sets VARIABLE to the object files. The include
# paths are those of arbor_lumen_internal, the folder of the caller and INCLUDES; LUMEN_ARR_CLASS
# is defined as the class.
find_program(ARBORLUMEN_VECTOR_CXX NAMES clang++-21 clang++-20 clang++-19
             DOC "Compiler of the loops that have to vectorise")

set(vector_flags -std=c++20 -O3 -fPIC -fvisibility=hidden -ffp-contract=off -fno-math-errno
                 -fno-trapping-math -Wall -Wextra -Wshadow)
set(vector_compiler ${CMAKE_CXX_COMPILER})
if(ARBORLUMEN_VECTOR_CXX)
  set(vector_compiler ${ARBORLUMEN_VECTOR_CXX})
  # The machine scheduler moves the independent chains of an interleaved loop apart and spills.
  list(APPEND vector_flags -mllvm -enable-misched=false)
elseif(CMAKE_CXX_COMPILER_ID STREQUAL "GNU")
  # Threaded jumps turn selects back into branches.
  list(APPEND vector_flags -fno-thread-jumps)
endif()
set(vector_classes baseline)
set(vector_flags_baseline)
if(CMAKE_SYSTEM_PROCESSOR STREQUAL "x86_64")
  list(APPEND vector_classes avx2 avx512)
  set(vector_flags_avx2 -mavx2 -mfma)
  set(vector_flags_avx512 -mavx512f -mavx512dq -mavx512bw -mavx512vl -mfma
                          -mprefer-vector-width=512)
endif()

function(arbor_lumen_vector_objects variable class)
  cmake_parse_arguments(PARSE_ARGV 2 arg "" "" "SOURCES;INCLUDES")
  set(folders ${CMAKE_CURRENT_SOURCE_DIR} ${PROJECT_SOURCE_DIR}/src ${ARBORLUMEN_GENERATED}/src
              ${PROJECT_BINARY_DIR}/tables ${arg_INCLUDES})
  list(TRANSFORM folders PREPEND -I)
  set(objects)
  foreach(source IN LISTS arg_SOURCES)
    cmake_path(ABSOLUTE_PATH source BASE_DIRECTORY ${CMAKE_CURRENT_SOURCE_DIR})
    cmake_path(GET source STEM name)
    set(object ${CMAKE_CURRENT_BINARY_DIR}/${class}/${name}.o)
    add_custom_command(
      OUTPUT ${object}
      COMMAND ${CMAKE_COMMAND} -E make_directory ${CMAKE_CURRENT_BINARY_DIR}/${class}
      COMMAND ${vector_compiler} ${vector_flags} ${vector_flags_${class}} -DLUMEN_ARR_CLASS=${class}
              ${folders} -MD -MF ${object}.d -c ${source} -o ${object}
      DEPENDS ${source} table_headers
      DEPFILE ${object}.d
      COMMENT "Building vector object ${class}/${name}.o"
      VERBATIM COMMAND_EXPAND_LISTS)
    list(APPEND objects ${object})
  endforeach()
  set(${variable} ${objects} PARENT_SCOPE)
endfunction()
