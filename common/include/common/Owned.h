/// Owners of C handles. Two ways to release are two types, so what came from one allocator is never
/// handed to another by accident.
#pragma once

#include <gio/gio.h>

#include <cstdlib>
#include <memory>

namespace common {

template <auto Release>
struct ReleaseWith {
  template <typename T>
  void operator()(T* handle) const {
    Release(handle);
  }
};

template <typename T, auto Release>
using Owned = std::unique_ptr<T, ReleaseWith<Release>>;

/// One reference to a GObject.
template <typename T>
using OwnedObject = Owned<T, g_object_unref>;

using OwnedText = Owned<char, g_free>;
/// Of the platform's and the toolkit's calls that give a text away as malloc made it.
using OwnedPlainText = Owned<char, std::free>;
using OwnedTexts = Owned<char*, g_strfreev>;
using OwnedError = Owned<GError, g_error_free>;
using OwnedBytes = Owned<GBytes, g_bytes_unref>;
using OwnedVariant = Owned<GVariant, g_variant_unref>;
using OwnedBus = OwnedObject<GDBusConnection>;
using OwnedMessage = OwnedObject<GDBusMessage>;

template <typename T>
OwnedObject<T> refer(T* object) {
  return OwnedObject<T>(static_cast<T*>(g_object_ref(object)));
}

/// For C functions that answer through an out-parameter: `get(handle, Out(text))`.
template <typename Owner>
class Out {
 public:
  explicit Out(Owner& owner) : _owner(owner) {}
  ~Out() { _owner.reset(_handle); }
  Out(const Out&) = delete;
  Out& operator=(const Out&) = delete;
  operator typename Owner::pointer *() { return &_handle; }

 private:
  Owner& _owner;
  typename Owner::pointer _handle = nullptr;
};

}  // namespace common
