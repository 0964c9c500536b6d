#pragma once

#include <Elementary.h>

#include "ZQVPicturePreload.h"

/// The pictures next to the page on screen, decoded before somebody turns to them.
class ZQVNeighbourPictures {
 public:
  /// Those of the cells before and after this one; null for none.
  void lookAround(Elm_Object_Item* cell);

 private:
  ZQVPicturePreload _before;
  ZQVPicturePreload _after;
};
