/// Every text that a person reads, by message id.
#pragma once

#include <string>

#define ZQV_TEXT_DOMAIN "zelqo"

/// The text of a message: the application's catalogue first, then the platform's, else the id
/// itself. Null and empty give an empty text. Never freed by the caller.
const char* zqvText(const char* id);

/// The text of a message filled in. `arguments` lists what follows, one letter each: 's' for
/// const char*, 'd' for int. A catalogue text that takes anything else is not trusted: the plain id
/// is the result.
std::string zqvFormat(const char* id, const char* arguments, ...);

/// A stranger's text as it may stand in markup, shown as it is.
std::string zqvEscape(const char* text);
