#include <Edje.h>
#include <Elementary.h>
#include <app_assist.h>
#include <app_control.h>
#include <gtest/gtest.h>
#include <vconf.h>

#include <clocale>
#include <csignal>
#include <cstdlib>
#include <functional>
#include <new>

#include "FramePages.h"

using app_assist::WApp;
using app_assist::WNaviframeController;
using app_assist::WWindowController;

namespace {

constexpr const char* kThemeKey = "db/setting/theme";

/// Sends a launch request to this very process, as it is registered on the bus.
void launchMyself(const char* operation) {
  app_control_h request = nullptr;
  app_control_create(&request);
  app_control_set_app_id(request, getenv("APPFW_APP_ID"));
  app_control_set_operation(request, operation);
  EXPECT_EQ(app_control_send_launch_request(request, nullptr, nullptr), APP_CONTROL_ERROR_NONE);
  app_control_destroy(request);
}

class FakeApp : public WApp {
 public:
  explicit FakeApp(Record& record) : WApp(0, nullptr), _record(record) {}

  bool onStart() override {
    _record.push_back("start");
    if (atStart) atStart();
    return starts;
  }
  bool onCreate() override {
    _record.push_back("create");
    auto* window = new WWindowController("app-test", ELM_WIN_BASIC);
    attachWindowController(window);
    auto* naviframe = new WNaviframeController;
    window->attachBaseViewController(naviframe);
    naviframe->push(new FakePage(pages, "page"));
    if (atCreate) atCreate();
    return creates;
  }
  void onAppControl(app_control_h request) override {
    char* operation = nullptr;
    app_control_get_operation(request, &operation);
    _record.push_back(operation ? operation : "none");
    free(operation);
    elm_exit();
  }
  void onTerminate() override {
    pagesGoneAtEnd = !pages.empty() && pages.back() == "page gone";
    windowThereAtEnd = getWindowController() && getWindowController()->getEvasObj();
    _record.push_back("terminate");
  }

  bool starts = true;
  bool creates = true;
  std::function<void()> atStart;
  std::function<void()> atCreate;
  Record pages;
  bool pagesGoneAtEnd = false;
  bool windowThereAtEnd = false;

 private:
  Record& _record;
};

/// The setting is changed while the application runs; it ends when it has followed.
class App : public testing::Test {
 protected:
  int run() { return app.start(0, nullptr); }
  void runUntil(std::function<void()> change, std::function<bool()> followed) {
    app.atCreate = [=] {
      ecore_job_add([](void* data) { (*static_cast<std::function<void()>*>(data))(); }, &_change);
      _followed = ecore_timer_add(
          0.002,
          [](void* data) -> Eina_Bool {
            if (!(*static_cast<std::function<bool()>*>(data))()) return ECORE_CALLBACK_RENEW;
            elm_exit();
            return ECORE_CALLBACK_CANCEL;
          },
          &_condition);
    };
    _change = std::move(change);
    _condition = std::move(followed);
    EXPECT_EQ(run(), 0);
  }

  Record record;
  FakeApp app{record};

 private:
  std::function<void()> _change;
  std::function<bool()> _condition;
  Ecore_Timer* _followed = nullptr;
};

int redOf(const char* colourClass) {
  int r = -1;
  edje_color_class_get(colourClass, &r, nullptr, nullptr, nullptr, nullptr, nullptr, nullptr,
                       nullptr, nullptr, nullptr, nullptr, nullptr);
  return r;
}

}  // namespace

TEST_F(App, HandsOnARequestOnceItIsCreated) {
  app.atCreate = [] { launchMyself("op"); };
  EXPECT_EQ(run(), 0);
  EXPECT_EQ(record, (Record{"start", "create", "op", "terminate"}));
}

TEST_F(App, KeepsARequestThatCameBeforeItWasCreated) {
  app.atStart = [] { launchMyself("early"); };
  EXPECT_EQ(run(), 0);
  EXPECT_EQ(record, (Record{"start", "create", "early", "terminate"}));
}

TEST_F(App, EndsItsPagesBeforeAndItsWindowAfterTermination) {
  app.atCreate = [] { launchMyself("op"); };
  run();
  EXPECT_TRUE(app.pagesGoneAtEnd);
  EXPECT_TRUE(app.windowThereAtEnd);
  EXPECT_EQ(app.getWindowController(), nullptr);
}

TEST_F(App, IsKnownWhileItRuns) {
  WApp* known = nullptr;
  app.atCreate = [&] {
    known = WApp::getInstance();
    launchMyself("op");
  };
  run();
  EXPECT_EQ(known, &app);
  EXPECT_EQ(WApp::getInstance(), nullptr);
}

TEST_F(App, SaysFromItsBeginningOnWhenThereIsNoMemory) {
  const auto runOutOfMemory = [&] {
    std::set_new_handler(nullptr);
    const FakeApp another(record);
    std::get_new_handler()();
  };
  EXPECT_EXIT(runOutOfMemory(), testing::ExitedWithCode(EXIT_FAILURE),
              "F/APP_ASSIST\\([ 0-9]+\\): out of memory");
}

