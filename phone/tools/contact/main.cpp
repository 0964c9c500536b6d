// phone-contact add NAME NUMBER [PHOTO] | rename OLD NEW | remove NAME | list: the address book.

#include <contacts/AddressBookEditor.h>

#include <cstdio>
#include <string>
#include <vector>

namespace {

using contacts::AddressBookEditor;

constexpr int kWrongCall = 2;

int list(AddressBookEditor& book) {
  for (const auto& entry : book.all()) {
    printf("%s", entry.name.c_str());
    for (const auto& number : entry.numbers) printf("\t%s", number.c_str());
    if (!entry.picture.empty()) printf("\t%s", entry.picture.c_str());
    putchar('\n');
  }
  return 0;
}

}  // namespace

int main(int argc, char** argv) {
  const std::vector<std::string> words(argv + 1, argv + argc);
  const std::string what = words.empty() ? "" : words[0];
  const bool add = what == "add" && (words.size() == 3 || words.size() == 4);
  const bool rename = what == "rename" && words.size() == 3;
  const bool remove = what == "remove" && words.size() == 2;
  if (!add && !rename && !remove && !(what == "list" && words.size() == 1)) {
    fputs("phone-contact add NAME NUMBER [PHOTO] | rename OLD NEW | remove NAME | list\n", stderr);
    return kWrongCall;
  }
  AddressBookEditor book;
  std::string error = "there is no address book";
  bool done = false;
  if (book.isOpen()) {
    if (what == "list") return list(book);
    if (add) done = book.add({words[1], {words[2]}, words.size() > 3 ? words[3] : ""}, error);
    if (rename) done = book.rename(words[1], words[2], error);
    if (remove) done = book.remove(words[1], error);
  }
  if (!done) fprintf(stderr, "phone-contact: %s\n", error.c_str());
  return done ? 0 : 1;
}
