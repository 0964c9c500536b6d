/// Owners of GLib handles.
#pragma once

#include <base/Owned.h>

namespace downloads {

template <typename T>
using OwnedObject = base::Owned<T, g_object_unref>;
using OwnedBytes = base::Owned<GBytes, g_bytes_unref>;
using base::OwnedError;
using base::OwnedText;

}  // namespace downloads
