#include "SignUpPage.h"

#include <SimCard.h>
#include <companion/Text.h>
#include <zelqo.h>

using companion::text;

namespace ovuport {

SignUpPage::SignUpPage(Subscriber& subscriber, std::string server)
    : _subscriber(subscriber), _server(std::move(server)) {}

void SignUpPage::showTexts() {
  setTitle(text("Sign up"));
  switch (_step) {
    case Step::Asking:
      return setHeader(text("To share files, sign up with the number of this phone."));
    case Step::SigningUp:
      return setHeader(text("Signing up…"));
    case Step::Failed:
      return setHeader(text("Signing up did not work. Try again."));
  }
}

void SignUpPage::onCreated() {
  setRows({0});
}

void SignUpPage::_goTo(Step step) {
  _step = step;
  setButtonEnabled(0, step != Step::SigningUp);
  showTexts();
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
  _goTo(Step::SigningUp);
  const std::string imsi = ovu::simCardImsi();
  _subscriber.service.signUp(imsi, [this, imsi](int error) { _signedUp(imsi, error); });
}

void SignUpPage::_signedUp(const std::string& imsi, int error) {
  const bool succeeded =
      error == ZELQO_ERROR_NONE && _subscriber.accounts.signUp(_subscriber.number, imsi);
  if (!succeeded) {
    _goTo(Step::Failed);
    return;
  }
  companion::showMessage(text("Signed up"));
  _subscriber.reply.send(APP_CONTROL_RESULT_SUCCEEDED);
  getNaviframe()->pop();
}

}  // namespace ovuport
