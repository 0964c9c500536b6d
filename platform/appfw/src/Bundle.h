/// What a bundle is made of.
#pragma once

#include <bundle.h>
#include <common/Owned.h>

#include <list>
#include <string>
#include <vector>

/// One key and its text or texts. Never moved or copied: the getters hand out pointers into it.
struct keyval_t {
  keyval_t(std::string key, std::string text);
  keyval_t(std::string key, std::vector<std::string> texts);
  keyval_t(const keyval_t&) = delete;
  keyval_t& operator=(const keyval_t&) = delete;

  bool isArray() const { return type == BUNDLE_TYPE_STR_ARRAY; }

  const std::string key;
  const int type;
  const std::string text;
  const std::vector<std::string> texts;
  /// The texts and a null at the end.
  std::vector<const char*> pointers;
};

struct _bundle_t {
  const keyval_t* find(const std::string& key) const;
  /// False when the key exists already.
  template <typename Value>
  bool add(const std::string& key, Value value) {
    if (find(key)) return false;
    entries.emplace_back(key, std::move(value));
    return true;
  }
  bool remove(const std::string& key);
  void copyFrom(const _bundle_t& other);

  std::list<keyval_t> entries;
};

namespace appfw {

using OwnedBundle = common::Owned<bundle, bundle_free>;

/// What the platform makes for itself never fails as an application's call may.
inline OwnedBundle emptyBundle() {
  return OwnedBundle(new _bundle_t);
}

}  // namespace appfw
