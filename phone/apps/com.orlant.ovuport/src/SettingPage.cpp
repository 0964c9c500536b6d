#include "SettingPage.h"

#include <companion/Text.h>
#include <ovu.h>
#include <zelqo.h>

using companion::text;

namespace ovuport {

SettingPage::SettingPage(Subscriber& subscriber) : _subscriber(subscriber) {}

void SettingPage::showTexts() {
  setTitle(text("Account"));
  setHeader(companion::format("Signed up as %s", _subscriber.number.c_str()));
}

void SettingPage::onCreated() {
  setRows({0});
}

companion::Row SettingPage::row(companion::RowKey) {
  companion::Row row;
  const bool on = _subscriber.accounts.isServiceOn(OVU_SERVICE_SHARE);
  row.title = text("Sharing service");
  row.detail = _isSwitching ? text("Switching…") : on ? text("On") : text("Off");
  row.checked = on;
  return row;
}

void SettingPage::onRowTapped(companion::RowKey) {
  if (_isSwitching) return;
  _isSwitching = true;
  const bool on = !_subscriber.accounts.isServiceOn(OVU_SERVICE_SHARE);
  updateRows();
  _subscriber.service.switchSharing(
      on, [this](int error, bool isOn) { _switched(error == ZELQO_ERROR_NONE, isOn); });
}

void SettingPage::_switched(bool succeeded, bool on) {
  _isSwitching = false;
  if (succeeded && _subscriber.accounts.switchService(OVU_SERVICE_SHARE, on)) {
    _subscriber.reply.send(APP_CONTROL_RESULT_SUCCEEDED);
  } else {
    companion::showMessage(text("The service could not be switched. Try again."));
  }
  updateRows();
}

}  // namespace ovuport
