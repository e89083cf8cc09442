// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#pragma once

#define SYCL_LANGUAGE_VERSION 202012L
#define SYCL_IMPLEMENTATION_ARBOR_LUMEN 1

#include "access.hpp"
#include "accessor.hpp"
#include "aspect.hpp"
#include "atomic_ref.hpp"
#include "backend.hpp"
#include "bit_cast.hpp"
#include "buffer.hpp"
#include "context.hpp"
#include "device.hpp"
#include "event.hpp"
#include "exception.hpp"
#include "half.hpp"
#include "handler.hpp"
#include "id.hpp"
#include "info.hpp"
#include "interop_handle.hpp"
#include "item.hpp"
#include "math.hpp"
#include "native.hpp"
#include "platform.hpp"
#include "property.hpp"
#include "queue.hpp"
#include "range.hpp"
#include "selector.hpp"
#include "span.hpp"
#include "type_traits.hpp"
#include "usm.hpp"
