// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include "arbor/lumen/vm/error_handler.hpp"

namespace arbor::lumen::vm::detail {

error_handler_base::error_handler_base() = default;
error_handler_base::error_handler_base(const error_handler_base&) = default;
error_handler_base& error_handler_base::operator=(const error_handler_base&) = default;
error_handler_base::~error_handler_base() = default;

template <typename T>
error_handler<T>::error_handler() : status_buffer(sycl::range<1>(1)) {}
template <typename T>
error_handler<T>::error_handler(const error_handler&) = default;
template <typename T>
error_handler<T>::error_handler(error_handler&&) = default;
template <typename T>
error_handler<T>& error_handler<T>::operator=(const error_handler&) = default;
template <typename T>
error_handler<T>& error_handler<T>::operator=(error_handler&&) = default;
template <typename T>
error_handler<T>::~error_handler() = default;

template class error_handler<sycl::half>;
template class error_handler<float>;
template class error_handler<double>;
template class error_handler<std::complex<float>>;
template class error_handler<std::complex<double>>;

}  // namespace arbor::lumen::vm::detail
