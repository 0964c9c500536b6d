#include <companion/CompanionApp.h>
#include <companion/Launch.h>

#include "HistoryPage.h"

namespace {

class HistoryApp : public companion::CompanionApp {
 public:
  using CompanionApp::CompanionApp;

  bool onCreate() override {
    _page = new history::HistoryPage;
    pages()->push(_page);
    return true;
  }

  void onAppControl(app_control_h request) override {
    _page->reload();
    raise();
    companion::reply(request, APP_CONTROL_RESULT_SUCCEEDED);
  }

  // What has expired in the meantime looks different.
  void onResume() override { _page->reload(); }

 protected:
  // There is nothing behind the phone's home.
  bool onLeave() override { return true; }

 private:
  history::HistoryPage* _page = nullptr;  // the naviframe's
};

}  // namespace

int main(int argc, char** argv) {
  return HistoryApp(argc, argv).start(argc, argv);
}
