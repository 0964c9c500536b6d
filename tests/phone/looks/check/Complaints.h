// What a person would find wrong with the texts of a page.
#pragma once

#include "Look.h"

/// One line each. Lines that have no room for larger text may end in dots.
std::vector<std::string> complaintsAbout(const Look& look, bool isTextLarger);

/// Does the page show the message? What the message leaves open may be anything.
bool shows(const Look& look, const std::string& message);
/// Does the message begin at the margin where the language begins to read?
bool beginsAtTheMargin(const Look& look, const std::string& message, bool isRightToLeft);
