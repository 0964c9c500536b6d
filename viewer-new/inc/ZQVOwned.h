/// Owners of C handles. Two ways to release are two types, so what came from one allocator is never
/// handed to another by accident.
#pragma once

#include <app_control.h>
#include <bundle.h>
#include <glib.h>

#include <memory>
#include <type_traits>

template <auto Release>
struct ZQVRelease {
  template <typename T>
  void operator()(T* handle) const {
    Release(handle);
  }
};

template <typename T, auto Release>
using ZQVOwned = std::unique_ptr<T, ZQVRelease<Release>>;

using ZQVOwnedText = ZQVOwned<char, g_free>;
using ZQVOwnedAppControl = ZQVOwned<std::remove_pointer_t<app_control_h>, app_control_destroy>;
using ZQVOwnedBundle = ZQVOwned<bundle, bundle_free>;

/// For C functions that answer through an out-parameter: `get(handle, ZQVOut(text))`.
template <typename Owner>
class ZQVOut {
 public:
  explicit ZQVOut(Owner& owner) : _owner(owner) {}
  ~ZQVOut() { _owner.reset(_handle); }
  ZQVOut(const ZQVOut&) = delete;
  ZQVOut& operator=(const ZQVOut&) = delete;
  operator typename Owner::pointer *() { return &_handle; }

 private:
  Owner& _owner;
  typename Owner::pointer _handle = nullptr;
};
