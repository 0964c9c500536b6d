/// A message over the top of the window, whatever else the window shows; the layout takes it away
/// again.
#pragma once

#include <Elementary.h>

namespace app_assist {

class MessageBanner {
 public:
  explicit MessageBanner(Evas_Object* window);
  ~MessageBanner();
  MessageBanner(const MessageBanner&) = delete;
  MessageBanner& operator=(const MessageBanner&) = delete;

  void show(const char* markup);

 private:
  static void windowResizedCb(void* data, Evas*, Evas_Object* window, void*);
  static void bannerDeletedCb(void* data, Evas*, Evas_Object*, void*);

  Evas_Object* const _window;
  Evas_Object* _banner;
};

}  // namespace app_assist
