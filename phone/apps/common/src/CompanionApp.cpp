#include "companion/CompanionApp.h"

#include <app_common.h>
#include <appfw/AppId.h>
#include <common/Owned.h>

#include <cstdlib>

namespace companion {
namespace {

std::string resource(const std::string& name) {
  const common::OwnedPlainText folder(app_get_resource_path());
  return (folder ? folder.get() : "") + name;
}

}  // namespace

std::string themeFile() {
  return resource("edje/companion.edj");
}

std::string imageFile(const char* name) {
  return resource(std::string("images/") + name);
}

app_assist::WNaviframeController* CompanionApp::pages() {
  if (_pages) return _pages;
  // Adds only what the device theme lacks, which stays in charge of everything it knows.
  elm_theme_extension_add(nullptr, themeFile().c_str());
  auto* window = new app_assist::WWindowController(appfw::applicationId().c_str(), ELM_WIN_BASIC);
  attachWindowController(window);
  _pages = new app_assist::WNaviframeController;
  window->attachBaseViewController(_pages);
  _pages->setOnLastItemPop([this](bool* handled) {
    *handled = onLeave();
    if (!*handled) elm_exit();
  });
  return _pages;
}

void CompanionApp::raise() {
  if (hasWindow()) elm_win_activate(getWindowController()->getEvasObj());
}

void CompanionApp::lower() {
  if (hasWindow()) elm_win_lower(getWindowController()->getEvasObj());
}

bool CompanionApp::onLeave() {
  return false;
}

}  // namespace companion
