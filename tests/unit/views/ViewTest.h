#pragma once

#include <app_assist.h>

#include <string>

#include "Items.h"
#include "Loop.h"
#include "PhoneTest.h"
#include "ZQVText.h"

/// The application around the views under test: a real window with a real naviframe. All tests run
/// inside its onCreate.
class TestApp : public app_assist::WApp {
 public:
  TestApp(int argc, char** argv) : WApp(argc, argv) {}
  bool onCreate() override;

  app_assist::WNaviframeController* naviframe() const { return _naviframe; }
  Evas_Object* window() const { return getWindowController()->getEvasObj(); }
  int result() const { return _result; }
  static TestApp& get() { return *static_cast<TestApp*>(getInstance()); }

 private:
  app_assist::WNaviframeController* _naviframe = nullptr;
  int _result = 1;
};

/// An empty first page, so that the page under test can be popped.
class BlankPage : public app_assist::WContentViewController {
 public:
  const char* getClassName() override { return "BlankPage"; }
  Evas_Object* onCreateView(Evas_Object* parent, void*) override { return elm_layout_add(parent); }
};

/// Runs all tests inside the application, on buses of its own, and ends the process.
[[noreturn]] void runViewTests(int argc, char** argv);

/// A test of pages. Pages end with it.
class ViewTest : public PhoneTest {
 protected:
  ViewTest() {
    naviframe.push(new BlankPage());
    log.clear();
  }
  ~ViewTest() override { naviframe.destroyAllViewControllers(); }

  /// Pushes a page and waits until it has arrived.
  void push(app_assist::WContentViewController* view, void* viewParam = nullptr,
            const char* style = nullptr);
  /// The controller of the uppermost page.
  app_assist::WContentViewController* top() const;
  bool isTop(const char* className) const {
    return className == std::string(top()->getClassName());
  }

  static std::string textOf(Evas_Object* object, const char* part = nullptr);
  static bool isEnabled(Evas_Object* object) { return !elm_object_disabled_get(object); }
  static void click(Evas_Object* button) {
    evas_object_smart_callback_call(button, "clicked", nullptr);
  }
  /// The popup in front, or null.
  static Evas_Object* popup();
  static Evas_Object* popupButton(int number);
  static bool waitForPopup() {
    return waitUntil([] { return popup() != nullptr; });
  }
  static bool waitForNoPopup() {
    return waitUntil([] { return popup() == nullptr; });
  }

  app_assist::WNaviframeController& naviframe = *TestApp::get().naviframe();
  Items items;
};

/// A page class that tells when it is gone.
template <typename View>
class Watched : public View {
 public:
  template <typename... Arguments>
  explicit Watched(bool* isGone, Arguments... arguments) : View(arguments...), _isGone(isGone) {}
  ~Watched() override { *_isGone = true; }

 private:
  bool* _isGone;
};
