// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#pragma once

/// Marks what the shared library exports.
#define ARBOR_LUMEN_SYCL_API __attribute__((visibility("default")))
