// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <cstddef>
#include <functional>
#include <memory>
#include <type_traits>
#include <utility>

#include "access.hpp"
#include "buffer.hpp"
#include "detail/accessor_base.hpp"
#include "detail/handle.hpp"
#include "detail/region.hpp"
#include "handler.hpp"
#include "id.hpp"
#include "property.hpp"
#include "range.hpp"

namespace sycl {

/// A command's access to a buffer. Subscripts count from the offset of a ranged accessor.
template <typename DataT, int Dimensions, access_mode Mode, target Target,
          access::placeholder Placeholder>
class accessor : public detail::accessor_base<DataT, Dimensions, Mode> {
  using base = detail::accessor_base<DataT, Dimensions, Mode>;
  using plain = std::remove_const_t<DataT>;
  template <typename T>
  static constexpr bool is_tag =
      std::is_same_v<T, mode_tag_t<Mode>> || std::is_same_v<T, mode_target_tag_t<Mode, Target>>;

 public:
  /// Accesses nothing; may be assigned to.
  accessor() noexcept = default;

  template <typename T, int D, typename AllocatorT>
  requires(std::is_same_v<std::remove_const_t<T>, plain>&& D == detail::rank_v<Dimensions>)
      accessor(buffer<T, D, AllocatorT>& buf, const property_list& properties = {})
      : accessor(buf, shape(buf), id<detail::rank_v<Dimensions>>(), properties) {}
  template <typename T, int D, typename AllocatorT, typename Tag>
  requires(std::is_same_v<std::remove_const_t<T>, plain>&& D == detail::rank_v<Dimensions> &&
           is_tag<Tag>)
      accessor(buffer<T, D, AllocatorT>& buf, Tag, const property_list& properties = {})
      : accessor(buf, shape(buf), id<detail::rank_v<Dimensions>>(), properties) {}
  template <typename T, int D, typename AllocatorT>
  requires(std::is_same_v<std::remove_const_t<T>, plain>&& D == detail::rank_v<Dimensions>)
      accessor(buffer<T, D, AllocatorT>& buf, handler& cgh, const property_list& properties = {})
      : accessor(buf, cgh, shape(buf), id<detail::rank_v<Dimensions>>(), properties) {}
  template <typename T, int D, typename AllocatorT, typename Tag>
  requires(std::is_same_v<std::remove_const_t<T>, plain>&& D == detail::rank_v<Dimensions> &&
           is_tag<Tag>) accessor(buffer<T, D, AllocatorT>& buf, handler& cgh, Tag,
                                 const property_list& properties = {})
      : accessor(buf, cgh, shape(buf), id<detail::rank_v<Dimensions>>(), properties) {}

  template <typename T, typename AllocatorT>
  accessor(buffer<T, detail::rank_v<Dimensions>, AllocatorT>& buf,
           range<detail::rank_v<Dimensions>> extent,
           const property_list& properties = {}) requires(Dimensions > 0)
      : accessor(buf, extent, id<detail::rank_v<Dimensions>>(), properties) {}
  template <typename T, typename AllocatorT, typename Tag>
  accessor(buffer<T, detail::rank_v<Dimensions>, AllocatorT>& buf,
           range<detail::rank_v<Dimensions>> extent, Tag,
           const property_list& properties = {}) requires(Dimensions > 0 && is_tag<Tag>)
      : accessor(buf, extent, id<detail::rank_v<Dimensions>>(), properties) {}
  template <typename T, typename AllocatorT>
  accessor(buffer<T, detail::rank_v<Dimensions>, AllocatorT>& buf,
           range<detail::rank_v<Dimensions>> extent, id<detail::rank_v<Dimensions>> offset,
           const property_list& properties = {})
      : base(buf.view().bytes(), shape(buf), extent, offset, properties), placeholder_(true) {}
  template <typename T, typename AllocatorT, typename Tag>
  accessor(buffer<T, detail::rank_v<Dimensions>, AllocatorT>& buf,
           range<detail::rank_v<Dimensions>> extent, id<detail::rank_v<Dimensions>> offset, Tag,
           const property_list& properties = {}) requires(Dimensions > 0 && is_tag<Tag>)
      : accessor(buf, extent, offset, properties) {}