TEST_F(App, EndsAtOnceWhenItDoesNotStart) {
  app.starts = false;
  EXPECT_NE(run(), 0);
  EXPECT_EQ(record, (Record{"start"}));
}

TEST_F(App, TerminatesWithoutALoopWhenItIsNotCreated) {
  app.creates = false;
  run();
  EXPECT_EQ(record, (Record{"start", "create", "terminate"}));
}

TEST_F(App, TerminatesOrderlyWhenTheProcessIsToldTo) {
  app.atCreate = [] { ecore_job_add([](void*) { raise(SIGTERM); }, nullptr); };
  EXPECT_EQ(run(), 0);
  EXPECT_EQ(record.back(), "terminate");
  EXPECT_TRUE(app.pagesGoneAtEnd);
}

TEST_F(App, FitsItsScaleToTheScreen) {
  double scale = 0;
  int width = 0;
  app.atCreate = [&] {
    scale = elm_config_scale_get();
    elm_win_screen_size_get(app.getWindowController()->getEvasObj(), nullptr, nullptr, &width,
                            nullptr);
    launchMyself("op");
  };
  run();
  EXPECT_NEAR(scale, 2.6 * width / 720, 0.001);
}

TEST_F(App, KeepsLittleOfWhatIsNoLongerShown) {
  int pictures = 0;
  app.atCreate = [&] {
    pictures = evas_image_cache_get(evas_object_evas_get(app.getWindowController()->getEvasObj()));
    launchMyself("op");
  };
  run();
  constexpr int kMegabyte = 1024 * 1024;
  EXPECT_LE(pictures, kMegabyte);
  EXPECT_GT(pictures, kMegabyte / 4);
  EXPECT_LE(eina_freeq_mem_max_get(eina_freeq_main_get()), static_cast<size_t>(kMegabyte));
}

TEST_F(App, PaintsAFrameInOneGo) {
  struct Frame {
    double begun = 0;
    double painted = 0;
  } frame;
  app.atCreate = [&] {
    Evas* canvas = evas_object_evas_get(app.getWindowController()->getEvasObj());
    evas_event_callback_add(
        canvas, EVAS_CALLBACK_RENDER_PRE,
        [](void* data, Evas*, void*) { static_cast<Frame*>(data)->begun = ecore_loop_time_get(); },
        &frame);
    evas_event_callback_add(
        canvas, EVAS_CALLBACK_RENDER_POST,
        [](void* data, Evas*, void*) {
          static_cast<Frame*>(data)->painted = ecore_loop_time_get();
          elm_exit();
        },
        &frame);
  };
  run();
  EXPECT_GT(frame.begun, 0);
  EXPECT_EQ(frame.begun, frame.painted);
}

TEST_F(App, DecodesPicturesWithTwoThreads) {
  int threads = 0;
  app.atCreate = [&] {
    threads = ecore_thread_max_get();
    launchMyself("op");
  };
  run();
  EXPECT_EQ(threads, 2);
}

TEST_F(App, SpeaksTheNewLanguageBeforeTheApplicationHearsOfIt) {
  static std::string heard;
  heard.clear();
  runUntil(
      [] {
        vconf_notify_key_changed(
            VCONFKEY_LANGSET,
            [](keynode_t*, void*) {
              const char* language = getenv("LANGUAGE");
              heard = language ? language : setlocale(LC_MESSAGES, nullptr);
            },
            nullptr);
        vconf_set_str(VCONFKEY_LANGSET, "de_DE.UTF-8");
      },
      [] { return !heard.empty(); });
  EXPECT_EQ(heard.substr(0, 5), "de_DE");
}

TEST_F(App, ReadsFromTheOtherSideInArabic) {
  runUntil([] { vconf_set_str(VCONFKEY_LANGSET, "ar_EG.UTF-8"); },
           [] { return elm_config_mirrored_get() == EINA_TRUE; });
}

TEST_F(App, ReadsFromTheLeftInEnglishAgain) {
  runUntil([] { vconf_set_str(VCONFKEY_LANGSET, "en_US.UTF-8"); },
           [] { return elm_config_mirrored_get() == EINA_FALSE; });
}

TEST_F(App, TurnsDarkAndLightAtOnce) {
  runUntil([] { vconf_set_str(kThemeKey, "dark"); }, [] { return redOf("look/page") < 64; });
  runUntil([] { vconf_set_str(kThemeKey, "light"); }, [] { return redOf("look/page") > 192; });
}

TEST_F(App, EnlargesItsTextsAtOnce) {
  runUntil([] { vconf_set_int("db/setting/accessibility/font_size", 150); },
           [] {
             const char* font = nullptr;
             int size = 0;
             return edje_text_class_get("body", &font, &size) && size == -150;
           });
}
