// The calls of the toolkit that the tests must see or let fail, and where the layouts lie.
#include <Elementary.h>
#include <app_common.h>
#include <dlfcn.h>

#include <cstring>

#include "FakePhone.h"

extern "C" {

void elm_exit(void) {
  ++FakePhone::get().exits;
}

Evas_Object* elm_button_add(Evas_Object* parent) {
  if (FakePhone::get().buttonsUntilFailure == 0) return nullptr;
  if (FakePhone::get().buttonsUntilFailure > 0) --FakePhone::get().buttonsUntilFailure;
  static auto* real =
      reinterpret_cast<decltype(&elm_button_add)>(dlsym(RTLD_NEXT, "elm_button_add"));
  return real(parent);
}

char* app_get_resource_path(void) {
  return strdup(VIEWS_RESOURCES "/");
}

}  // extern "C"
