// phone-vconf get KEY | set KEY TEXT [KEY TEXT...] | set-int KEY NUMBER: the phone's settings
// store.

#include <vconf.h>

#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <memory>

namespace {

constexpr int kWrongCall = 2;

struct Free {
  void operator()(char* text) const { free(text); }
};

int fail(const char* what, const char* key) {
  fprintf(stderr, "phone-vconf: %s '%s'\n", what, key);
  return 1;
}

int get(const char* key) {
  if (const std::unique_ptr<char, Free> text{vconf_get_str(key)}; text) {
    puts(text.get());
    return 0;
  }
  int number = 0;
  if (vconf_get_int(key, &number) != VCONF_OK) return fail("nothing is stored under", key);
  printf("%d\n", number);
  return 0;
}

int setTexts(char** words, int count) {
  for (int i = 0; i + 1 < count; i += 2) {
    if (vconf_set_str(words[i], words[i + 1]) != VCONF_OK) return fail("cannot store", words[i]);
  }
  return 0;
}

}  // namespace

int main(int argc, char** argv) {
  if (argc == 3 && strcmp(argv[1], "get") == 0) return get(argv[2]);
  if (argc > 3 && argc % 2 == 0 && strcmp(argv[1], "set") == 0) {
    return setTexts(argv + 2, argc - 2);
  }
  if (argc == 4 && strcmp(argv[1], "set-int") == 0) {
    return vconf_set_int(argv[2], atoi(argv[3])) == VCONF_OK ? 0 : fail("cannot store", argv[2]);
  }
  fputs("phone-vconf get KEY | set KEY TEXT [KEY TEXT...] | set-int KEY NUMBER\n", stderr);
  return kWrongCall;
}
