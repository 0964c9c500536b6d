/// A window with a naviframe, and pages that write down what happens to them.
#pragma once

#include <app_assist.h>
#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "Loop.h"

using Record = std::vector<std::string>;

class FakePage : public app_assist::WContentViewController {
 public:
  FakePage(Record& record, std::string name) : _record(record), _name(std::move(name)) {}
  ~FakePage() override { note("gone"); }

  const char* getClassName() override { return "FakePage"; }
  bool onPrepare() override { return prepares; }
  Evas_Object* onCreateView(Evas_Object* parent, void* viewParam) override {
    this->viewParam = viewParam;
    note("view");
    setTitle(_name.c_str());
    return hasView ? elm_layout_add(parent) : nullptr;
  }
  void onCreated() override { note("created"); }
  Evas_Object* onViewDeleted(Evas_Object* view) override {
    note("view deleted");
    return view;
  }
  Elm_Object_Item* onPushToNaviframe(Evas_Object* naviframe) override {
    note("push");
    return WContentViewController::onPushToNaviframe(naviframe);
  }
  void onPushed(Elm_Object_Item*) override { note("pushed"); }
  bool onPop() override {
    note("pop");
    return allowsPop;
  }
  void onBecomeTop() override { note("top"); }

  bool prepares = true;
  bool hasView = true;
  bool allowsPop = true;
  void* viewParam = nullptr;

 private:
  void note(const char* what) { _record.push_back(_name + " " + what); }

  Record& _record;
  const std::string _name;
};

class FrameTest : public testing::Test {
 protected:
  FrameTest() : app(0, nullptr) {
    window = new app_assist::WWindowController("frame-test", ELM_WIN_BASIC);
    app.attachWindowController(window);
    naviframe = new app_assist::WNaviframeController;
    window->attachBaseViewController(naviframe);
    evas_object_smart_callback_add(
        naviframe->getEvasObj(), "transition,finished",
        [](void* data, Evas_Object*, void*) { ++*static_cast<int*>(data); }, &_transitions);
  }
  ~FrameTest() override { naviframe->destroyAllViewControllers(); }

  /// Not returning before the page is in place.
  FakePage* pushed(const char* name) {
    const int before = _transitions;
    const bool slides = pages() > 0;
    FakePage* page = pushedJustNow(name);
    EXPECT_TRUE(waitUntil([&] { return !slides || _transitions > before; }));
    record.clear();
    return page;
  }
  FakePage* pushedJustNow(const char* name) {
    auto* page = new FakePage(record, name);
    naviframe->push(page);
    return page;
  }
  /// For what must not happen, and for what a transition might do after its page has gone.
  void runPastTransitions() {
    const double until = ecore_time_get() + 0.3;
    waitUntil([&] { return ecore_time_get() > until; });
  }
  int pages() const {
    Eina_List* items = elm_naviframe_items_get(naviframe->getEvasObj());
    const int count = static_cast<int>(eina_list_count(items));
    eina_list_free(items);
    return count;
  }
  bool has(const char* entry) const {
    for (const std::string& noted : record) {
      if (noted == entry) return true;
    }
    return false;
  }

  Record record;
  app_assist::WApp app;
  app_assist::WWindowController* window;
  app_assist::WNaviframeController* naviframe;

 private:
  int _transitions = 0;
};
