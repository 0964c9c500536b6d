/// Owners of GLib handles.
#pragma once

#include <gio/gio.h>

#include <memory>

namespace downloads {

template <auto Free>
struct Release {
  template <typename T>
  void operator()(T* handle) const {
    Free(handle);
  }
};

template <typename T>
using OwnedObject = std::unique_ptr<T, Release<g_object_unref>>;
using OwnedText = std::unique_ptr<char, Release<g_free>>;
using OwnedError = std::unique_ptr<GError, Release<g_error_free>>;
using OwnedVariant = std::unique_ptr<GVariant, Release<g_variant_unref>>;
using OwnedBytes = std::unique_ptr<GBytes, Release<g_bytes_unref>>;

}  // namespace downloads