  template <typename T, typename AllocatorT>
  accessor(buffer<T, detail::rank_v<Dimensions>, AllocatorT>& buf, handler& cgh,
           range<detail::rank_v<Dimensions>> extent,
           const property_list& properties = {}) requires(Dimensions > 0)
      : accessor(buf, cgh, extent, id<detail::rank_v<Dimensions>>(), properties) {}
  template <typename T, typename AllocatorT, typename Tag>
  accessor(buffer<T, detail::rank_v<Dimensions>, AllocatorT>& buf, handler& cgh,
           range<detail::rank_v<Dimensions>> extent, Tag,
           const property_list& properties = {}) requires(Dimensions > 0 && is_tag<Tag>)
      : accessor(buf, cgh, extent, id<detail::rank_v<Dimensions>>(), properties) {}
  template <typename T, typename AllocatorT>
  accessor(buffer<T, detail::rank_v<Dimensions>, AllocatorT>& buf, handler& cgh,
           range<detail::rank_v<Dimensions>> extent, id<detail::rank_v<Dimensions>> offset,
           const property_list& properties = {})
      : base(buf.view().bytes(), shape(buf), extent, offset, properties), placeholder_(false) {
    detail::require_region(cgh, this->bytes(), Mode);
  }
  template <typename T, typename AllocatorT, typename Tag>
  accessor(buffer<T, detail::rank_v<Dimensions>, AllocatorT>& buf, handler& cgh,
           range<detail::rank_v<Dimensions>> extent, id<detail::rank_v<Dimensions>> offset, Tag,
           const property_list& properties = {}) requires(Dimensions > 0 && is_tag<Tag>)
      : accessor(buf, cgh, extent, offset, properties) {}

  /// A read-only accessor from any other of the same memory.
  template <typename OtherT, access_mode OtherMode>
  requires(Mode == access_mode::read &&
           std::is_same_v<std::remove_const_t<OtherT>, std::remove_const_t<DataT>> &&
           (!std::is_same_v<OtherT, DataT> || OtherMode != Mode) && OtherMode != access_mode::write)
      accessor(const accessor<OtherT, Dimensions, OtherMode, Target, Placeholder>& other)
  noexcept : base(other), placeholder_(other.is_placeholder()) {}

  void swap(accessor& other) noexcept { std::swap(*this, other); }
  bool is_placeholder() const noexcept { return placeholder_; }

  const accessor& operator=(const plain& value) const
      requires(Dimensions == 0 && Mode != access_mode::read) {
    *this->get_pointer() = value;
    return *this;
  }

  friend bool operator==(const accessor& a, const accessor& b) noexcept {
    return a.number() == b.number();
  }

 private:
  template <typename T, typename AllocatorT>
  static range<detail::rank_v<Dimensions>> shape(
      const buffer<T, detail::rank_v<Dimensions>, AllocatorT>& buf) {
    if constexpr (Dimensions == 0) {
      return range<1>(1);
    } else {
      return buf.get_range();
    }
  }

  bool placeholder_ = true;
};

/// The host's access to a buffer. Its construction waits for the commands before it; commands
/// after it wait until it and its copies are gone.
template <typename DataT, int Dimensions, access_mode Mode>
class host_accessor : public detail::accessor_base<DataT, Dimensions, Mode> {
  using base = detail::accessor_base<DataT, Dimensions, Mode>;
  using plain = std::remove_const_t<DataT>;

 public:
  host_accessor() noexcept = default;

