/// Which program of the phone opens a file, by what the file contains.
#pragma once

#include <common/Owned.h>
#include <gio/gdesktopappinfo.h>

#include <string>

namespace mime {

using OwnedAppInfo = common::OwnedObject<GAppInfo>;

/// The MIME type of a file's content; its name only refines it (a zip archive that is named .docx).
/// Empty when the file may not be opened: not a plain readable file, a link, executable, a script,
/// a desktop entry, or of no known type.
std::string openableType(const std::string& path);

/// The program for openableType(path), or null.
OwnedAppInfo handlerFor(const std::string& path);

/// The path that a launch request's URI means: one of the form file://, or the path itself. Empty
/// for anything else.
std::string pathOfUri(const std::string& uri);

/// Whether some program of the phone opens what the URI means.
bool resolver_can_open(const char* uri);

}  // namespace mime
