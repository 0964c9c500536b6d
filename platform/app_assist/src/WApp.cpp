#include "app_assist/WApp.h"

#include <Ecore_X.h>
#include <Elementary.h>
#include <appfw/AppId.h>
#include <appfw/AppService.h>
#include <dlog.h>
#include <settings/Look.h>
#include <unistd.h>
#include <vconf.h>

#include <cstdio>
#include <cstdlib>
#include <new>

#include "DeviceTheme.h"
#include "Direction.h"
#include "GlibBridge.h"
#include "Language.h"
#include "LateDestroyer.h"
#include "MarkupRefresh.h"
#include "MemoryUse.h"
#include "Threads.h"
#include "WindowPrivate.h"
#include "app_assist/WNaviframeController.h"

namespace app_assist {
namespace {

WApp* theApp = nullptr;

/// Without memory there is nothing to be done but to say so and to go. Allocates nothing.
void outOfMemory() {
  char line[64];
  const int length = snprintf(line, sizeof line, "F/APP_ASSIST(%5d): out of memory\n", getpid());
  [[maybe_unused]] const ssize_t written = write(STDERR_FILENO, line, static_cast<size_t>(length));
  _exit(EXIT_FAILURE);
}

}  // namespace

struct WApp::Private {
  explicit Private(WApp* self) : self(self) {}

  WApp* const self;
  std::unique_ptr<appfw::AppService> service;
  std::unique_ptr<WWindowController> window;
  Ecore_Event_Handler* visibility = nullptr;
  Ecore_Job* refresh = nullptr;
  bool paused = false;

  bool takeName();
  bool setUpToolkit();
  int run();
  void tearDown();
  void followSettings(bool follow);

  static Eina_Bool visibilityCb(void* data, int, void* event);
  void refreshLater();

