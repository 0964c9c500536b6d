// phone-contact add NAME NUMBER [PHOTO] | import FILE | rename OLD NEW | remove NAME | list: the
// phone's address book. FILE holds vCards.

#include <contacts/AddressBookEditor.h>

#include <cstdio>
#include <fstream>
#include <iterator>
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

bool importFile(AddressBookEditor& book, const std::string& file, std::string& error) {
  std::ifstream source(file, std::ios::binary);
  error = "cannot read " + file;
  return source && book.import({std::istreambuf_iterator<char>(source), {}}, error);
}

}  // namespace

int main(int argc, char** argv) {
  const std::vector<std::string> words(argv + 1, argv + argc);
  const std::string what = words.empty() ? "" : words[0];
  const bool add = what == "add" && (words.size() == 3 || words.size() == 4);
  const bool rename = what == "rename" && words.size() == 3;
  const bool remove = what == "remove" && words.size() == 2;
  const bool import = what == "import" && words.size() == 2;
  if (!add && !rename && !remove && !import && !(what == "list" && words.size() == 1)) {
    fputs(
        "phone-contact add NAME NUMBER [PHOTO] | import FILE | rename OLD NEW | remove NAME | "
        "list\n",
        stderr);
    return kWrongCall;
  }
  AddressBookEditor book;
  std::string error = "there is no address book";
  bool done = false;
  if (book.isOpen()) {
    if (what == "list") return list(book);
    if (add) done = book.add({words[1], {words[2]}, words.size() > 3 ? words[3] : ""}, error);
    if (rename) done = book.rename(words[1], words[2], error);
    if (import) done = importFile(book, words[1], error);
    if (remove) done = book.remove(words[1], error);
  }
  if (!done) fprintf(stderr, "phone-contact: %s\n", error.c_str());
  return done ? 0 : 1;
}
