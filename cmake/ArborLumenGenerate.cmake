# SPDX-FileCopyrightText: The Arbor Lumen authors
# SPDX-License-Identifier: Apache-2.0

# Runs the generator at configuration time. A change of the catalogue or of the generator configures
# again; files that do not change are not touched, so nothing is rebuilt for them.
find_package(Python3 3.11 REQUIRED COMPONENTS Interpreter)

set(ARBORLUMEN_CATALOGUE ${PROJECT_SOURCE_DIR}/catalogue/functions.toml)
set(ARBORLUMEN_GENERATED ${PROJECT_BINARY_DIR}/generated)

file(GLOB generator_sources CONFIGURE_DEPENDS ${PROJECT_SOURCE_DIR}/tools/generate/*.py)
set_property(DIRECTORY ${PROJECT_SOURCE_DIR} APPEND
             PROPERTY CMAKE_CONFIGURE_DEPENDS ${ARBORLUMEN_CATALOGUE} ${generator_sources})
execute_process(
  COMMAND ${Python3_EXECUTABLE} -B ${PROJECT_SOURCE_DIR}/tools/generate ${ARBORLUMEN_CATALOGUE}
          ${ARBORLUMEN_GENERATED} COMMAND_ERROR_IS_FATAL ANY)
