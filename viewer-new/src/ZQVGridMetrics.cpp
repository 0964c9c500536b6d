#include "ZQVGridMetrics.h"

#include <Ecore_X.h>
#include <Elementary.h>

#include "ZQVOwned.h"

namespace {

/// The root window does not turn with the screen.
void screenSize(Evas_Object* window, int* width, int* height) {
  if (!ecore_x_display_get()) {
    elm_win_screen_size_get(window, nullptr, nullptr, width, height);
    return;
  }
  int count = 0;
  ZQVOwned<Ecore_X_Window, free> roots(ecore_x_window_root_list(&count));
  if (roots && count > 0) ecore_x_window_size_get(roots.get()[0], width, height);
}

}  // namespace

int zqvCellSideFor(int screenWidth, int screenHeight, int rotation) {
  return rotation == 90 || rotation == 270 ? screenHeight / 7 : screenWidth / 4;
}

int zqvGridCellSide(Evas_Object* window) {
  int width = 0;
  int height = 0;
  screenSize(window, &width, &height);
  return zqvCellSideFor(width, height, elm_win_rotation_get(window));
}
