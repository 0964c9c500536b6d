/// Which program of the phone opens a file, by what the file contains.
#pragma once

#include <base/Owned.h>
#include <gio/gdesktopappinfo.h>

#include <string>

namespace mime {

using OwnedAppInfo = base::Owned<GAppInfo, g_object_unref>;

/// The MIME type of a file's content; its name only refines it (a zip archive that is named .docx).
/// Empty when the file may not be opened: not a plain readable file, a link, executable, a script,
/// a desktop entry, or of no known type.
std::string openableType(const std::string& path);

/// The program for openableType(path), or null.
OwnedAppInfo handlerFor(const std::string& path);

/// Whether handlerFor(path) finds a program.
bool resolver_can_open(const char* path);

}  // namespace mime