  template <typename T, int D, typename AllocatorT>
  requires(std::is_same_v<std::remove_const_t<T>, plain>&& D == detail::rank_v<Dimensions>)
      host_accessor(buffer<T, D, AllocatorT>& buf, const property_list& properties = {})
      : host_accessor(buf, shape(buf), id<detail::rank_v<Dimensions>>(), properties) {}
  template <typename T, int D, typename AllocatorT>
  requires(std::is_same_v<std::remove_const_t<T>, plain>&& D == detail::rank_v<Dimensions>)
      host_accessor(buffer<T, D, AllocatorT>& buf, mode_tag_t<Mode>,
                    const property_list& properties = {})
      : host_accessor(buf, shape(buf), id<detail::rank_v<Dimensions>>(), properties) {}
  template <typename T, typename AllocatorT>
  host_accessor(buffer<T, detail::rank_v<Dimensions>, AllocatorT>& buf,
                range<detail::rank_v<Dimensions>> extent,
                const property_list& properties = {}) requires(Dimensions > 0)
      : host_accessor(buf, extent, id<detail::rank_v<Dimensions>>(), properties) {}
  template <typename T, typename AllocatorT>
  host_accessor(buffer<T, detail::rank_v<Dimensions>, AllocatorT>& buf,
                range<detail::rank_v<Dimensions>> extent, mode_tag_t<Mode>,
                const property_list& properties = {}) requires(Dimensions > 0)
      : host_accessor(buf, extent, id<detail::rank_v<Dimensions>>(), properties) {}
  template <typename T, typename AllocatorT>
  host_accessor(buffer<T, detail::rank_v<Dimensions>, AllocatorT>& buf,
                range<detail::rank_v<Dimensions>> extent, id<detail::rank_v<Dimensions>> offset,
                const property_list& properties = {})
      : base(buf.view().bytes(), shape(buf), extent, offset, properties),
        access_(detail::begin_host_access(this->bytes(), Mode)) {}
  template <typename T, typename AllocatorT>
  host_accessor(buffer<T, detail::rank_v<Dimensions>, AllocatorT>& buf,
                range<detail::rank_v<Dimensions>> extent, id<detail::rank_v<Dimensions>> offset,
                mode_tag_t<Mode>, const property_list& properties = {}) requires(Dimensions > 0)
      : host_accessor(buf, extent, offset, properties) {}

  /// A read-only accessor from any other of the same memory.
  template <typename OtherT, access_mode OtherMode>
  requires(Mode == access_mode::read &&
           std::is_same_v<std::remove_const_t<OtherT>, std::remove_const_t<DataT>> &&
           (!std::is_same_v<OtherT, DataT> || OtherMode != Mode) && OtherMode != access_mode::write)
      host_accessor(const host_accessor<OtherT, Dimensions, OtherMode>& other)
  noexcept : base(other), access_(other.access_) {}

  void swap(host_accessor& other) noexcept { std::swap(*this, other); }

  const host_accessor& operator=(const plain& value) const
      requires(Dimensions == 0 && Mode != access_mode::read) {
    *this->get_pointer() = value;
    return *this;
  }

  friend bool operator==(const host_accessor& a, const host_accessor& b) noexcept {
    return a.number() == b.number();
  }

 private:
  template <typename, int, access_mode>
  friend class host_accessor;

  template <typename T, typename AllocatorT>
  static range<detail::rank_v<Dimensions>> shape(
      const buffer<T, detail::rank_v<Dimensions>, AllocatorT>& buf) {
    if constexpr (Dimensions == 0) {
      return range<1>(1);
    } else {
      return buf.get_range();
    }
  }

