#pragma once

#include <string>
#include <vector>

#include "app_assist/WContentViewController.h"

namespace app_assist {

struct WContentViewController::Private {
  WNaviframeController* naviframe = nullptr;
  Elm_Object_Item* item = nullptr;
  std::string itemStyle;
  std::string title;
  std::vector<WPopupController*> popups;
  bool ending = false;

  /// At once, in the order of attachment; from now on no popup can be added.
  void closePopups();
};

}  // namespace app_assist