  static void refreshCb(void* data);
  static void languageCb(keynode_t*, void* data);
  static void paletteCb(keynode_t*, void* data);
  static void textSizeCb(keynode_t*, void* data);
};

WApp::WApp(int, char**) {
  std::set_new_handler(outOfMemory);
  _d = std::make_unique<Private>(this);
}

WApp::~WApp() {
  if (theApp == this) theApp = nullptr;
}

bool WApp::onStart() {
  return true;
}

bool WApp::onCreate() {
  return true;
}

void WApp::onTerminate() {}

void WApp::onPause() {}

void WApp::onResume() {}

void WApp::onAppControl(app_control_h) {}

/// The name comes first: whoever launches the application waits for it, and requests queue up.
int WApp::start(int argc, char** argv) {
  theApp = this;
  limitFreedMemory();
  paintInMainThread();
  // They tell of clock, locale and power, which the platform does itself, and wait for the system
  // bus as long as it takes.
  setenv("ECORE_NO_SYSTEM_MODULES", "1", 1);
  if (!_d->takeName()) return EXIT_FAILURE;
  if (!elm_init(argc, argv)) return EXIT_FAILURE;
  int status = EXIT_FAILURE;
  if (_d->setUpToolkit()) {
    if (onStart()) status = _d->run();
    _d->followSettings(false);
    ecore_x_shutdown();
  }
  _d->service.reset();
  elm_shutdown();
  theApp = nullptr;
  return status;
}

void WApp::attachWindowController(WWindowController* window) {
  _d->window.reset(window);
  if (window) window->_d->open();
}

WWindowController* WApp::getWindowController() const {
  return _d->window.get();
}

WApp* WApp::getInstance() {
  return theApp;
}

/// A process that is no installed application gets no requests, but runs.
bool WApp::Private::takeName() {
  const std::string& id = appfw::applicationId();
  if (id.empty()) {
    dlog_print(DLOG_WARN, "APP_ASSIST", "no application id: nobody can launch this");
    return true;
  }
  service = std::make_unique<appfw::AppService>(id);
  return service->start([] { elm_exit(); });
}

/// The display is opened before the first window, for its size decides the scale. The language
/// follows its setting before anybody else hears of a change, so the framework listens first.
bool WApp::Private::setUpToolkit() {
  if (!ecore_x_init(nullptr)) {
    dlog_print(DLOG_ERROR, "APP_ASSIST", "no display");
    return false;
  }
  installGlibBridge();
  limitCaches();
  limitDecodingThreads();
  followSettings(true);
  Language::bindCatalogues();
  Language::begin();
  DeviceTheme::install();
  return true;
}

int WApp::Private::run() {
  visibility = ecore_event_handler_add(ECORE_X_EVENT_WINDOW_VISIBILITY_CHANGE, visibilityCb, this);
  if (self->onCreate()) {
    if (service) {
      service->deliverTo([this](app_control_h request) {
        self->onAppControl(request);
        returnFreedMemorySoon();
      });
    }
    elm_run();
  }
  tearDown();
  return EXIT_SUCCESS;
}

/// Views end while everything they use is there; the window that they looked at goes last.
void WApp::Private::tearDown() {
  ecore_event_handler_del(visibility);
  if (refresh) ecore_job_del(refresh);
  WViewController* base = window ? window->getBaseViewController() : nullptr;
  if (auto* naviframe = dynamic_cast<WNaviframeController*>(base)) {
    naviframe->destroyAllViewControllers();
  }
  LateDestroyer::instance().flush();
  self->onTerminate();
  window.reset();
  LateDestroyer::instance().flush();
}

void WApp::Private::followSettings(bool follow) {
  static const struct {
    const char* key;
    vconf_callback_fn callback;
  } kFollowed[] = {{VCONFKEY_LANGSET, languageCb},
                   {settings::kThemeKey, paletteCb},
                   {settings::kTextSizeKey, textSizeCb}};
  for (const auto& entry : kFollowed) {
    if (follow) {
      vconf_notify_key_changed(entry.key, entry.callback, this);
    } else {
      vconf_ignore_key_changed(entry.key, entry.callback);
    }
  }
}

/// The application's own tables hear of the change after this.
void WApp::Private::refreshLater() {
  if (!refresh) refresh = ecore_job_add(refreshCb, this);
}

void WApp::Private::languageCb(keynode_t*, void* data) {
  const bool wasMirrored = elm_config_mirrored_get();
  Language::change();
  const auto* self = static_cast<Private*>(data);
  Evas_Object* window = self->window ? self->window->getEvasObj() : nullptr;
  if (window && elm_config_mirrored_get() != wasMirrored) followDirection(window);
}

void WApp::Private::refreshCb(void* data) {
  auto* self = static_cast<Private*>(data);
  self->refresh = nullptr;
  Evas_Object* window = self->window ? self->window->getEvasObj() : nullptr;
  if (window) refreshTexts(window);
}

void WApp::Private::paletteCb(keynode_t*, void* data) {
  DeviceTheme::applyPalette();
  static_cast<Private*>(data)->refreshLater();
}

void WApp::Private::textSizeCb(keynode_t*, void* data) {
  DeviceTheme::applyTextSize();
  static_cast<Private*>(data)->refreshLater();
}

Eina_Bool WApp::Private::visibilityCb(void* data, int, void* event) {
  auto* self = static_cast<Private*>(data);
  const auto* change = static_cast<Ecore_X_Event_Window_Visibility_Change*>(event);
  Evas_Object* window = self->window ? self->window->getEvasObj() : nullptr;
  if (!window || change->win != elm_win_xwindow_get(window)) return ECORE_CALLBACK_PASS_ON;
  const bool hidden = change->fully_obscured;
  if (hidden == self->paused) return ECORE_CALLBACK_PASS_ON;
  self->paused = hidden;
  if (hidden) {
    self->self->onPause();
  } else {
    self->self->onResume();
  }
  return ECORE_CALLBACK_PASS_ON;
}

}  // namespace app_assist
