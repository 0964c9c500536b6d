// phone-prefs APPLICATION list | get KEY | set KEY VALUE | remove KEY: an application's
// preferences.

#include <appfw/PreferenceStore.h>

#include <cstdio>
#include <string>
#include <vector>

namespace {

using appfw::PreferenceStore;

constexpr int kWrongCall = 2;

int answer(int error, const std::string& key) {
  if (error == PREFERENCE_ERROR_NONE) return 0;
  if (error == PREFERENCE_ERROR_NO_KEY) {
    fprintf(stderr, "phone-prefs: there is no preference '%s'\n", key.c_str());
  } else {
    fprintf(stderr, "phone-prefs: '%s': error %d\n", key.c_str(), error);
  }
  return 1;
}

int list(PreferenceStore& store) {
  std::vector<std::string> keys;
  const int error = store.keys(keys);
  if (error == PREFERENCE_ERROR_NO_KEY) return 0;  // nothing was ever stored
  for (const auto& key : keys) {
    std::string value;
    if (store.getText(key, value) == PREFERENCE_ERROR_NONE) {
      printf("%s=%s\n", key.c_str(), value.c_str());
    }
  }
  return answer(error, "list");
}

int get(PreferenceStore& store, const std::string& key) {
  std::string value;
  const int error = store.getText(key, value);
  if (error == PREFERENCE_ERROR_NONE) puts(value.c_str());
  return answer(error, key);
}

}  // namespace

int main(int argc, char** argv) {
  if (argc >= 3) {
    PreferenceStore store(argv[1]);
    const std::string what = argv[2];
    if (what == "list" && argc == 3) return list(store);
    if (what == "get" && argc == 4) return get(store, argv[3]);
    if (what == "set" && argc == 5) return answer(store.setText(argv[3], argv[4]), argv[3]);
    if (what == "remove" && argc == 4) return answer(store.remove(argv[3]), argv[3]);
  }
  fputs("phone-prefs APPLICATION list | get KEY | set KEY VALUE | remove KEY\n", stderr);
  return kWrongCall;
}
