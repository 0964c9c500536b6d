/// Strangers' texts inside markup.
#pragma once

#include <stddef.h>

#include <string>

/// A stranger's text as markup of at most `limit` bytes: cut between characters, so the markup is
/// always whole. Line breaks and other control characters become blanks.
std::string zqvEscapeWithin(const char* text, size_t limit);

/// A message that takes one text ('s'), filled with a stranger's name; markup of at most `limit`
/// bytes.
std::string zqvFormatName(const char* id, const char* name, size_t limit);
