#include "Language.h"

#include <Elementary.h>
#include <app_common.h>
#include <libintl.h>
#include <unicode/uloc.h>
#include <vconf.h>

#include <base/PhonePaths.h>
#include <common/Owned.h>

#include <clocale>
#include <cstdlib>

extern "C" {
/// Part of gettext's interface: counting up makes it look at LANGUAGE again.
extern int _nl_msg_cat_cntr;
}

namespace app_assist {
namespace {

void bind(const char* domain, const std::string& folder) {
  bindtextdomain(domain, folder.c_str());
  bind_textdomain_codeset(domain, "UTF-8");
}

/// Domains are the names of the catalogues of any language.
void bindFolder(const std::string& folder) {
  const common::Owned<GDir, g_dir_close> languages(g_dir_open(folder.c_str(), 0, nullptr));
  while (const char* language = languages ? g_dir_read_name(languages.get()) : nullptr) {
    const std::string messages = folder + "/" + language + "/LC_MESSAGES";
    const common::Owned<GDir, g_dir_close> files(g_dir_open(messages.c_str(), 0, nullptr));
    while (const char* file = files ? g_dir_read_name(files.get()) : nullptr) {
      if (!g_str_has_suffix(file, ".mo")) continue;
      const std::string name(file);
      bind(name.substr(0, name.size() - 3).c_str(), folder);
    }
  }
}

/// Without the locale itself its messages are still to be had; numbers and dates then are plain.
void applyMessagesOnly(const std::string& locale) {
  setenv("LANGUAGE", locale.substr(0, locale.find('.')).c_str(), 1);
  _nl_msg_cat_cntr++;
  elm_language_set("C.UTF-8");
}

/// That of the settings, else that of the environment.
std::string wantedLocale() {
  const common::OwnedPlainText setting(vconf_get_str(VCONFKEY_LANGSET));
  if (setting && *setting) return setting.get();
  const char* inherited = setlocale(LC_MESSAGES, "");
  return inherited ? inherited : "C.UTF-8";
}

/// All but the order of texts: its tables take two megabytes, and hardly any application sorts.
bool setLocale(const char* locale) {
  for (const int category : {LC_CTYPE, LC_NUMERIC, LC_TIME, LC_MONETARY, LC_MESSAGES}) {
    if (!setlocale(category, locale)) return false;
  }
  return true;
}

void setDirection(const std::string& locale) {
  elm_config_mirrored_set(uloc_isRightToLeft(locale.c_str()) ? EINA_TRUE : EINA_FALSE);
}

}  // namespace

void Language::bindCatalogues() {
  bindFolder(base::phoneRoot() + "/share/locale");
  const common::OwnedPlainText resources(app_get_resource_path());
  if (resources) bindFolder(std::string(resources.get()) + "locale");
}

void Language::begin() {
  const std::string locale = wantedLocale();
  if (setLocale(locale.c_str())) {
    unsetenv("LANGUAGE");
    evas_language_reinit();
    edje_language_set(locale.c_str());
  } else {
    applyMessagesOnly(locale);
  }
  setDirection(locale);
}

void Language::change() {
  const std::string locale = wantedLocale();
  if (setLocale(locale.c_str())) {
    unsetenv("LANGUAGE");
    elm_language_set(locale.c_str());
  } else {
    applyMessagesOnly(locale);
  }
  setDirection(locale);
}

}  // namespace app_assist
