# SPDX-FileCopyrightText: The Arbor Lumen authors
# SPDX-License-Identifier: Apache-2.0

# Flags of every target of the project.
#
# Contraction is off everywhere: a product and a sum fuse only where the source says fma, so that
# results have the same bits on every device and instruction set. No fast-math flag is used.
add_library(arbor_lumen_flags INTERFACE)
target_compile_options(
  arbor_lumen_flags INTERFACE -ffp-contract=off -Wall -Wextra -Wshadow
                              $<$<BOOL:${ARBORLUMEN_WERROR}>:-Werror>)

# What lets the compiler vectorise a main path and changes no value: errno is never read after a
# mathematical built-in, and floating-point exceptions do not trap.
add_library(arbor_lumen_kernel_flags INTERFACE)
target_compile_options(arbor_lumen_kernel_flags INTERFACE -fno-math-errno -fno-trapping-math)
