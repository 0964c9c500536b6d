#include "PageTest.h"

#include <Elementary.h>
#include <contacts.h>
#include <libintl.h>

#include <random>

using app_assist::WContentViewController;
using app_assist::WNaviframeController;

bool TestViewer::onCreate() {
  bindtextdomain("zelqo", TEST_LOCALES);
  bind_textdomain_codeset("zelqo", "UTF-8");
  FakePlatform& platform = FakePlatform::get();
  platform.reset();
  platform.contactsConnectError = CONTACTS_ERROR_IPC_NOT_AVALIABLE;
  FakeLog::get().clear();
  ZQVApp::onCreate();
  startErrors = FakeLog::get().errors();
  contactsChanged = platform.contactsChanged;
  settingsChanged = platform.settingCallbacks[13].first;
  watchedSettings = platform.watchedSettings;
  evas_object_resize(window(), 720, 1280);
  evas_object_show(window());
  _result = RUN_ALL_TESTS();
  return false;
}

void TestViewer::onTerminate() {
  FakeLog::get().clear();
  ZQVApp::onTerminate();
  // After the last test: what the end leaves behind is a failure of the whole program.
  if (FakeClock::running() != 0 || !FakeLog::get().errors().empty()) _result = 1;
}

WNaviframeController* TestViewer::naviframe() const {
  return static_cast<WNaviframeController*>(getWindowController()->getBaseViewController());
}

std::vector<std::string> PageTest::pages() const {
  std::vector<std::string> names;
  Eina_List* items = elm_naviframe_items_get(naviframe.getEvasObj());
  void* item = nullptr;
  EINA_LIST_FREE(items, item) {
    auto* view = static_cast<WContentViewController*>(
        elm_object_item_data_get(static_cast<Elm_Object_Item*>(item)));
    names.push_back(view ? view->getClassName() : "(none)");
  }
  return names;
}

WContentViewController* PageTest::top() const {
  return topItem() ? static_cast<WContentViewController*>(elm_object_item_data_get(topItem()))
                   : nullptr;
}

std::string PageTest::title() const {
  const char* text = elm_object_item_text_get(topItem());
  return text ? text : "";
}

std::string PageTest::textOf(Evas_Object* object, const char* part) {
  const char* text = elm_object_part_text_get(object, part);
  return text ? text : "";
}

std::string PageTest::picture(const char* name, int side) {
  static const std::string folder = [] {
    char path[] = "/tmp/pages.XXXXXX";
    return std::string(mkdtemp(path));
  }();
  std::string path = folder + "/" + name;
  Ecore_Evas* canvas = ecore_evas_buffer_new(8, 8);
  Evas_Object* image = evas_object_image_filled_add(ecore_evas_get(canvas));
  evas_object_image_size_set(image, side, side);
  auto* pixels = static_cast<uint32_t*>(evas_object_image_data_get(image, EINA_TRUE));
  std::minstd_rand noise;
  std::generate_n(pixels, side * side, [&noise] { return 0xff000000u | noise(); });
  evas_object_image_data_set(image, pixels);
  evas_object_image_save(image, path.c_str(), nullptr, nullptr);
  ecore_evas_free(canvas);
  return path;
}
