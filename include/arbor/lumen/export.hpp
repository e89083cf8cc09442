// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

/// Marks what the shared library exports; everything else is hidden.
#if defined(__GNUC__)
#define ARBORLUMEN_EXPORT [[gnu::visibility("default")]]
#else
#define ARBORLUMEN_EXPORT
#endif
