/// Strangers' texts inside markup, and markup for readers of either direction.
#pragma once

#include <stddef.h>

#include <string>

/// A stranger's text as markup of at most `limit` bytes: cut between characters, so the markup is
/// always whole. Line breaks and other control characters become blanks.
std::string zqvEscapeWithin(const char* text, size_t limit);

/// A message that takes one text ('s'), filled with a stranger's name; markup of at most `limit`
/// bytes.
std::string zqvFormatName(const char* id, const char* name, size_t limit);

/// Markup that is set to the left, set to where the reader begins instead.
std::string zqvFromReadingSide(const char* markup, bool isRightToLeft);
