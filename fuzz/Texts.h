#pragma once

#include <stddef.h>
#include <stdint.h>

#include <string>
#include <vector>

/// The input cut into texts at every `separator`; at least `count` of them, the missing ones empty.
inline std::vector<std::string> textsOf(const uint8_t* data, size_t size, char separator,
                                        size_t count = 0) {
  std::vector<std::string> texts(1);
  for (size_t i = 0; i < size; ++i) {
    if (static_cast<char>(data[i]) == separator) {
      texts.emplace_back();
    } else {
      texts.back() += static_cast<char>(data[i]);
    }
  }
  if (texts.size() < count) texts.resize(count);
  return texts;
}
