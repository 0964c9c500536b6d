#pragma once

#include <app_assist.h>

#include <string>
#include <vector>

#include "../views/Items.h"
#include "Loop.h"
#include "ViewerTest.h"
#include "ZQVApp.h"

/// The viewer itself, in a window in memory. All tests run at the end of its onCreate.
class TestViewer : public ZQVApp {
 public:
  TestViewer(int argc, char** argv) : ZQVApp(argc, argv) {}
  bool onCreate() override;
  void onTerminate() override;

  Evas_Object* window() const { return getWindowController()->getEvasObj(); }
  app_assist::WNaviframeController* naviframe() const;
  int result() const { return _result; }
  static TestViewer& get() { return *static_cast<TestViewer*>(getInstance()); }

  // What the start registered and logged.
  void (*contactsChanged)(const char*, void*) = nullptr;
  void (*settingsChanged)(int, void*) = nullptr;
  std::vector<int> watchedSettings;
  Errors startErrors;

 private:
  int _result = 1;
};

/// A test with a window. Its pages end with it.
class PageTest : public ViewerTest {
 protected:
  void TearDown() override { naviframe.destroyAllViewControllers(); }

  /// The class names of the pages, lowest first.
  std::vector<std::string> pages() const;
  app_assist::WContentViewController* top() const;
  Elm_Object_Item* topItem() const { return elm_naviframe_top_item_get(naviframe.getEvasObj()); }
  Evas_Object* toolbarButton() const {
    return elm_object_item_part_content_get(topItem(), "toolbar");
  }
  std::string title() const;
  static std::string textOf(Evas_Object* object, const char* part = nullptr);
  static void click(Evas_Object* button) {
    evas_object_smart_callback_call(button, "clicked", nullptr);
  }
  /// The path of a picture with that name; it is square, and no compression makes it small.
  static std::string picture(const char* name, int side = 8);

  Evas_Object* const window = TestViewer::get().window();
  app_assist::WNaviframeController& naviframe = *TestViewer::get().naviframe();
  Items items;
};
