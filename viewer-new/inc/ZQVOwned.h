/// Owners of C handles. Two ways to release are two types, so what came from one allocator is never
/// handed to another by accident.
#pragma once

#include <app_control.h>
#include <bundle.h>
#include <glib.h>

#include <cstddef>
#include <cstdlib>
#include <type_traits>
#include <utility>

/// The one owner of a handle that `Release` frees; null owns nothing.
template <typename T, auto Release>
class ZQVOwned {
 public:
  ZQVOwned(std::nullptr_t = nullptr) {}
  explicit ZQVOwned(T* handle) : _handle(handle) {}
  ZQVOwned(ZQVOwned&& other) noexcept : _handle(other.release()) {}
  ~ZQVOwned() { reset(); }
  ZQVOwned& operator=(ZQVOwned&& other) noexcept {
    if (this != &other) reset(other.release());
    return *this;
  }

  T* get() const { return _handle; }
  T* operator->() const { return _handle; }
  T& operator*() const { return *_handle; }
  explicit operator bool() const { return _handle != nullptr; }

  void reset(T* handle = nullptr) {
    if (T* old = std::exchange(_handle, handle)) Release(old);
  }
  [[nodiscard]] T* release() { return std::exchange(_handle, nullptr); }

  /// Where a C function may write the handle that it gives away.
  T** out() {
    reset();
    return &_handle;
  }

 private:
  T* _handle = nullptr;
};

/// A text of GLib's.
using ZQVOwnedText = ZQVOwned<char, g_free>;
/// A text that the platform gave away.
using ZQVPlatformText = ZQVOwned<char, free>;
using ZQVOwnedAppControl = ZQVOwned<std::remove_pointer_t<app_control_h>, app_control_destroy>;
using ZQVOwnedBundle = ZQVOwned<bundle, bundle_free>;
