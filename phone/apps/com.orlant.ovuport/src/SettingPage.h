#pragma once

#include <companion/ListPage.h>

#include "Subscriber.h"

namespace ovuport {

/// Switches the sharing service of the account on and off.
class SettingPage : public companion::ListPage {
 public:
  explicit SettingPage(Subscriber& subscriber);

  const char* getClassName() override { return "SettingPage"; }
  void onCreated() override;

 protected:
  void showTexts() override;
  companion::Row row(companion::RowKey key) override;
  void onRowTapped(companion::RowKey key) override;

 private:
  void _switched(bool succeeded, bool on);

  Subscriber& _subscriber;
  bool _isSwitching = false;
};

}  // namespace ovuport
