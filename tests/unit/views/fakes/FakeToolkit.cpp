// The two calls of the toolkit that the tests must see or let fail.
#include <Elementary.h>
#include <dlfcn.h>

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

}  // extern "C"
