#pragma once

#include <companion/ListPage.h>

#include "Subscriber.h"

namespace ovuport {

/// Signs this phone's number up.
class SignUpPage : public companion::ListPage {
 public:
  /// `server` is the account server that the asking application named, empty for the default.
  SignUpPage(Subscriber& subscriber, std::string server);

  const char* getClassName() override { return "SignUpPage"; }
  void onCreated() override;
  void onPushed(Elm_Object_Item* item) override;

 protected:
  void showTexts() override;
  companion::Row row(companion::RowKey key) override;
  std::vector<Button> buttons() override;

 private:
  enum class Step { Asking, SigningUp, Failed };

  void _goTo(Step step);
  void _signUp();
  void _signedUp(const std::string& imsi, int error);

  Subscriber& _subscriber;
  std::string _server;
  Step _step = Step::Asking;
};

}  // namespace ovuport
