#include "ViewerSetting.h"

#include <filesystem>
#include <fstream>

namespace fs = std::filesystem;
using phone::thePhone;

namespace {

constexpr const char* kPrograms = "apps/com.orlant.zelqo/bin";

/// Stands before the viewer, for the phone starts the first program of an application.
std::string starter() {
  return ViewerSetting::outside(std::string(kPrograms) + "/a-starter");
}

}  // namespace

ViewerSetting::ViewerSetting(const phone::Words& environment) {
  fs::remove(outside("endings"));
  std::ofstream script(starter());
  script << "#!/bin/sh\nenv";
  for (const auto& variable : environment) script << " '" << variable << "'";
  script << " /opt/usr/" << kPrograms << "/zelqo-viewer \"$@\"\n"
         << "echo $? >>" << inPhone("endings") << "\n";
  script.close();
  fs::permissions(starter(), fs::perms::owner_all);
}

ViewerSetting::~ViewerSetting() {
  lift();
}

void ViewerSetting::lift() {
  fs::remove(starter());
}

std::vector<int> ViewerSetting::endings() const {
  std::vector<int> statuses;
  std::ifstream file(outside("endings"));
  for (int status; file >> status;) statuses.push_back(status);
  return statuses;
}

std::string ViewerSetting::inPhone(const std::string& name) {
  return "/opt/usr/" + name;
}

std::string ViewerSetting::outside(const std::string& name) {
  return thePhone().folder() + "/opt-usr/" + name;
}