  std::shared_ptr<void> access_;
};

namespace detail {
/// The element type that a mode implies: read-only accessors have const elements.
template <typename T, access_mode Mode>
using accessed_t = std::conditional_t<Mode == access_mode::read, const T, T>;
}  // namespace detail

#define SYCL_DETAIL_BUFFER buffer<T, D, A>&
#define SYCL_DETAIL_GUIDES(...)                                                                  \
  template <typename T, int D, typename A>                                                       \
  accessor(SYCL_DETAIL_BUFFER __VA_OPT__(, ) __VA_ARGS__, const property_list& = {})             \
      -> accessor<T, D, access_mode::read_write, target::device, access::placeholder::true_t>;   \
  template <typename T, int D, typename A, access_mode M>                                        \
  accessor(SYCL_DETAIL_BUFFER __VA_OPT__(, ) __VA_ARGS__, mode_tag_t<M>,                         \
           const property_list& = {})                                                            \
      -> accessor<detail::accessed_t<T, M>, D, M, target::device, access::placeholder::true_t>;  \
  template <typename T, int D, typename A, access_mode M, target G>                              \
  accessor(SYCL_DETAIL_BUFFER __VA_OPT__(, ) __VA_ARGS__, mode_target_tag_t<M, G>,               \
           const property_list& = {})                                                            \
      -> accessor<detail::accessed_t<T, M>, D, M, G, access::placeholder::true_t>;               \
  template <typename T, int D, typename A>                                                       \
  accessor(SYCL_DETAIL_BUFFER, handler& __VA_OPT__(, ) __VA_ARGS__, const property_list& = {})   \
      -> accessor<T, D, access_mode::read_write, target::device, access::placeholder::false_t>;  \
  template <typename T, int D, typename A, access_mode M>                                        \
  accessor(SYCL_DETAIL_BUFFER, handler& __VA_OPT__(, ) __VA_ARGS__, mode_tag_t<M>,               \
           const property_list& = {})                                                            \
      -> accessor<detail::accessed_t<T, M>, D, M, target::device, access::placeholder::false_t>; \
  template <typename T, int D, typename A, access_mode M, target G>                              \
  accessor(SYCL_DETAIL_BUFFER, handler& __VA_OPT__(, ) __VA_ARGS__, mode_target_tag_t<M, G>,     \
           const property_list& = {})                                                            \
      -> accessor<detail::accessed_t<T, M>, D, M, G, access::placeholder::false_t>;              \
  template <typename T, int D, typename A>                                                       \
  host_accessor(SYCL_DETAIL_BUFFER __VA_OPT__(, ) __VA_ARGS__, const property_list& = {})        \
      -> host_accessor<T, D, access_mode::read_write>;                                           \
  template <typename T, int D, typename A, access_mode M>                                        \
  host_accessor(SYCL_DETAIL_BUFFER __VA_OPT__(, ) __VA_ARGS__, mode_tag_t<M>,                    \
                const property_list& = {}) -> host_accessor<detail::accessed_t<T, M>, D, M>;
SYCL_DETAIL_GUIDES()
SYCL_DETAIL_GUIDES(range<D>)
SYCL_DETAIL_GUIDES(range<D>, id<D>)
#undef SYCL_DETAIL_GUIDES
#undef SYCL_DETAIL_BUFFER

template <typename DataT, int D, access_mode M, target G, access::placeholder P>
struct is_property_of<property::no_init, accessor<DataT, D, M, G, P>> : std::true_type {};
template <typename DataT, int D, access_mode M>
struct is_property_of<property::no_init, host_accessor<DataT, D, M>> : std::true_type {};

template <typename T, int Dimensions, typename AllocatorT>
template <access_mode Mode, target Target>
auto buffer<T, Dimensions, AllocatorT>::get_access(handler& cgh) {
  return accessor<T, Dimensions, Mode, Target>(*this, cgh);
}
template <typename T, int Dimensions, typename AllocatorT>
template <access_mode Mode, target Target>
auto buffer<T, Dimensions, AllocatorT>::get_access(handler& cgh, range<Dimensions> extent,
                                                   id<Dimensions> offset) {
  return accessor<T, Dimensions, Mode, Target>(*this, cgh, extent, offset);
}
template <typename T, int Dimensions, typename AllocatorT>
template <typename... Ts>
auto buffer<T, Dimensions, AllocatorT>::get_access(Ts... args) {
  return accessor{*this, args...};
}
template <typename T, int Dimensions, typename AllocatorT>
template <typename... Ts>
auto buffer<T, Dimensions, AllocatorT>::get_access(handler& cgh, Ts... args) {
  return accessor{*this, cgh, args...};
}
template <typename T, int Dimensions, typename AllocatorT>
template <typename... Ts>
auto buffer<T, Dimensions, AllocatorT>::get_host_access(Ts... args) {
  return host_accessor{*this, args...};
}

template <typename SrcT, int D, access_mode M, target Tgt, access::placeholder P, typename DestT>
void handler::copy(accessor<SrcT, D, M, Tgt, P> src, DestT* dest) {
  auto* const out = static_cast<std::remove_const_t<SrcT>*>(dest);
  parallel_for(range<1>(src.size()),
               [src, out](id<1> i) { out[i[0]] = src.begin()[static_cast<std::ptrdiff_t>(i[0])]; });
}
template <typename SrcT, int D, access_mode M, target Tgt, access::placeholder P, typename DestT>
void handler::copy(accessor<SrcT, D, M, Tgt, P> src, std::shared_ptr<DestT> dest) {
  parallel_for(range<1>(src.size()), [src, dest](id<1> i) {
    static_cast<std::remove_const_t<SrcT>*>(dest.get())[i[0]] =
        src.begin()[static_cast<std::ptrdiff_t>(i[0])];
  });
}
template <typename SrcT, typename DestT, int D, access_mode M, target Tgt, access::placeholder P>
void handler::copy(const SrcT* src, accessor<DestT, D, M, Tgt, P> dest) {
  const auto* const in = static_cast<const DestT*>(src);
  parallel_for(range<1>(dest.size()),
               [in, dest](id<1> i) { dest.begin()[static_cast<std::ptrdiff_t>(i[0])] = in[i[0]]; });
}
template <typename SrcT, typename DestT, int D, access_mode M, target Tgt, access::placeholder P>
void handler::copy(std::shared_ptr<SrcT> src, accessor<DestT, D, M, Tgt, P> dest) {
  parallel_for(range<1>(dest.size()), [src, dest](id<1> i) {
    dest.begin()[static_cast<std::ptrdiff_t>(i[0])] = static_cast<const DestT*>(src.get())[i[0]];
  });
}
template <typename SrcT, int SrcD, access_mode SrcM, target SrcTgt, access::placeholder SrcP,
          typename DestT, int DestD, access_mode DestM, target DestTgt, access::placeholder DestP>
void handler::copy(accessor<SrcT, SrcD, SrcM, SrcTgt, SrcP> src,
                   accessor<DestT, DestD, DestM, DestTgt, DestP> dest) {
  detail::check_access_range(dest.byte_size(), 0, src.byte_size());
  parallel_for(range<1>(src.size()), [src, dest](id<1> i) {
    const auto position = static_cast<std::ptrdiff_t>(i[0]);
    dest.begin()[position] = src.begin()[position];
  });
}
template <typename T, int D, access_mode M, target Tgt, access::placeholder P>
void handler::fill(accessor<T, D, M, Tgt, P> dest, const std::remove_const_t<T>& value) {
  parallel_for(range<1>(dest.size()),
               [dest, value](id<1> i) { dest.begin()[static_cast<std::ptrdiff_t>(i[0])] = value; });
}
template <typename T, int D, access_mode M, target Tgt, access::placeholder P>
void handler::update_host(accessor<T, D, M, Tgt, P>) {
  begin_action();
  set_nothing();
}

}  // namespace sycl

template <typename DataT, int D, sycl::access_mode M, sycl::target G, sycl::access::placeholder P>
struct std::hash<sycl::accessor<DataT, D, M, G, P>> {
  std::size_t operator()(const sycl::accessor<DataT, D, M, G, P>& acc) const noexcept {
    return std::hash<std::uint64_t>()(acc.number());
  }
};
template <typename DataT, int D, sycl::access_mode M>
struct std::hash<sycl::host_accessor<DataT, D, M>> {
  std::size_t operator()(const sycl::host_accessor<DataT, D, M>& acc) const noexcept {
    return std::hash<std::uint64_t>()(acc.number());
  }
};
