// looks-check [--larger] [--languages "LANGUAGE..."] [--pictures PREFIX] [--begins ID] ID...: goes
// through the languages of the phone, all or these, with the page that the viewer shows now, and
// prints what is wrong with its texts, one line each. Each ID is a message that the page has to
// show; one of them may have to begin at the margin. With a prefix every language leaves a picture
// of the screen, PREFIX-LANGUAGE.png.

#include <base/Bus.h>
#include <libintl.h>
#include <unicode/uloc.h>
#include <vconf-keys.h>
#include <vconf.h>

#include <algorithm>
#include <clocale>
#include <cstdio>
#include <cstdlib>
#include <cstring>

#include "Complaints.h"

namespace {

/// The phone stands in this one before and after.
constexpr const char* kLast = "en_US.UTF-8";

bool isWanted(const std::string& language, const std::string& wanted) {
  return wanted.empty() || wanted.find(language.substr(0, language.find('_'))) != std::string::npos;
}

std::vector<std::string> languages(const std::string& wanted) {
  std::vector<std::string> all;
  const char* folder = getenv("LOCPATH");
  const common::Owned<GDir, g_dir_close> entries(folder ? g_dir_open(folder, 0, nullptr) : nullptr);
  while (const char* name = entries ? g_dir_read_name(entries.get()) : nullptr) {
    if (*name != '.' && strcmp(name, kLast) != 0 && isWanted(name, wanted)) all.emplace_back(name);
  }
  std::sort(all.begin(), all.end());
  all.emplace_back(kLast);
  return all;
}

struct Wishes {
  bool isTextLarger = false;
  std::string languages;
  std::string pictures;
  std::string begins;
  std::vector<std::string> messages;
};

Wishes read(int count, char** words) {
  Wishes wishes;
  for (int i = 1; i < count; i++) {
    const std::string word = words[i];
    if (word == "--larger") {
      wishes.isTextLarger = true;
    } else if (word == "--languages" && i + 1 < count) {
      wishes.languages = words[++i];
    } else if (word == "--pictures" && i + 1 < count) {
      wishes.pictures = words[++i];
    } else if (word == "--begins" && i + 1 < count) {
      wishes.begins = words[++i];
    } else {
      wishes.messages.push_back(word);
    }
  }
  return wishes;
}

std::string message(const std::string& id) {
  return dgettext("zelqo", id.c_str());
}

void takePicture(const std::string& prefix, const std::string& language) {
  const std::string file = prefix + '-' + language.substr(0, language.find('.')) + ".png";
  const common::OwnedText quoted(g_shell_quote(file.c_str()));
  if (system((std::string(PHONE_SCREEN " >") + quoted.get()).c_str()) != 0) {
    printf("no picture %s\n", file.c_str());
  }
}

void check(const Look& look, const Wishes& wishes) {
  for (const std::string& complaint : complaintsAbout(look, wishes.isTextLarger)) {
    puts(complaint.c_str());
  }
  const char* language = look.language.c_str();
  for (const std::string& id : wishes.messages) {
    if (!shows(look, message(id))) printf("%s: %s is not shown\n", language, id.c_str());
  }
  if (!wishes.begins.empty() &&
      !beginsAtTheMargin(look, message(wishes.begins), uloc_isRightToLeft(language))) {
    printf("%s: %s does not begin at the margin\n", language, wishes.begins.c_str());
  }
}

}  // namespace

int main(int argc, char** argv) {
  const Wishes wishes = read(argc, argv);
  const common::OwnedBus bus = base::sessionBus();
  if (!bus) return 1;
  bindtextdomain("zelqo", "/opt/usr/apps/com.orlant.zelqo/res/locale");
  bind_textdomain_codeset("zelqo", "UTF-8");
  for (const std::string& language : languages(wishes.languages)) {
    vconf_set_str(VCONFKEY_REGIONFORMAT, language.c_str());
    vconf_set_str(VCONFKEY_LANGSET, language.c_str());
    setlocale(LC_ALL, language.c_str());
    const auto look = lookIn(bus.get(), language);
    if (!look) {
      printf("%s: the page does not come to rest in it\n", language.c_str());
      continue;
    }
    check(*look, wishes);
    if (!wishes.pictures.empty()) takePicture(wishes.pictures, language);
  }
  return 0;
}
