// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

/// All scalar functors: one type per name of the catalogue, also where bodies coincide.
#include "scalar/generated/all.hpp"
