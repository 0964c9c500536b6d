#include "SignUpPage.h"

#include <SimCard.h>
#include <companion/Text.h>
#include <zelqo.h>

using companion::text;

namespace ovuport {

SignUpPage::SignUpPage(Subscriber& subscriber, std::string server)
    : _subscriber(subscriber), _server(std::move(server)) {
  setTitle(text("Sign up"));
}

void SignUpPage::onCreated() {
  setHeader(text("To share files, sign up with the number of this phone."));
  setRows({0});
}

void SignUpPage::onPushed(Elm_Object_Item* item) {
  ListPage::onPushed(item);
  setButtonEnabled(0, !_subscriber.number.empty());
}

companion::Row SignUpPage::row(companion::RowKey) {
  companion::Row row;
  row.title = _subscriber.number.empty() ? text("This phone has no number") : _subscriber.number;
  row.detail = _server.empty() ? std::string(text("Phone number"))
                               : companion::format("Phone number, at %s", _server.c_str());
  return row;
}

std::vector<companion::ListPage::Button> SignUpPage::buttons() {
  return {{text("Sign up"), [this] { _signUp(); }}};
}

void SignUpPage::_signUp() {
  setButtonEnabled(0, false);
  setHeader(text("Signing up…"));
  const std::string imsi = ovu::simCardImsi();
  _subscriber.service.signUp(imsi, [this, imsi](int error) { _signedUp(imsi, error); });
}

void SignUpPage::_signedUp(const std::string& imsi, int error) {
  const bool succeeded =
      error == ZELQO_ERROR_NONE && _subscriber.accounts.signUp(_subscriber.number, imsi);
  if (!succeeded) {
    setButtonEnabled(0, true);
    setHeader(text("Signing up did not work. Try again."));
    return;
  }
  companion::showMessage(text("Signed up"));
  _subscriber.reply.send(APP_CONTROL_RESULT_SUCCEEDED);
  getNaviframe()->pop();
}

}  // namespace ovuport
