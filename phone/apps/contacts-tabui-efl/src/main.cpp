#include <companion/CompanionApp.h>

#include "PickerPage.h"

namespace {

class PickerApp : public companion::CompanionApp {
 public:
  using CompanionApp::CompanionApp;

  void onAppControl(app_control_h request) override {
    pages()->destroyAllViewControllers();
    pages()->push(
        new picker::PickerPage(picker::readRequest(request), companion::PendingReply(request)));
    raise();
  }
};

}  // namespace

int main(int argc, char** argv) {
  return PickerApp(argc, argv).start(argc, argv);
}
