#include <companion/CompanionApp.h>
#include <zelqo/PhoneSettings.h>

#include "SettingPage.h"
#include "SignUpPage.h"
#include "Subscriber.h"

namespace {

constexpr const char* kSettingPath = "/appcontrol/operation/setting";

bool endsWith(const std::string& whole, const std::string& end) {
  return whole.size() >= end.size() &&
         whole.compare(whole.size() - end.size(), end.size(), end) == 0;
}

class SignUpApp : public companion::CompanionApp {
 public:
  using CompanionApp::CompanionApp;

  // The pages go first: they work on the subscriber.
  void onAppControl(app_control_h request) override {
    pages()->destroyAllViewControllers();
    _subscriber = std::make_unique<ovuport::Subscriber>(zelqo::ownNumber(), request);
    const auto servers = companion::extrasOf(request, "server");
    const bool setting = endsWith(companion::operationOf(request), kSettingPath);
    if (setting && _subscriber->accounts.account()) {
      pages()->push(new ovuport::SettingPage(*_subscriber));
    } else {
      pages()->push(new ovuport::SignUpPage(*_subscriber, servers.empty() ? "" : servers.front()));
    }
    raise();
  }

  void onTerminate() override { _subscriber.reset(); }

 private:
  std::unique_ptr<ovuport::Subscriber> _subscriber;
};

}  // namespace

int main(int argc, char** argv) {
  return SignUpApp(argc, argv).start(argc, argv);
}
