#include <appfw/PreferenceStore.h>
#include <base/PhonePaths.h>

namespace appfw {
namespace {

using Store = base::KeyValueStore;

int errorOf(Store::Answer answer) {
  switch (answer) {
    case Store::Answer::Done:
      return PREFERENCE_ERROR_NONE;
    case Store::Answer::NoKey:
      return PREFERENCE_ERROR_NO_KEY;
    case Store::Answer::Failed:
      break;
  }
  return PREFERENCE_ERROR_IO_ERROR;
}

bool isKey(const std::string& key) {
  return !key.empty() && key.size() <= PreferenceStore::kMaxBytes;
}

}  // namespace

PreferenceStore::PreferenceStore(const std::string& appId)
    : _usable(!base::applicationFolder(appId).empty()),
      _store(base::applicationFolder(appId) + "data/.pref.db", Store::Reads::OfOneTurn) {}

int PreferenceStore::setText(const std::string& key, const std::string& value) {
  if (!isKey(key) || value.size() > kMaxBytes) return PREFERENCE_ERROR_INVALID_PARAMETER;
  return _usable ? errorOf(_store.set(key, value)) : PREFERENCE_ERROR_IO_ERROR;
}

int PreferenceStore::getText(const std::string& key, std::string& value) {
  if (!isKey(key)) return PREFERENCE_ERROR_INVALID_PARAMETER;
  if (!_usable) return PREFERENCE_ERROR_IO_ERROR;
  Store::Value stored;
  const int error = errorOf(_store.get(key, stored));
  const auto* text = std::get_if<std::string>(&stored);
  if (error == PREFERENCE_ERROR_NONE && text) value = *text;
  return text ? error : PREFERENCE_ERROR_IO_ERROR;
}

int PreferenceStore::remove(const std::string& key) {
  if (!isKey(key)) return PREFERENCE_ERROR_INVALID_PARAMETER;
  return _usable ? errorOf(_store.remove(key)) : PREFERENCE_ERROR_IO_ERROR;
}

int PreferenceStore::removeAll() {
  return _usable ? errorOf(_store.removeAll()) : PREFERENCE_ERROR_IO_ERROR;
}

int PreferenceStore::keys(std::vector<std::string>& keys) {
  return _usable ? errorOf(_store.keys(keys)) : PREFERENCE_ERROR_IO_ERROR;
}

}  // namespace appfw
