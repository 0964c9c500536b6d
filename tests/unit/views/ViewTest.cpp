#include "ViewTest.h"

#include <cstring>

#include "PageProcess.h"

bool TestApp::onCreate() {
  auto* window = new app_assist::WWindowController("views-test", ELM_WIN_BASIC);
  _naviframe = new app_assist::WNaviframeController();
  elm_app_base_scale_set(2.6);
  elm_config_transition_duration_factor_set(0.1);
  attachWindowController(window);
  window->attachBaseViewController(_naviframe);
  _result = RUN_ALL_TESTS();
  return false;
}

void runViewTests(int argc, char** argv) {
  PageProcess process(TEST_THEME);
  testing::InitGoogleMock(&argc, argv);
  TestApp app(argc, argv);
  app.start(argc, argv);
  process.end(app.result());
}

void ViewTest::push(app_assist::WContentViewController* view, void* viewParam, const char* style) {
  bool hasArrived = false;
  const Evas_Smart_Cb arrived = [](void* data, Evas_Object*, void*) {
    *static_cast<bool*>(data) = true;
  };
  evas_object_smart_callback_add(naviframe.getEvasObj(), "transition,finished", arrived,
                                 &hasArrived);
  naviframe.push(view, viewParam, style);
  EXPECT_TRUE(waitUntil([&] { return hasArrived; }));
  evas_object_smart_callback_del_full(naviframe.getEvasObj(), "transition,finished", arrived,
                                      &hasArrived);
}

app_assist::WContentViewController* ViewTest::top() const {
  return static_cast<app_assist::WContentViewController*>(
      elm_object_item_data_get(elm_naviframe_top_item_get(naviframe.getEvasObj())));
}

std::string ViewTest::textOf(Evas_Object* object, const char* part) {
  const char* text = elm_object_part_text_get(object, part);
  return text ? text : "";
}

Evas_Object* ViewTest::popup() {
  Evas* canvas = evas_object_evas_get(TestApp::get().window());
  for (Evas_Object* object = evas_object_top_get(canvas); object;
       object = evas_object_below_get(object)) {
    const char* type = evas_object_type_get(object);
    if (type && strcmp(type, "elm_popup") == 0 && evas_object_visible_get(object)) return object;
  }
  return nullptr;
}

Evas_Object* ViewTest::popupButton(int number) {
  return elm_object_part_content_get(popup(), ("button" + std::to_string(number)).c_str());
}
