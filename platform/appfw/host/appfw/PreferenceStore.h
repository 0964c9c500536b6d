/// The preferences of any one application.
#pragma once

#include <app_preference.h>
#include <base/KeyValueStore.h>

#include <string>
#include <vector>

namespace appfw {

/// All calls answer one of preference_error_e.
class PreferenceStore {
 public:
  static constexpr size_t kMaxBytes = size_t{64} * 1024;

  explicit PreferenceStore(const std::string& appId);

  int setText(const std::string& key, const std::string& value);
  int getText(const std::string& key, std::string& value);
  int remove(const std::string& key);
  int removeAll();
  /// Sorted.
  int keys(std::vector<std::string>& keys);

 private:
  const bool _usable;
  base::KeyValueStore _store;
};

}  // namespace appfw
