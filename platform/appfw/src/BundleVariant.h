/// Bundles as they travel: a{sv} in the bundle's order, texts as s, text arrays as as.
#pragma once

#include "Bundle.h"

namespace appfw {

constexpr size_t kMaxBundleBytes = size_t{1024} * 1024;

/// A floating reference. What is not UTF-8 gets replacement characters: the bus takes nothing else.
GVariant* toVariant(const bundle& contents);
/// What is neither text nor text array, has no key, or comes a second time is left out and logged.
OwnedBundle fromVariant(GVariant* contents);

/// The text with replacement characters for what is not UTF-8.
std::string utf8(const std::string& text);

}  // namespace appfw
