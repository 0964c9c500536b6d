/// The environment in which the phone starts the viewer, and how the viewer ended in it.
#pragma once

#include <string>
#include <vector>

#include "Phone.h"

class ViewerSetting {
 public:
  /// From the next start of the viewer until this object goes or is lifted: NAME=VALUE texts.
  explicit ViewerSetting(const phone::Words& environment);
  ~ViewerSetting();
  ViewerSetting(const ViewerSetting&) = delete;
  ViewerSetting& operator=(const ViewerSetting&) = delete;

  /// The next start is as usual.
  void lift();

  /// What ended since the beginning: exit statuses, as a shell gives them.
  std::vector<int> endings() const;

  /// Where a file is for the viewer and for this test.
  static std::string inPhone(const std::string& name);
  static std::string outside(const std::string& name);
};
